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
  Mutex mutex;
  ASSERT_TRUE(mutex.lock(Mutex::kInfinite));
  ASSERT_TRUE(mutex.lock(Mutex::kInfinite));
  EXPECT_FALSE(otherThreadCanLock(mutex, 0));
  mutex.unlock();
  EXPECT_FALSE(otherThreadCanLock(mutex, 20));
  mutex.unlock();
  EXPECT_TRUE(otherThreadCanLock(mutex, Mutex::kInfinite));
}

TEST(Mutex, ALimitedWaitTakesAFreeLock) {
#ifdef __SANITIZE_THREAD__
  GTEST_SKIP() << "the sanitizer does not see pthread_mutex_clocklock take a lock";
#endif
  Mutex mutex;
  EXPECT_TRUE(mutex.lock(0));
  EXPECT_TRUE(mutex.lock(1000));
  EXPECT_FALSE(otherThreadCanLock(mutex, 0));
  mutex.unlock();
  mutex.unlock();
  EXPECT_TRUE(otherThreadCanLock(mutex, 1000));
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
