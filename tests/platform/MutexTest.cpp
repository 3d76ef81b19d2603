#include "platform/Mutex.h"

#include <gtest/gtest.h>

#include <future>

using Vaneth::Mutex;

namespace {

bool otherThreadCanLock(Mutex& mutex, unsigned milliseconds) {
  return std::async(std::launch::async,
                    [&mutex, milliseconds] {
                      const bool locked = mutex.lock(milliseconds);
                      if (locked) mutex.unlock();
                      return locked;
                    })
      .get();
}

}  // namespace

TEST(Mutex, StaysLockedUntilItsOwnerUnlockedItAsOftenAsItLocked) {
  for (const unsigned wait : {Mutex::kInfinite, 1000u, 0u}) {
#ifdef __SANITIZE_THREAD__  // It does not see pthread_mutex_clocklock take a lock.
    if (wait != Mutex::kInfinite) continue;
#endif
    Mutex mutex;
    ASSERT_TRUE(mutex.lock(wait));
    ASSERT_TRUE(mutex.lock(wait));
    EXPECT_FALSE(otherThreadCanLock(mutex, 0));
    mutex.unlock();
    EXPECT_FALSE(otherThreadCanLock(mutex, 20));
    mutex.unlock();
    EXPECT_TRUE(otherThreadCanLock(mutex, wait));
  }
}

TEST(Mutex, AnInfiniteWaitEndsWithTheUnlock) {
  Mutex mutex;
  mutex.lock(Mutex::kInfinite);
  auto waiting =
      std::async(std::launch::async, otherThreadCanLock, std::ref(mutex), Mutex::kInfinite);
  EXPECT_EQ(waiting.wait_for(std::chrono::milliseconds(20)), std::future_status::timeout);
  mutex.unlock();
  EXPECT_TRUE(waiting.get());
}
