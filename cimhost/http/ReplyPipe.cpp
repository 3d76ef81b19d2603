#include "cimhost/http/ReplyPipe.h"

#include <algorithm>

namespace cimhost {

namespace {

constexpr int kInternalError = 500;
// A sender that waits for more is woken for no less, so that small writes do not become small
// packets.
constexpr std::size_t kWorthWaking = 32U << 10U;

}  // namespace

void ReplyPipe::begin(int httpStatus, const HttpHeaders& headers) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (status_ != 0) return;
  status_ = httpStatus;
  headers_ = headers;
}

bool ReplyPipe::write(std::string_view bytes) {
  std::unique_lock<std::mutex> lock(mutex_);
  while (!bytes.empty()) {
    waitForRoom(lock);
    if (closed_ || cut_) return false;
    const std::size_t part = std::min(bytes.size(), kCapacity - pending());
    filling_.append(bytes.data(), part);
    bytes.remove_prefix(part);
    if (!streaming_ && filling_.size() > kWholeSize) streaming_ = true;
    if (streaming_ && pending() >= kWorthWaking) wakeSender();
  }
  return !closed_ && !cut_;
}

void ReplyPipe::waitForRoom(std::unique_lock<std::mutex>& lock) {
  const auto hasRoom = [this] { return closed_ || cut_ || pending() < kCapacity; };
  if (hasRoom()) return;
  waitsSince_ = Clock::now();
  room_.wait(lock, hasRoom);
  waitsSince_ = Clock::time_point::max();
}

void ReplyPipe::abort() {
  cut(kInternalError);
}

void ReplyPipe::finish() {
  const std::lock_guard<std::mutex> lock(mutex_);
  finished_ = true;
  if (status_ == 0) status_ = kInternalError;
  wakeSender();
}

bool ReplyPipe::cut(int status) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (cut_ || closed_ || (finished_ && !streaming_)) return false;
  cut_ = true;
  if (!taken_) {
    streaming_ = false;
    status_ = status;
    headers_.clear();
    filling_.clear();
  }
  room_.notify_all();
  wakeSender();
  return true;
}

void ReplyPipe::close() {
  const std::lock_guard<std::mutex> lock(mutex_);
  closed_ = true;
  armed_ = false;
  room_.notify_all();
}

bool ReplyPipe::isReady(const Callback& suspend) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (streaming_ || finished_ || cut_) {
    taken_ = true;
    return true;
  }
  suspend();
  armed_ = true;
  return false;
}

bool ReplyPipe::isWhole() const {
  const std::lock_guard<std::mutex> lock(mutex_);
  return !streaming_;
}

int ReplyPipe::status() const {
  const std::lock_guard<std::mutex> lock(mutex_);
  return status_;
}

std::string ReplyPipe::takeWhole() {
  const std::lock_guard<std::mutex> lock(mutex_);
  bytes_ = filling_.size();
  return std::move(filling_);
}

ssize_t ReplyPipe::read(char* bytes, std::size_t size, const Callback& suspend) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (cut_) return kCut;
  if (drained_ == draining_.size()) refill();
  const std::size_t part = std::min(size, draining_.size() - drained_);
  if (part > 0) {
    std::copy_n(draining_.data() + drained_, part, bytes);
    drained_ += part;
    bytes_ += part;
    if (pending() <= kCapacity / 2) room_.notify_all();
    return static_cast<ssize_t>(part);
  }
  if (finished_) return kEnd;
  suspend();
  armed_ = true;
  return 0;
}

bool ReplyPipe::isOver() const {
  const std::lock_guard<std::mutex> lock(mutex_);
  return closed_ || cut_;
}

bool ReplyPipe::isReadSlowly(Clock::duration patience) const {
  const std::lock_guard<std::mutex> lock(mutex_);
  const auto now = Clock::now();
  return now > waitsSince_ && now - waitsSince_ > patience;
}

std::uint64_t ReplyPipe::bytes() const {
  const std::lock_guard<std::mutex> lock(mutex_);
  return bytes_;
}

void ReplyPipe::wakeSender() {
  if (!armed_) return;
  armed_ = false;
  wake_();
}

void ReplyPipe::refill() {
  draining_.clear();
  drained_ = 0;
  draining_.swap(filling_);
}

}  // namespace cimhost
