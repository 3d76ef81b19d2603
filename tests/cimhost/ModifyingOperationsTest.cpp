#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

#include <cstdlib>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::ElementsAre;

CIMInstance instanceOf(const char* className) {
  CIMInstance instance((CIMName(className)));
  instance.setPath(pathOf(className));
  return instance;
}

class ModifyingOperations : public testing::Test {
 protected:
  TestHost host;
  RecordingSink sink;
  const OperationContext context;
};

TEST_F(ModifyingOperations, EndAsOnAServer) {
  constexpr const char* kUnserved = "7 No provider serves class Test_Unserved";
  const struct {
    const char* className;
    const char* modified;
    const char* created = modified;
    const char* deleted = modified;
  } cases[] = {
      {"Test_Disk", "0 "},
      {"Test_Nothing", "0 "},
      {"Test_OnlyCompletes", "0 ", "1 Too few objects delivered.", "0 "},
      {"Test_ThrowsCim", "2 not for you"},
      {"Test_ThrowsNotSupported", "7 no"},  // not swallowed here
      {"Test_Unserved", kUnserved},
      {"Test_Missing", "5 Test_Missing"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.className);
    sink.names.clear();
    const CIMInstance instance = instanceOf(row.className);
    EXPECT_EQ(textOf(host.operations.modifyInstance(context, {kNamespace, instance, true, {}})),
              row.modified);
    EXPECT_EQ(textOf(host.operations.createInstance(context, {kNamespace, instance}, sink)),
              row.created);
    EXPECT_EQ(textOf(host.operations.deleteInstance(context, {kNamespace, pathOf(row.className)})),
              row.deleted);
    if (row.created == std::string("0 ")) {
      EXPECT_THAT(sink.names,
                  ElementsAre("root/test:" + std::string(row.className) + ".Name=\"new\""));
    }
  }
}

// As it was sent, but for the properties that the client does not want to change.
TEST_F(ModifyingOperations, TheProviderGetsTheInstanceAsSent) {
  CIMInstance instance = instanceOf("test_ECHOPATH");
  instance.addProperty(CIMProperty(CIMName("Undeclared"), CIMValue(Uint8(1))));
  instance.addProperty(CIMProperty(CIMName("Size"), CIMValue(String("not a number"))));
  const struct {
    CIMPropertyList list;
    const char* received;
  } cases[] = {{{}, "2 NULL"}, {listOf({"SIZE", "Other"}), "1 SIZE, Other"}};
  for (const auto& row : cases) {
    setenv("TEST_PROVIDER_EVENTS", "", 1);
    EXPECT_TRUE(
        host.operations.modifyInstance(context, {kNamespace, instance, false, row.list}).ok());
    EXPECT_THAT(getenv("TEST_PROVIDER_EVENTS"),
                testing::MatchesRegex("//[^/]+/root/test:test_ECHOPATH\\.Name=\"a\" "
                                      "test_ECHOPATH\\.Name=\"a\" " +
                                      std::string(row.received) + ";"));
  }
  EXPECT_EQ(instance.getPropertyCount(), 2u);
  EXPECT_EQ(host.operations.modifyInstance(context, {kNamespace, CIMInstance(), true, {}}).code,
            CIM_ERR_FAILED);
}

TEST_F(ModifyingOperations, MethodsEndAsOnAServer) {
  Array<CIMParamValue> parameters;
  parameters.append(CIMParamValue("uNdeclared", CIMValue(Uint8(5))));
  const struct {
    const char *path, *method, *status;
    const char* returnValue = "not delivered";
  } cases[] = {
      {"Test_Disk.Name=\"a\"", "Any", "0 ", "7"},
      {"Test_Disk", "Any", "0 ", "7"},  // a class path
      {"Test_Disk", "Nothing", "0 ", "null"},
      {"Test_Disk", "OnlyCompletes", "0 ", "null"},
      {"Test_Disk", "NoComplete", "0 ", "null"},
      {"Test_Disk", "Twice", "0 ", "2"},
      {"Test_Disk", "ThrowsCim", "2 not for you"},
      {"Test_Disk", "ThrowsNotSupported", "7 no"},
      {"Test_Disk", "Uninitialized", "1 uninitialized object"},
      {"Test_BigDisk", "Format", "16 Format"},  // served, but not its methods
      {"Test_Unserved", "Nope", "17 Nope"},
      {"Test_Missing", "Format", "6 Test_Missing"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(std::string(row.path) + " " + row.method);
    sink = RecordingSink();
    const InvokeMethodRequest request{kNamespace, CIMObjectPath(row.path), row.method, parameters};
    EXPECT_EQ(textOf(host.operations.invokeMethod(context, request, sink)), row.status);
    EXPECT_EQ(sink.returnValue, row.returnValue);
    if (row.returnValue != std::string("7")) continue;
    EXPECT_THAT(sink.names, ElementsAre("uNdeclared=5", testing::StartsWith("Target=//")));
  }
}

}  // namespace
