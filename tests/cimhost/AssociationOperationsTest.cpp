#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using Names = std::vector<std::string>;

AssociationFilter filterOf(const char* association, const char* result = "", const char* role = "",
                           const char* resultRole = "") {
  const auto name = [](const char* text) { return *text == '\0' ? CIMName() : CIMName(text); };
  return {name(association), name(result), String(role), String(resultRole)};
}

class Associations : public testing::Test {
 protected:
  std::string associators(const char* className, const AssociationFilter& filter,
                          const InstanceSelection& selection = {}) {
    sink = RecordingSink();
    return textOf(host.operations.associators(
        context, {kNamespace, pathOf(className), filter, selection}, sink));
  }
  Names associatorNames(const char* className, const AssociationFilter& filter) {
    RecordingSink paths;
    EXPECT_TRUE(
        host.operations.associatorNames(context, {kNamespace, pathOf(className), filter}, paths)
            .ok());
    return paths.names;
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
  const Names fastOnly = {"Link_Port 2", "Link_FastPort 2", "Link_Copy 2"};
  const struct {
    const char* objectClass;
    AssociationFilter filter;
    Names results;
  } cases[] = {
      {"test_bigdisk", filterOf(""), all},  // references for a superclass count
      {"Test_Base", filterOf(""), copy},    // those for a subclass do not
      {"Test_Array", filterOf(""), {}},
      {"Test_Disk", filterOf("link_PORT"), port},
      {"Test_Disk", filterOf("Link_FastPort"), fast},
      {"Test_Disk", filterOf("Link_Unserved"), {}},
      {"Test_Disk", filterOf("Test_Disk"), {}},  // no association
      {"Test_Disk", filterOf("", "test_fastport"), fastOnly},
      {"Test_Disk", filterOf("", "", "disk"), port},
      {"Test_Disk", filterOf("", "", "Port"), {}},  // the other end
      {"Test_Disk", filterOf("", "", "1 \xC3\xA9"), {}},
      {"Test_Disk", filterOf("", "", "", "PORT"), port},
      {"Test_Disk", filterOf("", "", "", "Disk"), {}},  // this end
      {"Test_Disk", filterOf("", "", "", "Copy"), {}},  // the role is for another class
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(&row - cases);
    EXPECT_EQ(associators(row.objectClass, row.filter), "0 ");
    EXPECT_EQ(sink.names, row.results);
    Names keys;
    for (const std::string& path : associatorNames(row.objectClass, row.filter)) {
      keys.push_back(path.substr(path.find('"') + 1, path.rfind('"') - path.find('"') - 1));
    }
    EXPECT_EQ(keys, row.results);
  }
}

TEST_F(Associations, EndAsOnAServer) {
  const struct {
    AssociationFilter filter;
    const char* status;
    Names results;
  } cases[] = {
      {filterOf("Link_NoComplete"), "0 ", {}},
      {filterOf("Link_ThrowsNotSupported"), "0 ", {}},
      {filterOf("Link_ThrowsCim"), "2 not for you", {}},
      {filterOf("Link_Class"), "1 dynamic cast failed", {}},
      {filterOf(""), "2 not for you", {}},  // the first that fails takes the others back
      {filterOf("Link_Missing"), "4 Link_Missing", {}},
      // The client's words reach the provider, with the class that is served.
      {filterOf("link_ECHO", "", "ODD", "port"), "0 ", {"TEST_odd|Link_Echo||ODD|port"}},
      {filterOf("LINK_echo", "test_port"), "0 ", {"TEST_odd|Link_Echo|test_port||"}},
  };
  for (const auto& row : cases) {
    EXPECT_EQ(associators("TEST_odd", row.filter), row.status);
    EXPECT_EQ(sink.names, row.results) << row.status;
  }
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
  const struct {
    const char* objectClass;
    AssociationFilter filter;
    Names objects, paths;
  } cases[] = {
      {"Test_Odd", filterOf("Link_ThrowsNotSupported"), {}, {}},
      {"Test_Disk",
       filterOf("Link_Port", "", "disk"),
       {"Test_Disk|Link_Port||disk|", "Test_Disk|Link_FastPort||disk|"},
       {"Link_Port.Name=\"link\"", "Link_FastPort.Name=\"link\""}},
  };
  for (const auto& row : cases) {
    RecordingSink objects;
    RecordingSink paths;
    const CIMObjectPath path = pathOf(row.objectClass);
    EXPECT_TRUE(
        host.operations.references(context, {kNamespace, path, row.filter, {}}, objects).ok());
    EXPECT_TRUE(
        host.operations.referenceNames(context, {kNamespace, path, row.filter}, paths).ok());
    EXPECT_EQ(objects.names, row.objects);
    ASSERT_EQ(paths.names.size(), row.paths.size());
    for (std::size_t i = 0; i < row.paths.size(); ++i) {
      EXPECT_THAT(paths.names[i], testing::EndsWith(row.paths[i]));
    }
  }
}

TEST_F(Associations, RequestsThatCannotBeAnswered) {
  const auto codeOf = [&](TestHost& asked, const char* nameSpace, const char* object) {
    const AssociatorNamesRequest request{nameSpace, CIMObjectPath(String(object)), {}};
    return asked.operations.associatorNames(context, request, sink).code;
  };
  EXPECT_EQ(codeOf(host, "root/nowhere", "Test_Disk.Name=\"a\""), CIM_ERR_INVALID_NAMESPACE);
  EXPECT_EQ(codeOf(host, "root/test", "Test_Missing.Name=\"a\""), CIM_ERR_INVALID_PARAMETER);
  EXPECT_EQ(codeOf(host, "root/test", "Test_Disk"), CIM_ERR_NOT_SUPPORTED);
  TestHost bare("Bare");
  EXPECT_EQ(codeOf(bare, "root/test", "Test_Disk.Name=\"a\""), CIM_ERR_SUCCESS);
}

}  // namespace
