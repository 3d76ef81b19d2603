#include "cimhost/http/FailureDelays.h"

#include <algorithm>

namespace cimhost {

namespace {

FailureDelays::Duration distance(int failures) {
  constexpr int kDoublings = 4;
  static_assert(FailureDelays::kFirstDelay * (1 << kDoublings) == FailureDelays::kLastDelay);
  const int doublings = std::min(failures - FailureDelays::kFreeFailures, kDoublings);
  return FailureDelays::kFirstDelay * (1 << doublings);
}

}  // namespace

std::optional<FailureDelays::Duration> FailureDelays::reserve(const std::string& address,
                                                              Clock::time_point now) {
  const std::lock_guard<std::mutex> lock(mutex_);
  const auto found = entries_.find(address);
  if (found == entries_.end()) return Duration(0);
  Entry& entry = found->second;
  if (now - entry.last > kMemory) entry = {};
  if (entry.failures < kFreeFailures) return Duration(0);
  const Clock::time_point turn = std::max(now, entry.nextTurn);
  const auto wait = std::chrono::duration_cast<Duration>(turn - now);
  if (wait > kLongestWait) return std::nullopt;
  entry.nextTurn = turn + distance(entry.failures);
  entry.last = now;
  return wait;
}

void FailureDelays::failed(const std::string& address, Clock::time_point now) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (entries_.count(address) == 0) makeRoom(now);
  Entry& entry = entries_[address];
  if (now - entry.last > kMemory) entry = {};
  if (entry.failures < kFreeFailures + 16) ++entry.failures;
  if (entry.failures >= kFreeFailures) {
    entry.nextTurn = std::max(entry.nextTurn, now + distance(entry.failures));
  }
  entry.last = now;
}

void FailureDelays::succeeded(const std::string& address) {
  const std::lock_guard<std::mutex> lock(mutex_);
  entries_.erase(address);
}

std::size_t FailureDelays::size() const {
  const std::lock_guard<std::mutex> lock(mutex_);
  return entries_.size();
}

void FailureDelays::makeRoom(Clock::time_point now) {
  if (entries_.size() < kAddresses) return;
  auto oldest = entries_.end();
  for (auto each = entries_.begin(); each != entries_.end();) {
    if (now - each->second.last > kMemory) {
      each = entries_.erase(each);
      continue;
    }
    if (oldest == entries_.end() || each->second.last < oldest->second.last) oldest = each;
    ++each;
  }
  if (entries_.size() >= kAddresses) entries_.erase(oldest);
}

}  // namespace cimhost
