#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace cimhost {

/// A fixed number of threads that run tasks in the order in which they came, and a bounded queue
/// before them. Tasks must not throw.
class WorkerPool {
 public:
  using Task = std::function<void()>;

  WorkerPool(std::size_t threads, std::size_t queue);
  /// As stop().
  ~WorkerPool();
  WorkerPool(const WorkerPool&) = delete;
  WorkerPool& operator=(const WorkerPool&) = delete;

  /// False when the queue is full or the pool has been stopped; the task is dropped then.
  bool tryPush(Task task);
  /// Drops what waits and returns when what runs has ended.
  void stop();

 private:
  void work();

  std::mutex mutex_;
  std::condition_variable some_;
  std::deque<Task> tasks_;
  std::size_t queue_;
  bool stopped_ = false;
  std::vector<std::thread> threads_;
};

}  // namespace cimhost
