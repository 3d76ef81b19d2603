#pragma once

#include "cimhost/xml/CimXmlService.h"

#include <sys/types.h>

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <functional>
#include <mutex>
#include <string>
#include <utility>

namespace cimhost {

/// A reply on its way from the thread that makes it to the one that sends it.
///
/// A reply that ends within kWholeSize bytes is handed over at once, with its length; a longer one
/// flows through a buffer of kCapacity bytes, and its maker waits while that is full. The sending
/// thread never waits: where nothing is there it calls `suspend`, and the pipe calls `wake` once
/// when it is worth looking again. Both are called with the pipe's lock held, so no wake can come
/// before its suspend.
class ReplyPipe final : public ReplyStream {
 public:
  static constexpr std::size_t kWholeSize = 64U << 10U;
  static constexpr std::size_t kCapacity = 256U << 10U;

  using Callback = std::function<void()>;
  using Clock = std::chrono::steady_clock;

  /// `wake` may be called from any thread.
  explicit ReplyPipe(Callback wake) : wake_(std::move(wake)) {}

  // The maker's side.
  void begin(int httpStatus, const HttpHeaders& headers) override;
  bool write(std::string_view bytes) override;
  void abort() override;
  /// Nothing follows. A reply that was never begun is status 500.
  void finish();

  // The sender's side.
  /// True when a status and either the whole body or its start are there; else suspends.
  bool isReady(const Callback& suspend);
  /// The whole body is there. Read once isReady() was true; does not change later.
  bool isWhole() const;
  int status() const;
  HttpHeaders takeHeaders() { return std::move(headers_); }
  std::string takeWhole();
  /// Of a reply that is not whole: at most `size` bytes; 0 and a suspend when none are there yet;
  /// kEnd, kCut.
  ssize_t read(char* bytes, std::size_t size, const Callback& suspend);
  static constexpr ssize_t kEnd = -1;
  static constexpr ssize_t kCut = -2;
  /// The client is gone: the maker's writes fail from now on.
  void close();

  // Any thread.
  /// Ends the reply before its time: with `status` when nothing has been sent, else cut off. False
  /// when it had ended already.
  bool cut(int status);
  /// True once the reply was closed or cut: nothing that is written will be read.
  bool isOver() const;
  /// True when the maker waits for room, and has waited longer than `patience`: in that time the
  /// client has taken less than half of kCapacity.
  bool isReadSlowly(Clock::duration patience) const;
  std::uint64_t bytes() const;

 private:
  void waitForRoom(std::unique_lock<std::mutex>& lock);
  void wakeSender();
  std::size_t pending() const { return filling_.size() + draining_.size() - drained_; }
  void refill();

  mutable std::mutex mutex_;
  std::condition_variable room_;
  Callback wake_;
  bool armed_ = false;  // suspended, and to be woken
  int status_ = 0;
  HttpHeaders headers_;
  std::string filling_;
  std::string draining_;  // Of the sender, from drained_ on.
  std::size_t drained_ = 0;
  bool taken_ = false;  // the sender has decided how it sends
  bool streaming_ = false;
  bool finished_ = false;
  bool cut_ = false;
  bool closed_ = false;
  std::uint64_t bytes_ = 0;
  Clock::time_point waitsSince_ = Clock::time_point::max();
};

}  // namespace cimhost
