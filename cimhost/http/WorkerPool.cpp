#include "cimhost/http/WorkerPool.h"

#include "cimhost/HostError.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <string>
#include <system_error>
#include <utility>

namespace cimhost {

namespace {

int openEvent() {
  const int descriptor = eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK);
  if (descriptor < 0) throw HostError(std::string("eventfd: ") + std::strerror(errno));
  return descriptor;
}

// After as many ticks without work the spare thread sleeps until there is some.
constexpr int kQuietTicks = 100;

}  // namespace

WorkerPool::WorkerPool(std::size_t threads, std::size_t queue)
    : threadsLimit_(threads), queue_(queue) {}

WorkerPool::~WorkerPool() {
  stop();
  for (const Watched& each : sources_) close(each.kicked);
  if (stopEvent_ >= 0) close(stopEvent_);
}

void WorkerPool::start(std::vector<Source> sources) {
  stopEvent_ = openEvent();
  sources_.reserve(sources.size());
  for (Source& source : sources) {
    sources_.emplace_back();
    sources_.back().kicked = openEvent();
    sources_.back().source = std::move(source);
  }
  // All tasks may take their time, and every source is watched still, and one is spare.
  const std::size_t count = threadsLimit_ + sources_.size() + 1;
  try {
    for (std::size_t i = 0; i < count; ++i) threads_.emplace_back([this] { work(); });
  } catch (const std::system_error& problem) {
    stop();
    throw HostError(std::string("cannot start a thread: ") + problem.what());
  }
}

bool WorkerPool::tryPush(Task task) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (stopped_ || tasks_.size() >= queue_) return false;
  tasks_.push_back(std::move(task));
  if (standbySleeps_) standby_.notify_one();
  return true;
}

bool WorkerPool::isFull() {
  const Lock lock(mutex_);
  return !tasks_.empty() && running_ >= threadsLimit_;
}

void WorkerPool::kick(std::size_t index) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (index >= sources_.size()) return;
  Watched& watched = sources_[index];
  if (std::exchange(watched.hurry, true)) return;
  if (watched.polling) eventfd_write(watched.kicked, 1);
}

void WorkerPool::stop() {
  std::deque<Task> dropped;
  {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (std::exchange(stopped_, true)) return;
    dropped.swap(tasks_);
  }
  if (stopEvent_ >= 0) eventfd_write(stopEvent_, 1);
  rest_.notify_all();
  standby_.notify_all();
  for (std::thread& thread : threads_) thread.join();
}

void WorkerPool::work() {
  Lock lock(mutex_);
  while (!stopped_) {
    // Whoever is going to be busy leaves a spare one behind.
    if (!hasStandby_ && resting_ > 0) rest_.notify_one();
    if (hasTask()) {
      runTask(lock);
    } else if (Watched* source = unwatched()) {
      watch(*source, lock);
    } else {
      rest(lock);
    }
  }
}

WorkerPool::Watched* WorkerPool::unwatched() {
  const auto found = std::find_if(sources_.begin(), sources_.end(),
                                  [](const Watched& each) { return !each.busy; });
  return found == sources_.end() ? nullptr : &*found;
}

void WorkerPool::runTask(Lock& lock) {
  Task task = std::move(tasks_.front());
  tasks_.pop_front();
  ++running_;
  ++begun_;
  if (standbySleeps_) standby_.notify_one();
  lock.unlock();
  task();
  task = nullptr;
  lock.lock();
  --running_;
}

void WorkerPool::watch(Watched& watched, Lock& lock) {
  watched.busy = true;
  ++watched.turns;
  watched.polling = !watched.hurry;
  if (watched.polling) {
    lock.unlock();
    awaitEvent(watched);
    lock.lock();
    watched.polling = false;
  }
  watched.hurry = false;
  lock.unlock();
  watched.source.run();
  lock.lock();
  watched.busy = false;
}

void WorkerPool::awaitEvent(const Watched& watched) const {
  pollfd entries[] = {{watched.source.descriptor(), POLLIN, 0},
                      {watched.kicked, POLLIN, 0},
                      {stopEvent_, POLLIN, 0}};
  poll(entries, 3, static_cast<int>(watched.source.due().count()));
  eventfd_t kicks = 0;
  if (entries[1].revents != 0) eventfd_read(watched.kicked, &kicks);
}

void WorkerPool::rest(Lock& lock) {
  if (hasStandby_) {
    ++resting_;
    rest_.wait(lock);
    --resting_;
    return;
  }
  hasStandby_ = true;
  standBy(lock);
  hasStandby_ = false;
}

void WorkerPool::standBy(Lock& lock) {
  lacksHands();
  std::uint64_t before = activity();
  int quiet = 0;
  while (!stopped_) {
    if (quiet < kQuietTicks) {
      standby_.wait_for(lock, kTick);
    } else {
      standbySleeps_ = true;
      standby_.wait(lock);
      standbySleeps_ = false;
      quiet = 0;
    }
    if (lacksHands()) return;
    quiet = activity() == before ? quiet + 1 : 0;
    before = activity();
  }
}

// Remembers what it saw for the next time.
bool WorkerPool::lacksHands() {
  const bool task = hasTask();
  bool lacks = std::exchange(taskSeen_, task) && task;
  for (Watched& each : sources_) {
    if (!each.busy && each.turns == each.turnsSeen) lacks = true;
    each.turnsSeen = each.turns;
  }
  return lacks;
}

std::uint64_t WorkerPool::activity() const {
  std::uint64_t sum = begun_;
  for (const Watched& each : sources_) sum += each.turns;
  return sum;
}

}  // namespace cimhost
