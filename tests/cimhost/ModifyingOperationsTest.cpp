#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

#include <cstdlib>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::ElementsAre;

CIMObjectPath pathOf(const std::string& className) {
  return CIMObjectPath(String((className + ".Name=\"a\"").c_str()));
}

CIMInstance instanceOf(const std::string& className) {
  CIMInstance instance(CIMName(className.c_str()));
  instance.setPath(pathOf(className));
  return instance;
}

std::string textOf(const OperationStatus& status) {
  return std::to_string(static_cast<int>(status.code)) + " " + status.message;
}

struct Case {
  const char* className;
  const char* modified;
  const char* created;
  const char* deleted;
};

TEST(ModifyingOperations, EndAsOnAServer) {
  constexpr const char* kUnserved = "7 No provider serves class Test_Unserved";
  const Case cases[] = {
      {"Test_Disk", "0 ", "0 ", "0 "},
      {"Test_Nothing", "0 ", "0 ", "0 "},
      {"Test_OnlyCompletes", "0 ", "1 Too few objects delivered.", "0 "},
      {"Test_ThrowsCim", "2 not for you", "2 not for you", "2 not for you"},
      {"Test_ThrowsNotSupported", "7 no", "7 no", "7 no"},  // not swallowed here
      {"Test_ThrowsInt", "1 Unknown error.", "1 Unknown error.", "1 Unknown error."},
      {"Test_Unserved", kUnserved, kUnserved, kUnserved},
      {"Test_Missing", "5 Test_Missing", "5 Test_Missing", "5 Test_Missing"},
  };
  TestHost host;
  const OperationContext context;
  for (const Case& row : cases) {
    SCOPED_TRACE(row.className);
    RecordingSink sink;
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

TEST(ModifyingOperations, TheProviderGetsTheInstanceAsSent) {
  TestHost host;
  setenv("TEST_PROVIDER_EVENTS", "", 1);
  CIMInstance instance = instanceOf("test_ECHOPATH");
  instance.addProperty(CIMProperty(CIMName("Undeclared"), CIMValue(Uint8(1))));
  instance.addProperty(CIMProperty(CIMName("Size"), CIMValue(String("not a number"))));
  Array<CIMName> names;
  names.append(CIMName("Size"));
  const OperationContext context;
  EXPECT_TRUE(
      host.operations.modifyInstance(context, {kNamespace, instance, false, CIMPropertyList(names)})
          .ok());
  EXPECT_THAT(getenv("TEST_PROVIDER_EVENTS"),
              testing::MatchesRegex("//[^/]+/root/test:test_ECHOPATH\\.Name=\"a\" "
                                    "test_ECHOPATH\\.Name=\"a\" 2 Size;"));
  EXPECT_EQ(host.operations.modifyInstance(context, {kNamespace, CIMInstance(), true, {}}).code,
            CIM_ERR_FAILED);
}

struct MethodCase {
  const char* path;
  const char* method;
  const char* status;
  const char* returnValue;
};

TEST(InvokeMethod, EndsAsOnAServer) {
  const MethodCase cases[] = {
      {"Test_Disk.Name=\"a\"", "Any", "0 ", "7"},
      {"Test_Disk", "Any", "0 ", "7"},  // a class path
      {"Test_Disk", "Nothing", "0 ", "null"},
      {"Test_Disk", "OnlyCompletes", "0 ", "null"},
      {"Test_Disk", "NoComplete", "0 ", "null"},
      {"Test_Disk", "Twice", "0 ", "2"},
      {"Test_Disk", "ThrowsCim", "2 not for you", "not delivered"},
      {"Test_Disk", "ThrowsNotSupported", "7 no", "not delivered"},
      {"Test_Disk", "ThrowsInt", "1 Unknown error.", "not delivered"},
      {"Test_Disk", "Uninitialized", "1 uninitialized object", "not delivered"},
      {"Test_BigDisk", "Format", "16 Format", "not delivered"},  // served, but not its methods
      {"Test_Unserved", "format", "16 format", "not delivered"},
      {"Test_Unserved", "Nope", "17 Nope", "not delivered"},
      {"Test_Missing", "Format", "6 Test_Missing", "not delivered"},
  };
  TestHost host;
  for (const MethodCase& row : cases) {
    SCOPED_TRACE(std::string(row.path) + " " + row.method);
    RecordingSink sink;
    const OperationStatus status = host.operations.invokeMethod(
        OperationContext(), {kNamespace, CIMObjectPath(String(row.path)), CIMName(row.method), {}},
        sink);
    EXPECT_EQ(textOf(status), row.status);
    EXPECT_EQ(sink.returnValue, row.returnValue);
  }
  RecordingSink sink;
  EXPECT_EQ(
      host.operations
          .invokeMethod(OperationContext(),
                        {CIMNamespaceName("root/nowhere"), pathOf("Test_Disk"), CIMName("Any"), {}},
                        sink)
          .code,
      CIM_ERR_INVALID_NAMESPACE);
}

TEST(InvokeMethod, ParametersPassThrough) {
  TestHost host;
  RecordingSink sink;
  Array<CIMParamValue> parameters;
  parameters.append(CIMParamValue("uNdeclared", CIMValue(Uint8(5))));
  EXPECT_TRUE(host.operations
                  .invokeMethod(OperationContext(),
                                {kNamespace, pathOf("test_disk"), CIMName("Any"), parameters}, sink)
                  .ok());
  EXPECT_THAT(sink.names,
              ElementsAre("uNdeclared=5", testing::MatchesRegex(
                                              "Target=//[^/]+/root/test:test_disk\\.Name=\"a\"")));
}

TEST(ModifyingOperations, AProviderWithoutTheInterfacesIsNotSupported) {
  TestHost host("Bare");
  RecordingSink sink;
  const OperationContext context;
  EXPECT_EQ(
      host.operations.modifyInstance(context, {kNamespace, instanceOf("Test_Disk"), true, {}}).code,
      CIM_ERR_NOT_SUPPORTED);
  EXPECT_EQ(host.operations
                .invokeMethod(context, {kNamespace, pathOf("Test_Disk"), CIMName("Any"), {}}, sink)
                .code,
            CIM_ERR_NOT_SUPPORTED);
}

}  // namespace
