#pragma once

#include <chrono>
#include <cstddef>
#include <mutex>
#include <optional>
#include <string>
#include <unordered_map>

namespace cimhost {

/// How long the next password from an address has to wait before it is looked at.
///
/// Up to kFreeFailures wrong ones cost nothing; each further one doubles the distance of attempts,
/// from kFirstDelay to kLastDelay. Attempts of one address get their turns one after the other, so
/// that many connections are no faster than one. Remembers at most kAddresses addresses, each for
/// kMemory after its last attempt. May be called from several threads.
class FailureDelays {
 public:
  using Clock = std::chrono::steady_clock;
  using Duration = std::chrono::milliseconds;

  static constexpr int kFreeFailures = 3;
  static constexpr Duration kFirstDelay{250};
  static constexpr Duration kLastDelay{4000};
  static constexpr Duration kLongestWait{15000};
  static constexpr std::chrono::minutes kMemory{15};
  static constexpr std::size_t kAddresses = 4096;

  /// An attempt's wait; nullopt when too many wait already, and nothing is reserved.
  std::optional<Duration> reserve(const std::string& address, Clock::time_point now);
  void failed(const std::string& address, Clock::time_point now);
  void succeeded(const std::string& address);
  std::size_t size() const;

 private:
  struct Entry {
    int failures = 0;
    Clock::time_point nextTurn;
    Clock::time_point last;
  };

  void makeRoom(Clock::time_point now);

  mutable std::mutex mutex_;
  std::unordered_map<std::string, Entry> entries_;
};

}  // namespace cimhost
