#include "cimhost/http/WorkerPool.h"

#include "cimhost/HostError.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <unistd.h>

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

WorkerPool::Watched::Watched(Source itsSource)
    : source(std::move(itsSource)), kicked(openEvent()) {}

WorkerPool::Watched::~Watched() {
  close(kicked);
}

WorkerPool::WorkerPool(std::size_t threads, std::size_t queue)
    : threadsLimit_(threads), queue_(queue) {}

WorkerPool::~WorkerPool() {
  stop();
  if (stopEvent_ >= 0) close(stopEvent_);
}

void WorkerPool::start(std::vector<Source> sources) {
  stopEvent_ = openEvent();
  for (Source& source : sources) {
    sources_.push_back(std::make_unique<Watched>(std::move(source)));
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

bool WorkerPool::tryPush(std::size_t source, Task task) {
  if (waiting_.fetch_add(1) >= queue_) {
    --waiting_;
    return false;
  }
  Watched& watched = *sources_[source];
  {
    const Lock lock(watched.mutex);
    if (stopped_) return false;
    watched.tasks.push_back(std::move(task));
    ++watched.come;
  }
  wakeStandby();
  return true;
}

void WorkerPool::kick(std::size_t source) {
  Watched& watched = *sources_[source];
  if (watched.hurry.exchange(true)) return;
  if (watched.polling) eventfd_write(watched.kicked, 1);
}

void WorkerPool::stop() {
  {
    const Lock lock(mutex_);
    if (stopped_.exchange(true)) return;
  }
  if (stopEvent_ >= 0) eventfd_write(stopEvent_, 1);
  rest_.notify_all();
  standby_.notify_all();
  for (const auto& each : sources_) {
    std::deque<Task> dropped;
    const Lock lock(each->mutex);
    dropped.swap(each->tasks);
  }
  for (std::thread& thread : threads_) thread.join();
}

void WorkerPool::work() {
  while (!stopped_) {
    if (Watched* watched = inNeed()) {
      serve(*watched);
    } else {
      rest();
    }
  }
}

// One that was in the same state when the spare thread last looked.
WorkerPool::Watched* WorkerPool::inNeed() {
  for (const auto& each : sources_) {
    const Lock lock(each->mutex);
    const bool forgotten = !each->watched && each->turns == each->turnsSeen;
    const bool delayed = !each->tasks.empty() && each->begun < each->comeSeen;
    if (forgotten || (delayed && running_ < threadsLimit_)) return each.get();
  }
  return nullptr;
}

// Until another thread watches it.
void WorkerPool::serve(Watched& watched) {
  {
    // Whoever may become busy leaves a spare one behind.
    const Lock lock(mutex_);
    if (!hasStandby_ && resting_ > 0) rest_.notify_one();
  }
  Lock lock(watched.mutex);
  while (!stopped_) {
    if (!watched.tasks.empty() && claimRun()) {
      runTask(watched, lock);
    } else if (!watched.watched) {
      watch(watched, lock);
    } else {
      return;
    }
  }
}

bool WorkerPool::claimRun() {
  if (running_.fetch_add(1) < threadsLimit_) return true;
  --running_;
  return false;
}

void WorkerPool::runTask(Watched& watched, Lock& lock) {
  Task task = std::move(watched.tasks.front());
  watched.tasks.pop_front();
  ++watched.begun;
  lock.unlock();
  --waiting_;
  task();
  task = nullptr;
  --running_;
  lock.lock();
}

void WorkerPool::watch(Watched& watched, Lock& lock) {
  watched.watched = true;
  ++watched.turns;
  lock.unlock();
  awaitEvent(watched);
  watched.source.run();
  lock.lock();
  watched.watched = false;
}

void WorkerPool::awaitEvent(Watched& watched) const {
  const auto due = watched.source.due();
  watched.polling = true;
  if (!watched.hurry && due.count() > 0) {
    pollfd entries[] = {{watched.source.descriptor(), POLLIN, 0},
                        {watched.kicked, POLLIN, 0},
                        {stopEvent_, POLLIN, 0}};
    poll(entries, 3, static_cast<int>(due.count()));
    eventfd_t kicks = 0;
    if (entries[1].revents != 0) eventfd_read(watched.kicked, &kicks);
  }
  watched.polling = false;
  watched.hurry = false;
}

void WorkerPool::rest() {
  Lock lock(mutex_);
  if (stopped_) return;
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
  look();
  std::uint64_t before = activity();
  int quiet = 0;
  while (!stopped_) {
    // Who does something after it says that it sleeps, wakes it.
    standbySleeps_ = quiet >= kQuietTicks;
    if (!standbySleeps_) {
      standby_.wait_for(lock, kTick);
    } else if (activity() == before) {
      standby_.wait(lock);
    }
    standbySleeps_ = false;
    if (inNeed() != nullptr) return;
    look();
    quiet = activity() == before ? quiet + 1 : 0;
    before = activity();
  }
}

void WorkerPool::wakeStandby() {
  if (!standbySleeps_) return;
  const Lock lock(mutex_);
  standby_.notify_one();
}

void WorkerPool::look() {
  for (const auto& each : sources_) {
    const Lock lock(each->mutex);
    each->turnsSeen = each->turns;
    each->comeSeen = each->come;
  }
}

std::uint64_t WorkerPool::activity() {
  std::uint64_t sum = 0;
  for (const auto& each : sources_) {
    const Lock lock(each->mutex);
    sum += each->turns + each->come + each->begun;
  }
  return sum;
}

}  // namespace cimhost
