// Operations from several threads at once; what a thread sanitizer is for.

#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

#include <atomic>
#include <thread>

namespace {

using namespace cimhost;
using namespace cimhost::test;
using namespace Pegasus;

// How many results all the operations bring, errors counted as one.
std::size_t runAll(const Operations& operations) {
  RecordingSink sink;
  std::size_t errors = 0;
  const auto count = [&errors](const OperationStatus& status) { errors += status.ok() ? 0 : 1; };
  const OperationContext context = makeContext("guest");
  const CIMObjectPath disk("Test_Disk.Name=\"a\"");
  const CIMName diskClass("Test_Disk");
  const InstanceSelection local{false, true, false, false, {}};
  CIMInstance instance(diskClass);
  instance.setPath(disk);
  count(operations.enumerateInstances(context, {kNamespace, CIMName("Test_Base"), local}, sink));
  count(
      operations.enumerateInstances(context, {kNamespace, CIMName("Test_ServerDisks"), {}}, sink));
  count(operations.enumerateInstances(context, {kNamespace, CIMName("Test_ThrowsInt"), {}}, sink));
  count(operations.enumerateInstanceNames(context, {kNamespace, diskClass}, sink));
  count(operations.getInstance(context,
                               {kNamespace, CIMObjectPath("Test_BigDisk.Name=\"big\""), {}}, sink));
  count(operations.getClass({kNamespace, diskClass, true, true, false, {}}, sink));
  count(operations.enumerateClasses({kNamespace, CIMName(), true}, sink));
  count(operations.enumerateClassNames({kNamespace, CIMName(), true}, sink));
  count(operations.modifyInstance(context, {kNamespace, instance, true, {}}));
  count(operations.createInstance(context, {kNamespace, instance}, sink));
  count(operations.deleteInstance(context, {kNamespace, disk}));
  count(operations.invokeMethod(context, {kNamespace, disk, CIMName("Any"), {}}, sink));
  count(operations.associators(context, {kNamespace, disk, {}, {}}, sink));
  count(operations.associatorNames(context, {kNamespace, disk, {}}, sink));
  count(operations.references(context, {kNamespace, disk, {}, {}}, sink));
  count(operations.referenceNames(context, {kNamespace, disk, {}}, sink));
  return sink.names.size() + 1000 * errors;
}

TEST(OperationsThreads, EveryThreadGetsTheSame) {
  TestHost host;
  const std::size_t expected = runAll(host.operations);
  EXPECT_EQ(expected / 1000, 1u);  // only Test_ThrowsInt
  std::atomic<int> different{0};
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; ++i) {
    threads.emplace_back([&] {
      for (int round = 0; round < 20; ++round) {
        if (runAll(host.operations) != expected) ++different;
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(different, 0);
}

}  // namespace
