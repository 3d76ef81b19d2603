#include "cimhost/http/WorkerPool.h"

namespace cimhost {

WorkerPool::WorkerPool(std::size_t threads, std::size_t queue) : queue_(queue) {
  for (std::size_t i = 0; i < threads; ++i) threads_.emplace_back([this] { work(); });
}

WorkerPool::~WorkerPool() {
  stop();
}

bool WorkerPool::tryPush(Task task) {
  {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (stopped_ || tasks_.size() >= queue_) return false;
    tasks_.push_back(std::move(task));
  }
  some_.notify_one();
  return true;
}

void WorkerPool::stop() {
  std::deque<Task> dropped;
  {
    const std::lock_guard<std::mutex> lock(mutex_);
    stopped_ = true;
    dropped.swap(tasks_);
  }
  some_.notify_all();
  for (std::thread& thread : threads_) thread.join();
  threads_.clear();
}

void WorkerPool::work() {
  for (;;) {
    Task task;
    {
      std::unique_lock<std::mutex> lock(mutex_);
      some_.wait(lock, [this] { return stopped_ || !tasks_.empty(); });
      if (stopped_) return;
      task = std::move(tasks_.front());
      tasks_.pop_front();
    }
    task();
  }
}

}  // namespace cimhost
