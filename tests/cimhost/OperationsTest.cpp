#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

OperationStatus enumerate(TestHost& host, const char* className, RecordingSink& sink,
                          const InstanceSelection& selection = {}) {
  return host.operations.enumerateInstances(makeContext("guest"),
                                            {kNamespace, CIMName(className), selection}, sink);
}

TEST(Operations, InstancesAreThoseThatAServerWouldDeliver) {
  const struct {
    const char* className;
    const char* enumerated;
    std::vector<std::string> names;
    const char* got = enumerated;  // how the status of getInstance starts; 0: one instance
  } cases[] = {
      {"Test_BigDisk", "0 ", {"big"}},
      {"Test_Disk", "0 ", {"a", "b", "big"}, "1 Too many objects delivered."},
      {"Test_Base", "0 ", {"a", "b", "big"}, "6 "},  // only subclasses are served
      {"Test_Unserved", "0 ", {}, "6 Test_Unserved.Name=\"a\""},
      {"Test_Array", "0 ", {"x", "y"}, "1 Too many objects delivered."},
      {"Test_Nothing", "0 ", {}, "1 The provider did not complete"},
      {"Test_OnlyCompletes", "0 ", {}, "1 Too few objects delivered."},
      {"Test_NoComplete", "0 ", {}, "1 The provider did not complete"},
      {"Test_LateDelivery", "0 ", {"a"}, ""},
      {"Test_TwoBatches", "0 ", {"b"}, ""},
      {"Test_ThrowsCim", "2 not for you", {}},
      {"Test_ThrowsSuccess", "1 odd", {}},
      {"Test_ThrowsOddCode", "1 odd", {}},
      {"Test_ThrowsNotSupported", "0 ", {}, "7 no"},
      {"Test_ThrowsPegasus", "1 The CIM name is not valid: 1x", {}},
      {"Test_ThrowsStd", "1 std \xEF\xBF\xBD", {}},
      {"Test_ThrowsInt", "1 Unknown error.", {}},
      {"Test_ServerDisks",
       "0 ",
       {"seen root/test:Test_Disk.Name=\"a\"", "seen root/test:Test_Disk.Name=\"b\"",
        "seen root/test:Test_BigDisk.Name=\"big\""},
       "1 Too many objects delivered."},
      {"Test_Uninitialized", "1 uninitialized object", {}},
      {"Test_Missing", "5 Test_Missing", {}},
  };
  TestHost host;
  for (const auto& row : cases) {
    SCOPED_TRACE(row.className);
    RecordingSink sink;
    EXPECT_EQ(textOf(enumerate(host, row.className, sink)), row.enumerated);
    EXPECT_EQ(sink.names, row.names);
    RecordingSink single;
    const OperationStatus status = host.operations.getInstance(
        makeContext("guest"), {kNamespace, pathOf(row.className), {}}, single);
    EXPECT_THAT(textOf(status), StartsWith(row.got));
    EXPECT_EQ(single.names.size(), status.ok() ? 1u : 0u);
  }
}

TEST(Operations, WhatWasStreamedStaysButTheRestOfAFailedCallIsLost) {
  TestHost host;
  RecordingSink whole;
  EXPECT_TRUE(enumerate(host, "Test_Many", whole).ok());
  ASSERT_EQ(whole.names.size(), 2500u);
  for (std::size_t i = 0; i < 2500; ++i) EXPECT_EQ(whole.names[i], std::to_string(i));
  RecordingSink incomplete;
  EXPECT_TRUE(enumerate(host, "Test_ManyNoComplete", incomplete).ok());
  EXPECT_EQ(incomplete.names.size(), DeliveryBuffer<CIMInstance>::kLimit + 1);
  RecordingSink failed;
  EXPECT_EQ(enumerate(host, "Test_ManyThrows", failed).message, "in the middle");
  EXPECT_EQ(failed.names.size(), DeliveryBuffer<CIMInstance>::kLimit + 1);
}

// How calls end is tested with the operations; here, what happens at the limit.
TEST(DeliveryBuffer, OverTheLimitAllThatWaitsGoesOutInOrder) {
  std::vector<int> out;
  cimhost::DeliveryBuffer<int> buffer([&out](int value) { return out.push_back(value), true; }, 3);
  buffer.deliver(1);
  buffer.complete();
  buffer.endCall();
  buffer.deliver(2);
  buffer.complete();
  buffer.deliver(3);
  EXPECT_THAT(out, ElementsAre());
  buffer.deliver(4);  // 2 waits as completed, 3 and 4 as pending.
  EXPECT_THAT(out, ElementsAre(1, 2, 3, 4));
  buffer.deliver(5);
  buffer.endCall();  // without complete()
  buffer.finish();
  EXPECT_THAT(out, ElementsAre(1, 2, 3, 4));
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
  const GetInstanceRequest request{"ROOT/test", path, {}};
  EXPECT_TRUE(host.operations.getInstance(makeContext("guest"), request, sink).ok());
  EXPECT_THAT(sink.names, ElementsAre("//" + toUtf8(host.operations.hostName()) +
                                      "/ROOT/test:Test_EchoPath.A=\"1\",z=0x1F"));
}

