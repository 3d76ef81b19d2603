#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::ElementsAre;
using testing::IsEmpty;
using Names = std::vector<std::string>;

AssociationFilter filterOf(const char* association, const char* result, const char* role,
                           const char* resultRole) {
  const auto name = [](const char* text) { return *text == '\0' ? CIMName() : CIMName(text); };
  return {name(association), name(result), String(role), String(resultRole)};
}

CIMObjectPath objectOf(const std::string& className) {
  return CIMObjectPath(String((className + ".Name=\"a\"").c_str()));
}

// The key values of paths: what stands between the quotes.
Names keysOf(const Names& paths) {
  Names keys;
  for (const std::string& path : paths) {
    const std::size_t quote = path.find('"');
    keys.push_back(path.substr(quote + 1, path.rfind('"') - quote - 1));
  }
  return keys;
}

struct FilterCase {
  const char* name;
  const char* objectClass;
  AssociationFilter filter;
  Names results;
};

// associators and associatorNames must agree.
TEST(Associators, FiltersFollowTheDeclarations) {
  const Names port = {"Link_Port 1", "Link_Port 2"};
  const Names fast = {"Link_FastPort 1", "Link_FastPort 2"};
  const Names copy = {"Link_Copy 1", "Link_Copy 2"};
  const auto join = [](Names first, const Names& second) {
    first.insert(first.end(), second.begin(), second.end());
    return first;
  };
  const FilterCase cases[] = {
      {"all, each association class by itself", "Test_Disk", filterOf("", "", "", ""),
       join(join(port, fast), copy)},
      {"references for a superclass", "test_bigdisk", filterOf("", "", "", ""),
       join(join(port, fast), copy)},
      {"references for a subclass do not count", "Test_Base", filterOf("", "", "", ""), copy},
      {"association class and subclasses", "Test_Disk", filterOf("link_PORT", "", "", ""),
       join(port, fast)},
      {"association subclass", "Test_Disk", filterOf("Link_FastPort", "", "", ""), fast},
      {"result class",
       "Test_Disk",
       filterOf("", "test_fastport", "", ""),
       {"Link_Port 2", "Link_FastPort 2", "Link_Copy 2"}},
      {"role", "Test_Disk", filterOf("", "", "disk", ""), join(port, fast)},
      {"role at the other end", "Test_Disk", filterOf("", "", "Port", ""), {}},
      {"result role", "Test_Disk", filterOf("", "", "", "PORT"), join(port, fast)},
      {"result role at this end", "Test_Disk", filterOf("", "", "", "Disk"), {}},
      {"results of a class that the role is not for",
       "Test_Disk",
       filterOf("", "", "", "Copy"),
       {}},
      {"unknown role", "Test_Disk", filterOf("", "", "1 \xC3\xA9", ""), {}},
      {"unserved", "Test_Disk", filterOf("Link_Unserved", "", "", ""), {}},
      {"no association", "Test_Disk", filterOf("Test_Disk", "", "", ""), {}},
      {"takes part in none", "Test_Array", filterOf("", "", "", ""), {}},
  };
  TestHost host;
  for (const FilterCase& row : cases) {
    SCOPED_TRACE(row.name);
    RecordingSink paths;
    RecordingSink objects;
    const CIMObjectPath object = objectOf(row.objectClass);
    EXPECT_TRUE(
        host.operations.associatorNames(OperationContext(), {kNamespace, object, row.filter}, paths)
            .ok());
    EXPECT_TRUE(host.operations
                    .associators(OperationContext(), {kNamespace, object, row.filter, {}}, objects)
                    .ok());
    EXPECT_EQ(keysOf(paths.names), row.results);
    EXPECT_EQ(objects.names, row.results);
  }
}

struct BehaviourCase {
  const char* association;
  int code;
  const char* message;
  std::size_t results;
};

TEST(Associators, EndAsOnAServer) {
  const BehaviourCase cases[] = {
      {"Link_Nothing", 0, "", 0},
      {"Link_NoComplete", 0, "", 0},
      {"Link_ThrowsNotSupported", 0, "", 0},
      {"Link_ThrowsCim", 2, "not for you", 0},
      {"Link_ThrowsInt", 1, "Unknown error.", 0},
      {"Link_Uninitialized", 1, "uninitialized object", 0},
      {"Link_Class", 1, "dynamic cast failed", 0},
      {"Link_Echo", 0, "", 1},
      {"", 2, "not for you", 0},  // the first that fails takes the others back
      {"Link_Missing", 4, "Link_Missing", 0},
  };
  TestHost host;
  for (const BehaviourCase& row : cases) {
    SCOPED_TRACE(row.association);
    RecordingSink sink;
    const OperationStatus status = host.operations.associators(
        OperationContext(),
        {kNamespace, objectOf("Test_Odd"), filterOf(row.association, "", "", ""), {}}, sink);
    EXPECT_EQ(status.code, row.code);
    EXPECT_EQ(status.message, row.message);
    EXPECT_EQ(sink.names.size(), row.results);
  }
}

