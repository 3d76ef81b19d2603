// All reading operations from two threads at once, over a plug-in that both open first.

#include <atomic>
#include <thread>

#include "LinkTest.h"

using namespace Pegasus;

namespace {

using Threads = LinkTest;

TEST_F(Threads, ReadingOperationsDoNotDisturbEachOther) {
  start(classes() + association("T_Link", itemsAndParts() + itemsAndVolumes()));
  StdoutCapture traces;
  const CIMObjectPath item = pathOf("root/t:T_Item.Name=\"b\"");
  const auto readAll = [&] {
    RecordingHandler handler;
    for (const char* name : {"root/t:T_Item", "root/t:T_Part", "root/t:T_Link"}) {
      provider->enumerateInstances(context, pathOf(name), false, false, CIMPropertyList(), handler);
      provider->enumerateInstanceNames(context, pathOf(name), handler);
    }
    provider->getInstance(context, item, false, false, CIMPropertyList(), handler);
    provider->associatorNames(context, item, CIMName("T_Link"), CIMName(), String(), String(),
                              handler);
    provider->associators(context, item, CIMName(), CIMName("T_Part"), String(), String(), false,
                          false, CIMPropertyList(), handler);
    return handler.events;
  };
  std::atomic<int> waiting{2};
  std::vector<std::string> seen[2];
  const auto work = [&](size_t which) {
    --waiting;
    while (waiting.load() != 0) std::this_thread::yield();
    const std::vector<std::string> first = readAll();
    for (int i = 0; i < 10; ++i) EXPECT_EQ(readAll(), first);
    seen[which] = first;
  };
  std::thread other(work, 1);
  work(0);
  other.join();
  EXPECT_EQ(seen[0], seen[1]);
  EXPECT_EQ(seen[0], readAll());
  EXPECT_GT(seen[0].size(), 20u);
}

}  // namespace
