#include "cimhost/http/Housekeeper.h"

namespace cimhost {

Housekeeper::Housekeeper() : thread_([this] { work(); }) {}

Housekeeper::~Housekeeper() {
  stop();
}

void Housekeeper::at(Clock::time_point time, Task task) {
  {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (stopped_) return;
    tasks_.emplace(time, std::move(task));
  }
  changed_.notify_one();
}

void Housekeeper::stop() {
  std::multimap<Clock::time_point, Task> dropped;
  {
    const std::lock_guard<std::mutex> lock(mutex_);
    stopped_ = true;
    dropped.swap(tasks_);
  }
  changed_.notify_one();
  if (thread_.joinable()) thread_.join();
}

void Housekeeper::work() {
  std::unique_lock<std::mutex> lock(mutex_);
  while (!stopped_) {
    if (tasks_.empty()) {
      changed_.wait(lock);
    } else if (tasks_.begin()->first > Clock::now()) {
      changed_.wait_until(lock, tasks_.begin()->first);
    } else {
      auto next = tasks_.extract(tasks_.begin());
      lock.unlock();
      next.mapped()();
      next = {};  // What the task holds may come back here.
      lock.lock();
    }
  }
}

}  // namespace cimhost
