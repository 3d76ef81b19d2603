#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace cimhost {

/// A fixed number of threads that watch event sources and run the tasks that come of them.
///
/// The thread that was watching runs the tasks itself and then watches on: a short task costs no
/// change of threads. Nobody waits for a long one: one spare thread looks every kTick whether
/// nobody has watched a source since it last looked, or tasks still wait, and lends a hand. At most
/// `threads` tasks run at the same time, in the order in which they came; the queue before them is
/// bounded. Tasks and sources must not throw.
class WorkerPool {
 public:
  using Task = std::function<void()>;

  /// Something that is watched by one thread at a time.
  struct Source {
    /// Readable when run() has something to do; negative: only time and kicks count.
    std::function<int()> descriptor;
    std::function<std::chrono::milliseconds()> due;  ///< How long run() can wait without it.
    std::function<void()> run;                       ///< Must not wait.
  };

  static constexpr std::chrono::milliseconds kTick{1};

  WorkerPool(std::size_t threads, std::size_t queue);
  /// As stop().
  ~WorkerPool();
  WorkerPool(const WorkerPool&) = delete;
  WorkerPool& operator=(const WorkerPool&) = delete;

  /// Once. Throws HostError.
  void start(std::vector<Source> sources);
  /// False when the queue is full or the pool has been stopped; the task is dropped then. Called by
  /// a source, or anywhere else.
  bool tryPush(Task task);
  /// True when tasks wait because as many as may run are running.
  bool isFull();
  /// Runs a source soon although its descriptor does not tell. `index`: its place in start().
  void kick(std::size_t index);
  /// Drops what waits and returns when what runs has ended and no source is watched.
  void stop();

 private:
  using Lock = std::unique_lock<std::mutex>;

  struct Watched {
    Source source;
    int kicked = -1;  // An eventfd.
    bool busy = false;
    bool polling = false;     // Kicks must be heard.
    bool hurry = false;       // There is something to do, whatever the descriptor says.
    std::uint64_t turns = 0;  // How often somebody began to watch it.
    std::uint64_t turnsSeen = 0;
  };

  void work();
  bool hasTask() const { return !tasks_.empty() && running_ < threadsLimit_; }
  Watched* unwatched();
  void runTask(Lock& lock);
  void watch(Watched& watched, Lock& lock);
  void awaitEvent(const Watched& watched) const;
  void rest(Lock& lock);
  void standBy(Lock& lock);
  bool lacksHands();
  std::uint64_t activity() const;

  std::mutex mutex_;
  std::condition_variable rest_;
  std::condition_variable standby_;
  std::deque<Task> tasks_;
  std::vector<Watched> sources_;
  std::size_t threadsLimit_;
  std::size_t queue_;
  std::size_t running_ = 0;
  std::size_t resting_ = 0;
  std::uint64_t begun_ = 0;
  bool taskSeen_ = false;
  bool hasStandby_ = false;
  bool standbySleeps_ = false;
  bool stopped_ = false;
  int stopEvent_ = -1;
  std::vector<std::thread> threads_;
};

}  // namespace cimhost
