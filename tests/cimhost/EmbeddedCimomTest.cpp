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

TEST(EmbeddedCimom, ErrorsAreThoseOfAServer) {
  TestHost host;
  CIMOMHandle handle;
  const OperationContext context;
  const CIMNamespaceName nowhere("root/nowhere");
  const auto getClass = [&](const CIMNamespaceName& space, const CIMName& name) {
    return textOf(
        runOperation([&] { handle.getClass(context, space, name, false, true, true, {}); }));
  };
  const auto instance = [&](const char* name) {
    return textOf(runOperation(
        [&] { handle.getInstance(context, kNamespace, pathOf(name), false, true, true, {}); }));
  };
  EXPECT_EQ(getClass(kNamespace, CIMName()), "6 ");
  EXPECT_EQ(getClass(nowhere, CIMName("Test_Disk")), "3 root/nowhere");
  EXPECT_EQ(instance("Nope"), "5 Nope");
  EXPECT_EQ(instance("Test_Unserved"), "6 Test_Unserved.Name=\"a\"");
  EXPECT_EQ(instance("Test_BigDisk"), "0 ");
}

}  // namespace
