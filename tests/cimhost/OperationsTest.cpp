#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

struct EnumerationCase {
  const char* className;
  int code;
  const char* message;
  std::vector<std::string> names;
};

std::ostream& operator<<(std::ostream& out, const EnumerationCase& row) {
  return out << row.className;
}

class Enumeration : public testing::TestWithParam<EnumerationCase> {};

TEST_P(Enumeration, DeliversWhatAServerWould) {
  TestHost host;
  RecordingSink sink;
  const OperationStatus status = host.operations.enumerateInstances(
      makeContext("guest"), {kNamespace, CIMName(GetParam().className), {}}, sink);
  EXPECT_EQ(status.code, GetParam().code);
  EXPECT_EQ(status.message, GetParam().message);
  EXPECT_EQ(sink.names, GetParam().names);
}

INSTANTIATE_TEST_SUITE_P(
    Behaviours, Enumeration,
    testing::Values(EnumerationCase{"Test_BigDisk", 0, "", {"big"}},
                    EnumerationCase{"Test_Disk", 0, "", {"a", "b", "big"}},
                    EnumerationCase{
                        "Test_Base", 0, "", {"a", "b", "big"}},  // only subclasses are served
                    EnumerationCase{"Test_Unserved", 0, "", {}},
                    EnumerationCase{"Test_Array", 0, "", {"x", "y"}},
                    EnumerationCase{"Test_Nothing", 0, "", {}},
                    EnumerationCase{"Test_OnlyCompletes", 0, "", {}},
                    EnumerationCase{"Test_NoComplete", 0, "", {}},
                    EnumerationCase{"Test_LateDelivery", 0, "", {"a"}},
                    EnumerationCase{"Test_TwoBatches", 0, "", {"b"}},
                    EnumerationCase{"Test_ThrowsCim", 2, "not for you", {}},
                    EnumerationCase{"Test_ThrowsSuccess", 1, "odd", {}},
                    EnumerationCase{"Test_ThrowsOddCode", 1, "odd", {}},
                    EnumerationCase{"Test_ThrowsNotSupported", 0, "", {}},
                    EnumerationCase{"Test_ThrowsPegasus", 1, "The CIM name is not valid: 1x", {}},
                    EnumerationCase{"Test_ThrowsStd", 1, "std \xEF\xBF\xBD", {}},
                    EnumerationCase{"Test_ThrowsInt", 1, "Unknown error.", {}},
                    EnumerationCase{"Test_Uninitialized", 1, "uninitialized object", {}},
                    EnumerationCase{"Test_Missing", 5, "Test_Missing", {}}),
    [](const auto& row) { return std::string(row.param.className); });

struct SingleCase {
  const char* className;
  int code;
  const char* message;
};

std::ostream& operator<<(std::ostream& out, const SingleCase& row) {
  return out << row.className;
}

class GetInstance : public testing::TestWithParam<SingleCase> {};

TEST_P(GetInstance, EndsAsAServerWould) {
  TestHost host;
  RecordingSink sink;
  const CIMObjectPath path(String(std::string(GetParam().className).c_str()) + ".Name=\"a\"");
  const OperationStatus status =
      host.operations.getInstance(makeContext("guest"), {kNamespace, path, {}}, sink);
  EXPECT_EQ(status.code, GetParam().code);
  EXPECT_THAT(status.message, HasSubstr(GetParam().message));
  EXPECT_EQ(sink.names.size(), GetParam().code == 0 ? 1u : 0u);
}

INSTANTIATE_TEST_SUITE_P(
    Behaviours, GetInstance,
    testing::Values(SingleCase{"Test_BigDisk", 0, ""},
                    SingleCase{"Test_Disk", 1, "Too many objects delivered."},
                    SingleCase{"Test_Array", 1, "Too many objects delivered."},
                    SingleCase{"Test_OnlyCompletes", 1, "Too few objects delivered."},
                    SingleCase{"Test_Nothing", 1, "did not complete"},
                    SingleCase{"Test_NoComplete", 1, "did not complete"},
                    SingleCase{"Test_ThrowsNotSupported", 7, "no"},
                    SingleCase{"Test_ThrowsCim", 2, "not for you"},
                    SingleCase{"Test_ThrowsInt", 1, "Unknown error."},
                    SingleCase{"Test_Uninitialized", 1, "uninitialized object"},
                    SingleCase{"Test_Unserved", 6, "Test_Unserved.Name=\"a\""},
                    SingleCase{"Test_Missing", 5, "Test_Missing"}),
    [](const auto& row) { return std::string(row.param.className); });

