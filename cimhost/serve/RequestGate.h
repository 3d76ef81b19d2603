#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <mutex>

namespace cimhost {

/// Lets requests through, any number at once, except while it is closed.
///
/// Unlike a reader-writer lock it prefers the one who closes: new requests wait as soon as it wants
/// to. Nobody may pass again from inside.
class RequestGate {
 public:
  /// A request inside, from here to the end of the object.
  class Pass {
   public:
    explicit Pass(RequestGate& gate);
    ~Pass();
    Pass(const Pass&) = delete;
    Pass& operator=(const Pass&) = delete;

   private:
    RequestGate& gate_;
  };

  /// Waits until nobody is inside; false, and the gate is open again, when that takes longer than
  /// `time`. Of one thread.
  bool close(std::chrono::milliseconds time);
  void open();

 private:
  void leave();

  std::atomic<std::size_t> inside_{0};
  std::atomic<bool> closed_{false};  // Written under the mutex.
  std::mutex mutex_;
  std::condition_variable changed_;
};

}  // namespace cimhost