TEST(Operations, PathsWithoutNamespaceGetTheRequests) {
  TestHost host;
  RecordingSink instances;
  EXPECT_TRUE(enumerate(host, "Test_NoNamespace", instances).ok());
  EXPECT_EQ(toUtf8(instances.instances.at(0).getPath().toString()),
            "root/test:Test_NoNamespace.Name=\"plain\"");
  const auto pathsOf = [&host](const char* className) {
    RecordingSink paths;
    const OperationStatus status = host.operations.enumerateInstanceNames(
        makeContext("guest"), {kNamespace, CIMName(className)}, paths);
    EXPECT_TRUE(status.ok());
    return paths.names;
  };
  EXPECT_THAT(pathsOf("Test_BigDisk"), ElementsAre("root/test:Test_BigDisk.Name=\"n\"",
                                                   testing::EndsWith("/root/test:Test_BigDisk")));
  EXPECT_THAT(pathsOf("Test_NoComplete"), testing::IsEmpty());
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

TEST(Operations, SelectionIsAppliedToWhatAProviderDelivers) {
  const struct {
    const char* className;
    InstanceSelection selection;    // deep, local only, qualifiers, origin, list
    std::vector<std::string> last;  // of the last instance, always of Test_BigDisk
  } cases[] = {
      {"Test_Base", {true, false, true, true, {}}, {"Name+qualifiers+origin", "Size+origin"}},
      {"Test_Base", {true, false, true, false, {}}, {"Name+qualifiers", "Size"}},
      {"Test_Base", {true, false, false, true, {}}, {"Name+origin", "Size+origin"}},
      {"Test_BigDisk", {false, false, false, false, {}}, {"Name", "Size"}},
      {"Test_BigDisk", {true, true, false, false, {}}, {"Size"}},
      {"Test_Base", {true, true, false, false, {}}, {"Name", "Size"}},  // local to a superclass
      {"Test_Disk", {false, true, false, false, {}}, {}},
      {"Test_Base", {true, false, false, false, listOf({"SIZE", "Nope"})}, {"Size"}},
      {"Test_Base", {false, false, false, false, listOf({"Size"})}, {}},
      {"Test_Base", {true, false, false, false, listOf({})}, {}},
  };
  TestHost host;
  for (const auto& row : cases) {
    RecordingSink sink;
    EXPECT_TRUE(enumerate(host, row.className, sink, row.selection).ok());
    ASSERT_FALSE(sink.instances.empty());
    EXPECT_EQ(propertyNames(sink.instances.back()), row.last) << &row - cases;
  }
}

TEST(Operations, WhatIsNotThere) {
  TestHost host;
  TestHost bare("Bare");
  RecordingSink sink;
  const CIMNamespaceName nowhere("root/nowhere");
  const CIMName disk("Test_Disk");
  const CIMName missing("Test_Missing");
  const CIMObjectPath path = pathOf("Test_Disk");
  const OperationContext context;
  const Operations& operations = host.operations;
  EXPECT_EQ(bare.operations.getInstance(context, {kNamespace, path, {}}, sink).code, 7);
  EXPECT_EQ(bare.operations.invokeMethod(context, {kNamespace, path, "Any", {}}, sink).code, 7);
  EXPECT_EQ(operations.enumerateInstances(context, {nowhere, disk, {}}, sink).code, 3);
  EXPECT_EQ(operations.enumerateInstances(context, {kNamespace, CIMName(), {}}, sink).code, 5);
  EXPECT_EQ(operations.enumerateInstanceNames(context, {kNamespace, missing}, sink).code, 5);
  EXPECT_EQ(operations.getClass({kNamespace, missing, true, true, false, {}}, sink).code, 6);
  EXPECT_EQ(operations.enumerateClassNames({kNamespace, missing, true}, sink).code, 5);
  EXPECT_EQ(operations.enumerateClasses({nowhere, disk}, sink).message, "root/nowhere");
  EXPECT_EQ(operations.invokeMethod(context, {nowhere, path, "Any", {}}, sink).code, 3);
}

TEST(Operations, EndlessRecursionFailsAndTheHostGoesOn) {
  TestHost host;
  setenv("TEST_PROVIDER_EVENTS", "", 1);
  for (int round = 0; round < 2; ++round) {
    RecordingSink sink;
    const OperationStatus status = enumerate(host, "Test_Nested", sink);
    EXPECT_EQ(status.code, CIM_ERR_FAILED);
    EXPECT_THAT(status.message, HasSubstr("inside each other"));
  }
  const std::string events = getenv("TEST_PROVIDER_EVENTS");
  EXPECT_EQ(std::count(events.begin(), events.end(), ';'), 2 * (EmbeddedCimom::kMaximumDepth + 1));
}

TEST(Operations, ErrorsOfTheProvidersHandleAreThoseOfAServer) {
  TestHost host;
  CIMOMHandle handle;
  const OperationContext context;
  const auto instance = [&](const char* name) {
    return textOf(runOperation(
        [&] { handle.getInstance(context, kNamespace, pathOf(name), false, true, true, {}); }));
  };
  EXPECT_EQ(textOf(runOperation([&] {
              handle.getClass(context, "root/nowhere", "Test_Disk", false, true, true, {});
            })),
            "3 root/nowhere");
  EXPECT_EQ(instance("Nope"), "5 Nope");
  EXPECT_EQ(instance("Test_Unserved"), "6 Test_Unserved.Name=\"a\"");
  EXPECT_EQ(instance("Test_BigDisk"), "0 ");
}

}  // namespace
