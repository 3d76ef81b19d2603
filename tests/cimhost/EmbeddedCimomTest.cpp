#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;

OperationStatus enumerate(TestHost& host, const char* className, RecordingSink& sink) {
  return host.operations.enumerateInstances(makeContext("guest"),
                                            {kNamespace, CIMName(className), {}}, sink);
}

TEST(EmbeddedCimom, AProviderReachesItsOwnClassesThroughTheHandle) {
  TestHost host;
  RecordingSink sink;
  EXPECT_TRUE(enumerate(host, "Test_ServerDisks", sink).ok());
  EXPECT_THAT(sink.names, testing::ElementsAre("seen root/test:Test_Disk.Name=\"a\"",
                                               "seen root/test:Test_Disk.Name=\"b\"",
                                               "seen root/test:Test_BigDisk.Name=\"big\""));
}

TEST(EmbeddedCimom, EndlessRecursionFailsAndTheHostGoesOn) {
  TestHost host;
  setenv("TEST_PROVIDER_EVENTS", "", 1);
  for (int round = 0; round < 2; ++round) {
    RecordingSink sink;
    const OperationStatus status = enumerate(host, "Test_Nested", sink);
    EXPECT_EQ(status.code, CIM_ERR_FAILED);
    EXPECT_THAT(status.message, testing::HasSubstr("inside each other"));
  }
  const std::string events = getenv("TEST_PROVIDER_EVENTS");
  EXPECT_EQ(std::count(events.begin(), events.end(), ';'), 2 * (EmbeddedCimom::kMaximumDepth + 1));
}

template <class Call>
std::string errorOf(Call call) {
  const OperationStatus status = runOperation(call);
  return std::to_string(static_cast<int>(status.code)) + " " + status.message;
}

TEST(EmbeddedCimom, ErrorsAreThoseOfAServer) {
  TestHost host;
  CIMOMHandle handle;
  const OperationContext context;
  const CIMPropertyList all;
  const CIMNamespaceName nowhere("root/nowhere");
  const auto getClass = [&](const CIMNamespaceName& space, const CIMName& name) {
    return errorOf([&] { handle.getClass(context, space, name, false, true, true, all); });
  };
  const auto instances = [&](const CIMNamespaceName& space, const CIMName& name) {
    return errorOf(
        [&] { handle.enumerateInstances(context, space, name, true, false, true, true, all); });
  };
  const auto instance = [&](const char* path) {
    return errorOf([&] {
      handle.getInstance(context, kNamespace, CIMObjectPath(String(path)), false, true, true, all);
    });
  };
  EXPECT_EQ(getClass(kNamespace, CIMName("Nope")), "6 Nope");
  EXPECT_EQ(getClass(kNamespace, CIMName()), "6 ");
  EXPECT_EQ(getClass(nowhere, CIMName("Test_Disk")), "3 root/nowhere");
  EXPECT_EQ(instances(kNamespace, CIMName("Nope")), "5 Nope");
  EXPECT_EQ(instances(kNamespace, CIMName()), "5 ");
  EXPECT_EQ(instances(nowhere, CIMName("Test_Disk")), "3 root/nowhere");
  EXPECT_EQ(instance("Nope.A=1"), "5 Nope");
  EXPECT_EQ(instance("Test_Unserved.Name=\"a\""), "6 Test_Unserved.Name=\"a\"");
  EXPECT_EQ(instance("Test_BigDisk.Name=\"big\""), "0 ");
}

TEST(EmbeddedCimom, ObjectsAreFreshEachTime) {
  TestHost host;
  CIMOMHandle handle;
  const OperationContext context;
  CIMClass first =
      handle.getClass(context, kNamespace, CIMName("TEST_disk"), false, true, true, {});
  EXPECT_EQ(toUtf8(first.getClassName().getString()), "Test_Disk");
  first.getProperty(0).setValue(CIMValue(String("changed")));
  first.removeProperty(1);
  const CIMClass second =
      handle.getClass(context, kNamespace, CIMName("Test_Disk"), false, true, true, {});
  EXPECT_EQ(second.getPropertyCount(), 2u);
  EXPECT_TRUE(second.getProperty(0).getValue().isNull());
}

}  // namespace
