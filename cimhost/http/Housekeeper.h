#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <map>
#include <mutex>
#include <thread>

namespace cimhost {

/// A thread that runs short tasks at their time. Tasks must not throw.
class Housekeeper {
 public:
  using Clock = std::chrono::steady_clock;
  using Task = std::function<void()>;

  Housekeeper();
  /// As stop().
  ~Housekeeper();
  Housekeeper(const Housekeeper&) = delete;
  Housekeeper& operator=(const Housekeeper&) = delete;

  /// Does nothing once stopped.
  void at(Clock::time_point time, Task task);
  /// Drops what has not run.
  void stop();

 private:
  void work();

  std::mutex mutex_;
  std::condition_variable changed_;
  std::multimap<Clock::time_point, Task> tasks_;
  bool stopped_ = false;
  std::thread thread_;
};

}  // namespace cimhost
