#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>
#include <vector>

namespace cimhost {

/// A fixed number of threads that watch event sources and run the tasks that come of them.
///
/// The thread that was watching a source runs its tasks itself and then watches on: a short task
/// costs no change of threads, and threads of different sources share nothing. Nobody waits for a
/// long one: a spare thread looks every kTick whether a source has not been watched, or a task has
/// waited, since it last looked, and lends a hand. At most `threads` tasks run at the same time,
/// those of a source in the order in which they came; the queues before them are bounded. Tasks and
/// sources must not throw.
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

  /// `queue`: how many tasks may wait, of all sources.
  WorkerPool(std::size_t threads, std::size_t queue);
  /// As stop().
  ~WorkerPool();
  WorkerPool(const WorkerPool&) = delete;
  WorkerPool& operator=(const WorkerPool&) = delete;

  /// Once. Throws HostError.
  void start(std::vector<Source> sources);

  // From here on `source` is a place in what start() was given.
  /// False when the queue is full or the pool has been stopped; the task is dropped then. Called by
  /// the source, or anywhere else.
  bool tryPush(std::size_t source, Task task);
  /// Runs the source soon although its descriptor does not tell.
  void kick(std::size_t source);

  /// True when tasks wait because as many as may run are running.
  bool isFull() const { return waiting_ > 0 && running_ >= threadsLimit_; }
  /// Drops what waits and returns when what runs has ended and no source is watched.
  void stop();

 private:
  using Lock = std::unique_lock<std::mutex>;

  struct Watched {
    explicit Watched(Source itsSource);
    ~Watched();
    Watched(const Watched&) = delete;
    Watched& operator=(const Watched&) = delete;

    Source source;
    int kicked;                        // An eventfd.
    std::atomic<bool> polling{false};  // Kicks must be heard.
    std::atomic<bool> hurry{false};    // There is something to do, whatever the descriptor says.
    std::mutex mutex;                  // Of what follows.
    // How often it has been watched, and how many of its tasks have come and begun.
    std::uint64_t turns = 0;
    std::uint64_t come = 0;
    std::uint64_t begun = 0;
    std::deque<Task> tasks;
    bool watched = false;
    // At the spare thread's last look.
    std::uint64_t turnsSeen = 0;
    std::uint64_t comeSeen = 0;
  };

  void work();
  Watched* inNeed();
  void serve(Watched& watched);
  bool claimRun();
  void runTask(Watched& watched, Lock& lock);
  void watch(Watched& watched, Lock& lock);
  void awaitEvent(Watched& watched) const;
  void rest();
  void standBy(Lock& lock);
  void wakeStandby();
  void look();
  std::uint64_t activity();

  const std::size_t threadsLimit_;
  const std::size_t queue_;
  std::vector<std::unique_ptr<Watched>> sources_;
  std::atomic<std::size_t> waiting_{0};
  std::atomic<std::size_t> running_{0};
  std::atomic<bool> stopped_{false};
  int stopEvent_ = -1;
  // Of threads that have nothing to do. Locked before a source's mutex, never after it.
  std::mutex mutex_;
  std::condition_variable rest_;
  std::condition_variable standby_;
  std::size_t resting_ = 0;
  bool hasStandby_ = false;
  std::atomic<bool> standbySleeps_{false};
  std::vector<std::thread> threads_;
};

}  // namespace cimhost