TEST(Associators, ProvidersSeeTheServedClassAndTheClientsWords) {
  TestHost host;
  RecordingSink sink;
  const CIMObjectPath object = objectOf("TEST_odd");
  EXPECT_TRUE(host.operations
                  .associators(OperationContext(),
                               {kNamespace, object, filterOf("link_ECHO", "", "ODD", "port"), {}},
                               sink)
                  .ok());
  EXPECT_TRUE(host.operations
                  .associators(OperationContext(),
                               {kNamespace, object, filterOf("LINK_echo", "test_port", "", ""), {}},
                               sink)
                  .ok());
  EXPECT_THAT(sink.names,
              ElementsAre("TEST_odd|Link_Echo||ODD|port", "TEST_odd|Link_Echo|test_port||"));
}

TEST(Associators, ResultsAreCompletedAndSelected) {
  TestHost host;
  RecordingSink sink;
  InstanceSelection selection;
  Array<CIMName> names;
  names.append(CIMName("Size"));
  selection.propertyList = CIMPropertyList(names);
  selection.localOnly = true;
  EXPECT_TRUE(host.operations
                  .associators(OperationContext(),
                               {kNamespace, objectOf("Test_Disk"),
                                filterOf("Link_FastPort", "", "", ""), selection},
                               sink)
                  .ok());
  ASSERT_EQ(sink.instances.size(), 2u);
  EXPECT_EQ(toUtf8(sink.instances[1].getPath().toString()),
            "//" + toUtf8(host.operations.hostName()) +
                "/root/test:Test_FastPort.Name=\"Link_FastPort 2\"");
  EXPECT_EQ(sink.instances[1].getPropertyCount(), 1u);
  EXPECT_EQ(sink.instances[1].findProperty(CIMName("Size")), 0u);
}

TEST(References, EachAssociationClassIsAskedForItsOwn) {
  TestHost host;
  RecordingSink objects;
  const OperationContext context;
  const CIMObjectPath disk = objectOf("Test_Disk");
  EXPECT_TRUE(host.operations
                  .references(context,
                              {kNamespace, disk, filterOf("Link_Port", "", "disk", ""), {}},
                              objects)
                  .ok());
  EXPECT_THAT(objects.names,
              ElementsAre("Test_Disk|Link_Port||disk|", "Test_Disk|Link_FastPort||disk|"));
  RecordingSink paths;
  EXPECT_TRUE(
      host.operations
          .referenceNames(context, {kNamespace, disk, filterOf("Link_Port", "", "", "")}, paths)
          .ok());
  EXPECT_THAT(keysOf(paths.names), ElementsAre("link", "link"));
  RecordingSink refused;
  const AssociationFilter notSupported = filterOf("Link_ThrowsNotSupported", "", "", "");
  EXPECT_TRUE(
      host.operations
          .references(context, {kNamespace, objectOf("Test_Odd"), notSupported, {}}, refused)
          .ok());
  EXPECT_TRUE(
      host.operations
          .referenceNames(context, {kNamespace, objectOf("Test_Odd"), notSupported}, refused)
          .ok());
  EXPECT_THAT(refused.names, IsEmpty());
}

TEST(Associators, RequestsThatCannotBeAnswered) {
  TestHost host;
  RecordingSink sink;
  const OperationContext context;
  const auto codeOf = [&](const char* nameSpace, const char* object) {
    return host.operations
        .associatorNames(context, {CIMNamespaceName(nameSpace), CIMObjectPath(String(object)), {}},
                         sink)
        .code;
  };
  EXPECT_EQ(codeOf("root/nowhere", "Test_Disk.Name=\"a\""), CIM_ERR_INVALID_NAMESPACE);
  EXPECT_EQ(codeOf("root/test", "Test_Missing.Name=\"a\""), CIM_ERR_INVALID_PARAMETER);
  EXPECT_EQ(codeOf("root/test", "Test_Disk"), CIM_ERR_NOT_SUPPORTED);
  TestHost bare("Bare");
  EXPECT_TRUE(
      bare.operations.associatorNames(context, {kNamespace, objectOf("Test_Disk"), {}}, sink).ok());
  EXPECT_THAT(sink.names, IsEmpty());
}

}  // namespace
