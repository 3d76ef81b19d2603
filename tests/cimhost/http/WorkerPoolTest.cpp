// The threads under the HTTP server: who watches while tasks take their time.

#include "cimhost/http/WorkerPool.h"

#include <gmock/gmock.h>

#include <future>
#include <thread>

namespace {

using namespace cimhost;
using testing::ElementsAre;

bool await(const std::function<bool()>& condition) {
  for (int i = 0; i < 2000 && !condition(); ++i) {
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  return condition();
}

/// Tasks that last until it is opened, or goes.
class Gate {
 public:
  ~Gate() { open(); }

  WorkerPool::Task task() {
    return [this, opened = opened_] {
      ++begun_;
      opened.wait();
    };
  }
  bool awaitBegun(int count) const {
    return await([&] { return begun_ == count; });
  }
  void open() {
    if (!std::exchange(isOpen_, true)) open_.set_value();
  }

 private:
  std::promise<void> open_;
  std::shared_future<void> opened_ = open_.get_future().share();
  std::atomic<int> begun_{0};
  bool isOpen_ = false;
};

WorkerPool::Source countingSource(std::atomic<int>& runs) {
  return {[] { return -1; }, [] { return std::chrono::hours(1); }, [&runs] { ++runs; }};
}

TEST(WorkerPool, SourcesAreWatchedWhileAsManyTasksAsMayRunTakeTheirTime) {
  for (const int before : {0, 300}) {  // Milliseconds: the spare thread looks, or sleeps.
    SCOPED_TRACE(before);
    std::atomic<int> runs[2] = {};
    WorkerPool pool(2, 10);
    Gate gate;
    pool.start({countingSource(runs[0]), countingSource(runs[1])});
    std::this_thread::sleep_for(std::chrono::milliseconds(before));
    EXPECT_TRUE(pool.tryPush(0, gate.task()));
    EXPECT_TRUE(pool.tryPush(0, gate.task()));
    pool.kick(0);
    EXPECT_TRUE(gate.awaitBegun(2));
    EXPECT_FALSE(pool.isFull());
    EXPECT_TRUE(pool.tryPush(1, gate.task()));
    EXPECT_TRUE(pool.isFull());
    for (const std::size_t index : {0U, 1U, 0U, 1U}) {
      const int last = runs[index];
      pool.kick(index);
      EXPECT_TRUE(await([&] { return runs[index] > last; }));
    }
    EXPECT_TRUE(gate.awaitBegun(2));
    std::this_thread::sleep_for(std::chrono::milliseconds(before));
    gate.open();
    EXPECT_TRUE(gate.awaitBegun(3));
    EXPECT_FALSE(pool.isFull());
  }
}

TEST(WorkerPool, TasksKeepTheirOrderAndTheQueueItsBound) {
  std::atomic<int> runs[2] = {};
  std::vector<int> order;
  std::atomic<bool> done{false};
  WorkerPool pool(1, 2);
  Gate gate;
  pool.start({countingSource(runs[0]), countingSource(runs[1])});
  EXPECT_TRUE(pool.tryPush(0, gate.task()));
  pool.kick(0);
  EXPECT_TRUE(gate.awaitBegun(1));
  EXPECT_TRUE(pool.tryPush(1, [&order] { order.push_back(1); }));
  EXPECT_TRUE(pool.tryPush(1, [&order] { order.push_back(2); }));
  EXPECT_FALSE(pool.tryPush(0, [&order] { order.push_back(3); }));
  gate.open();
  EXPECT_TRUE(await([&] { return pool.tryPush(1, [&done] { done = true; }); }));
  EXPECT_TRUE(await([&done] { return done.load(); }));
  EXPECT_THAT(order, ElementsAre(1, 2));
}

TEST(WorkerPool, WhatWaitsIsDroppedAtTheEnd) {
  std::atomic<int> runs{0};
  std::atomic<bool> ran{false};
  WorkerPool pool(1, 10);
  Gate gate;
  pool.start({countingSource(runs)});
  EXPECT_TRUE(pool.tryPush(0, gate.task()));
  pool.kick(0);
  EXPECT_TRUE(gate.awaitBegun(1));
  const auto kept = std::make_shared<int>(0);
  EXPECT_TRUE(pool.tryPush(0, [kept, &ran] { ran = true; }));
  std::thread stopping([&pool] { pool.stop(); });
  EXPECT_TRUE(await([&kept] { return kept.use_count() == 1; }));
  EXPECT_FALSE(pool.tryPush(0, [] {}));
  gate.open();
  stopping.join();
  EXPECT_FALSE(ran);
}

}  // namespace