OperationStatus enumerate(TestHost& host, const char* className, const InstanceSelection& selection,
                          RecordingSink& sink) {
  return host.operations.enumerateInstances(makeContext("guest"),
                                            {kNamespace, CIMName(className), selection}, sink);
}

TEST(Operations, LargeResultsStreamInOrder) {
  TestHost host;
  RecordingSink sink;
  EXPECT_TRUE(enumerate(host, "Test_Many", {}, sink).ok());
  ASSERT_EQ(sink.names.size(), 2500u);
  for (std::size_t i = 0; i < sink.names.size(); ++i) EXPECT_EQ(sink.names[i], std::to_string(i));
}

TEST(Operations, WhatWasStreamedStaysButTheRestOfAFailedCallIsLost) {
  TestHost host;
  RecordingSink incomplete;
  EXPECT_TRUE(enumerate(host, "Test_ManyNoComplete", {}, incomplete).ok());
  EXPECT_EQ(incomplete.names.size(), DeliveryBuffer<CIMInstance>::kLimit + 1);
  RecordingSink failed;
  EXPECT_EQ(enumerate(host, "Test_ManyThrows", {}, failed).message, "in the middle");
  EXPECT_EQ(failed.names.size(), DeliveryBuffer<CIMInstance>::kLimit + 1);
}

class FailingSink : public InstanceSink {
 public:
  bool deliverInstance(const CIMInstance&) override {
    ++calls;
    throw std::runtime_error("client gone");
  }
  int calls = 0;
};

TEST(Operations, ASinksExceptionReachesTheStatusAndNotTheProvider) {
  TestHost host;
  unsetenv("TEST_PROVIDER_EVENTS");
  FailingSink sink;
  const OperationStatus status = host.operations.enumerateInstances(
      makeContext("guest"), {kNamespace, CIMName("Test_Swallows"), {}}, sink);
  EXPECT_EQ(status.message, "client gone");
  EXPECT_EQ(sink.calls, 1);
  EXPECT_EQ(getenv("TEST_PROVIDER_EVENTS"), nullptr);
}

TEST(Operations, ProvidersSeeHostNamespaceAndTheClientsSpelling) {
  TestHost host;
  RecordingSink sink;
  const CIMObjectPath path("//elsewhere/root/other:Test_EchoPath.z=0x1F,A=\"1\"");
  EXPECT_TRUE(
      host.operations
          .getInstance(makeContext("guest"), {CIMNamespaceName("ROOT/test"), path, {}}, sink)
          .ok());
  ASSERT_EQ(sink.names.size(), 1u);
  EXPECT_THAT(sink.names[0],
              testing::MatchesRegex("//[^/]+/ROOT/test:Test_EchoPath\\.A=\"1\",z=0x1F"));
  EXPECT_THAT(sink.names[0], testing::Not(HasSubstr("elsewhere")));
}

TEST(Operations, PathsWithoutNamespaceGetTheRequests) {
  TestHost host;
  RecordingSink instances;
  EXPECT_TRUE(enumerate(host, "Test_NoNamespace", {}, instances).ok());
  EXPECT_EQ(toUtf8(instances.instances.at(0).getPath().toString()),
            "root/test:Test_NoNamespace.Name=\"plain\"");
  RecordingSink paths;
  EXPECT_TRUE(host.operations
                  .enumerateInstanceNames(makeContext("guest"),
                                          {kNamespace, CIMName("Test_BigDisk")}, paths)
                  .ok());
  EXPECT_THAT(paths.names, ElementsAre("root/test:Test_BigDisk.Name=\"n\"",
                                       testing::EndsWith("/root/test:Test_BigDisk")));
  RecordingSink lost;
  host.operations.enumerateInstanceNames(makeContext("guest"),
                                         {kNamespace, CIMName("Test_NoComplete")}, lost);
  EXPECT_THAT(lost.names, IsEmpty());
}

std::vector<std::string> propertyNames(const CIMInstance& instance) {
  std::vector<std::string> names;
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    const CIMConstProperty property = instance.getProperty(i);
    names.push_back(toUtf8(property.getName().getString()));
    if (property.getQualifierCount() > 0) names.back() += "+qualifiers";
    if (!property.getClassOrigin().isNull()) names.back() += "+origin";
  }
  return names;
}

CIMPropertyList listOf(const std::vector<const char*>& names) {
  Array<CIMName> list;
  for (const char* name : names) list.append(CIMName(name));
  return CIMPropertyList(list);
}

