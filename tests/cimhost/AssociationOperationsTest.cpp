#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::ElementsAre;
using testing::IsEmpty;
using Names = std::vector<std::string>;

AssociationFilter filterOf(const char* association, const char* result = "", const char* role = "",
                           const char* resultRole = "") {
  const auto name = [](const char* text) { return *text == '\0' ? CIMName() : CIMName(text); };
  return {name(association), name(result), String(role), String(resultRole)};
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

class Associations : public testing::Test {
 protected:
  std::string associators(const char* className, const AssociationFilter& filter,
                          const InstanceSelection& selection = {}) {
    return textOf(host.operations.associators(
        context, {kNamespace, pathOf(className), filter, selection}, sink));
  }
  std::string references(const char* className, const AssociationFilter& filter) {
    return textOf(
        host.operations.references(context, {kNamespace, pathOf(className), filter, {}}, sink));
  }
  std::string referenceNames(const char* className, const AssociationFilter& filter) {
    return textOf(
        host.operations.referenceNames(context, {kNamespace, pathOf(className), filter}, sink));
  }

  TestHost host;
  RecordingSink sink;
  const OperationContext context;
};

// associators and associatorNames must agree.
TEST_F(Associations, FiltersFollowTheDeclarations) {
  const Names fast = {"Link_FastPort 1", "Link_FastPort 2"};
  const Names port = {"Link_Port 1", "Link_Port 2", "Link_FastPort 1", "Link_FastPort 2"};
  const Names copy = {"Link_Copy 1", "Link_Copy 2"};
  Names all = port;
  all.insert(all.end(), copy.begin(), copy.end());
  const struct {
    const char* objectClass;
    AssociationFilter filter;
    Names results;
  } cases[] = {
      {"Test_Disk", filterOf(""), all},     // each association class by itself
      {"test_bigdisk", filterOf(""), all},  // references for a superclass count
      {"Test_Base", filterOf(""), copy},    // those for a subclass do not
      {"Test_Array", filterOf(""), {}},
      {"Test_Disk", filterOf("link_PORT"), port},
      {"Test_Disk", filterOf("Link_FastPort"), fast},
      {"Test_Disk", filterOf("Link_Unserved"), {}},
      {"Test_Disk", filterOf("Test_Disk"), {}},  // no association
      {"Test_Disk",
       filterOf("", "test_fastport"),
       {"Link_Port 2", "Link_FastPort 2", "Link_Copy 2"}},
      {"Test_Disk", filterOf("", "", "disk"), port},
      {"Test_Disk", filterOf("", "", "Port"), {}},  // the other end
      {"Test_Disk", filterOf("", "", "1 \xC3\xA9"), {}},
      {"Test_Disk", filterOf("", "", "", "PORT"), port},
      {"Test_Disk", filterOf("", "", "", "Disk"), {}},  // this end
      {"Test_Disk", filterOf("", "", "", "Copy"), {}},  // the role is for another class
  };
  for (const auto& row : cases) {
    RecordingSink paths;
    RecordingSink objects;
    const CIMObjectPath object = pathOf(row.objectClass);
    EXPECT_TRUE(
        host.operations.associatorNames(context, {kNamespace, object, row.filter}, paths).ok());
    EXPECT_TRUE(
        host.operations.associators(context, {kNamespace, object, row.filter, {}}, objects).ok());
    EXPECT_EQ(keysOf(paths.names), row.results) << &row - cases;
    EXPECT_EQ(objects.names, row.results) << &row - cases;
  }
}

TEST_F(Associations, EndAsOnAServer) {
  const struct {
    const char* association;
    const char* status;
    std::size_t results;
  } cases[] = {
      {"Link_NoComplete", "0 ", 0},
      {"Link_ThrowsNotSupported", "0 ", 0},
      {"Link_ThrowsCim", "2 not for you", 0},
      {"Link_Class", "1 dynamic cast failed", 0},
      {"Link_Echo", "0 ", 1},
      {"", "2 not for you", 0},  // the first that fails takes the others back
      {"Link_Missing", "4 Link_Missing", 0},
  };
  for (const auto& row : cases) {
    sink.names.clear();
    EXPECT_EQ(associators("Test_Odd", filterOf(row.association)), row.status) << row.association;
    EXPECT_EQ(sink.names.size(), row.results) << row.association;
  }
}

TEST_F(Associations, ProvidersSeeTheServedClassAndTheClientsWords) {
  EXPECT_EQ(associators("TEST_odd", filterOf("link_ECHO", "", "ODD", "port")), "0 ");
  EXPECT_EQ(associators("TEST_odd", filterOf("LINK_echo", "test_port")), "0 ");
  EXPECT_THAT(sink.names,
              ElementsAre("TEST_odd|Link_Echo||ODD|port", "TEST_odd|Link_Echo|test_port||"));
}

TEST_F(Associations, ResultsAreCompletedAndSelected) {
  InstanceSelection selection;
  selection.propertyList = listOf({"Size"});
  selection.localOnly = true;
  EXPECT_EQ(associators("Test_Disk", filterOf("Link_FastPort"), selection), "0 ");
  ASSERT_EQ(sink.instances.size(), 2u);
  EXPECT_EQ(toUtf8(sink.instances[1].getPath().toString()),
            "//" + toUtf8(host.operations.hostName()) +
                "/root/test:Test_FastPort.Name=\"Link_FastPort 2\"");
  EXPECT_EQ(sink.instances[1].getPropertyCount(), 1u);
  EXPECT_EQ(sink.instances[1].findProperty(CIMName("Size")), 0u);
}

TEST_F(Associations, EachAssociationClassIsAskedForItsOwnReferences) {
  const AssociationFilter notSupported = filterOf("Link_ThrowsNotSupported");
  EXPECT_EQ(references("Test_Odd", notSupported), "0 ");
  EXPECT_EQ(referenceNames("Test_Odd", notSupported), "0 ");
  EXPECT_THAT(sink.names, IsEmpty());
  EXPECT_EQ(references("Test_Disk", filterOf("Link_Port", "", "disk")), "0 ");
  EXPECT_THAT(sink.names,
              ElementsAre("Test_Disk|Link_Port||disk|", "Test_Disk|Link_FastPort||disk|"));
  sink.names.clear();
  EXPECT_EQ(referenceNames("Test_Disk", filterOf("Link_Port")), "0 ");
  EXPECT_THAT(keysOf(sink.names), ElementsAre("link", "link"));
}

TEST_F(Associations, RequestsThatCannotBeAnswered) {
  const auto codeOf = [&](TestHost& asked, const char* nameSpace, const char* object) {
    return asked.operations
        .associatorNames(context, {CIMNamespaceName(nameSpace), CIMObjectPath(String(object)), {}},
                         sink)
        .code;
  };
  EXPECT_EQ(codeOf(host, "root/nowhere", "Test_Disk.Name=\"a\""), CIM_ERR_INVALID_NAMESPACE);
  EXPECT_EQ(codeOf(host, "root/test", "Test_Missing.Name=\"a\""), CIM_ERR_INVALID_PARAMETER);
  EXPECT_EQ(codeOf(host, "root/test", "Test_Disk"), CIM_ERR_NOT_SUPPORTED);
  TestHost bare("Bare");
  EXPECT_EQ(codeOf(bare, "root/test", "Test_Disk.Name=\"a\""), CIM_ERR_SUCCESS);
  EXPECT_THAT(sink.names, IsEmpty());
}

}  // namespace
