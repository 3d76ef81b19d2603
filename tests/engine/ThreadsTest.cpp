// Several threads at the first use of modules. Run these under the thread sanitizer, too.

#include "tests/engine/PluginTest.h"

#include <atomic>
#include <functional>
#include <thread>

class Threads : public PluginTest {
 protected:
  // Runs all of `work` at once, as nearly as threads can.
  static void together(const std::vector<std::function<void()>>& work) {
    std::atomic<size_t> waiting{work.size()};
    std::vector<std::thread> threads;
    for (const auto& task : work) {
      threads.emplace_back([&waiting, &task] {
        for (--waiting; waiting != 0;) std::this_thread::yield();
        task();
      });
    }
    for (std::thread& thread : threads) thread.join();
  }
};

TEST_F(Threads, OpenAModuleOnceAndSeeItInitialised) {
  for (int round = 0; round < 20; ++round) {
    setInit("lifecycle", callText("lifecycle", "start", "getI"));
    ProviderDefFunction& twice = function("lifecycle", "twice", "getIi");
    ProviderDefFunction& list = function("lifecycle", "twiceList", "execC");
    std::atomic<int> wrong{0};
    const auto call = [&](int number) {
      for (int i = 0; i < 20; ++i) {
        Values outputs;
        if (twice.get(number).getIntValue() != 2 * number) ++wrong;
        list.exec(Values{number}, outputs);
        if (valueText(outputs) != valueText(Values{2 * number})) ++wrong;
      }
    };
    together({[&] { call(1); }, [&] { call(2); }, [&] { call(3); }, [&] { call(4); }});
    EXPECT_EQ(wrong, 0);
    EXPECT_EQ(function("lifecycle", "getStarts", "getI").get().getIntValue(), 1);
    release();
  }
}

TEST_F(Threads, ModulesWhoseInitCallsReachEachOtherDoNotBlock) {
  const auto element = [](const std::string& call) {
    return "<argument type=\"element\">" + call + "</argument>";
  };
  for (int round = 0; round < 5; ++round) {
    for (const std::string own : {"a", "b"}) {
      const std::string other = own == "a" ? "b" : "a";
      // The pause lets the other thread take the other module's lock meanwhile.
      setInit("pair_" + own,
              callText("pair_" + own, "start_" + own, "getIv",
                       element(callText("pair_" + own, "pause_" + own, "getI")) +
                           element(callText("pair_" + other, "value_" + other, "getI"))));
    }
    const auto use = [](const std::string& side) {
      return [value = getFunction("value_" + side)] { EXPECT_EQ(value->get().getIntValue(), 5); };
    };
    together({use("a"), use("b"), use("a"), use("b")});
    for (const std::string side : {"a", "b"}) {
      EXPECT_EQ(function("pair_" + side, "starts_" + side, "getI").get().getIntValue(), 1);
    }
    release();
  }
}