TEST(Operations, SelectionIsAppliedToWhatAProviderDelivers) {
  struct Case {
    const char* name;
    const char* className;
    InstanceSelection selection;
    std::vector<std::string> last;  // of the last instance, always of Test_BigDisk
  };
  const Case cases[] = {
      {"all", "Test_Base", {true, false, true, true, {}}, {"Name+qualifiers+origin", "Size"}},
      {"neither", "Test_Base", {true, false, false, false, {}}, {"Name", "Size"}},
      {"qualifiers", "Test_Base", {true, false, true, false, {}}, {"Name+qualifiers", "Size"}},
      {"origin", "Test_Base", {true, false, false, true, {}}, {"Name+origin", "Size"}},
      {"not deep", "Test_Base", {false, false, false, false, {}}, {"Name"}},
      {"not deep, own class", "Test_BigDisk", {false, false, false, false, {}}, {"Name", "Size"}},
      {"local", "Test_BigDisk", {true, true, false, false, {}}, {"Size"}},
      {"local to a superclass", "Test_Base", {true, true, false, false, {}}, {"Name", "Size"}},
      {"local, not deep", "Test_Disk", {false, true, false, false, {}}, {}},
      {"list", "Test_Base", {true, false, false, false, listOf({"SIZE", "Nope"})}, {"Size"}},
      {"list, not deep", "Test_Base", {false, false, false, false, listOf({"Size"})}, {}},
      {"empty list",
       "Test_Base",
       {true, false, false, false, CIMPropertyList(Array<CIMName>())},
       {}},
  };
  TestHost host;
  for (const Case& row : cases) {
    SCOPED_TRACE(row.name);
    RecordingSink sink;
    EXPECT_TRUE(enumerate(host, row.className, row.selection, sink).ok());
    ASSERT_FALSE(sink.instances.empty());
    EXPECT_EQ(propertyNames(sink.instances.back()), row.last);
  }
}

TEST(Operations, AProviderWithoutInstanceInterfaceIsNotSupported) {
  TestHost host("Bare");
  RecordingSink sink;
  const CIMObjectPath path("Test_Disk.Name=\"a\"");
  EXPECT_EQ(host.operations.getInstance(makeContext("guest"), {kNamespace, path, {}}, sink).code,
            CIM_ERR_NOT_SUPPORTED);
}

TEST(Operations, Classes) {
  TestHost host;
  RecordingSink names;
  EXPECT_TRUE(
      host.operations.enumerateClassNames({kNamespace, CIMName("test_base"), false}, names).ok());
  EXPECT_THAT(names.names, ElementsAre("Test_Unserved", "Test_Disk"));
  RecordingSink deep;
  EXPECT_TRUE(
      host.operations
          .enumerateClasses({kNamespace, CIMName("Test_Base"), true, true, true, false}, deep)
          .ok());
  EXPECT_THAT(deep.names, ElementsAre("Test_Unserved", "Test_Disk", "Test_BigDisk"));
  EXPECT_EQ(deep.classes.back().getPropertyCount(), 1u);
  RecordingSink single;
  EXPECT_TRUE(host.operations
                  .getClass({kNamespace, CIMName("TEST_bigdisk"), false, true, false, {}}, single)
                  .ok());
  EXPECT_THAT(single.names, ElementsAre("Test_BigDisk"));
  EXPECT_EQ(single.classes.at(0).getPropertyCount(), 3u);
}

TEST(Operations, MissingNamespacesAndClasses) {
  TestHost host;
  RecordingSink sink;
  const CIMNamespaceName nowhere("root/nowhere");
  const CIMName disk("Test_Disk");
  const CIMName missing("Test_Missing");
  const OperationContext context;
  const Operations& operations = host.operations;
  EXPECT_EQ(operations.enumerateInstances(context, {nowhere, disk, {}}, sink).code, 3);
  EXPECT_EQ(operations.enumerateInstances(context, {kNamespace, CIMName(), {}}, sink).code, 5);
  EXPECT_EQ(operations.enumerateInstanceNames(context, {kNamespace, missing}, sink).code, 5);
  EXPECT_EQ(operations.getClass({kNamespace, missing, true, true, false, {}}, sink).code, 6);
  EXPECT_EQ(operations.getClass({nowhere, disk, true, true, false, {}}, sink).code, 3);
  EXPECT_EQ(operations.enumerateClassNames({kNamespace, missing, true}, sink).code, 5);
  EXPECT_EQ(operations.enumerateClassNames({nowhere, CIMName(), true}, sink).code, 3);
  EXPECT_EQ(operations.enumerateClasses({nowhere, disk}, sink).message, "root/nowhere");
  EXPECT_THAT(sink.names, IsEmpty());
}

}  // namespace
