#pragma once

#include <chrono>
#include <mutex>

namespace Vaneth {

/// A recursive lock with a time-out: its owner may lock it again and unlocks it as often.
///
/// Recursive because a module's initialisation call resolves functions of the very module whose
/// lock the opening thread holds.
class Mutex {
 public:
  /// A wait without end.
  static constexpr unsigned kInfinite = 0xFFFFFFFFu;

  /// Waits at most `milliseconds`; true when the lock was taken.
  bool lock(unsigned milliseconds) {
    if (milliseconds == kInfinite) {
      mutex_.lock();
      return true;
    }
    return mutex_.try_lock_for(std::chrono::milliseconds(milliseconds));
  }

  void unlock() { mutex_.unlock(); }

 private:
  std::recursive_timed_mutex mutex_;
};

}  // namespace Vaneth
