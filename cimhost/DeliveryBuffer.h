#pragma once

#include <cstddef>
#include <exception>
#include <functional>
#include <iterator>
#include <utility>
#include <vector>

namespace cimhost {

/// Holds back what provider calls deliver until it is certain that it counts, and bounds how much.
///
/// One request makes one or more provider calls. What a call delivered counts once the call has
/// completed it and returned; complete() a second time replaces what the first one completed. What
/// is not completed is lost, and discard() drops everything when a call fails: a client gets all or
/// an error, as from a CIM server. This holds for up to `limit` objects per request. When more
/// wait, all that wait go out in order, completed or not, and cannot be taken back: larger results
/// stream in bounded memory, and an error then follows the objects sent before it.
///
/// `consume` returns false to stop; what it throws is kept and thrown by finish(), never into the
/// provider. One thread at a time.
template <class Object>
class DeliveryBuffer {
 public:
  using Consume = std::function<bool(const Object&)>;
  static constexpr std::size_t kLimit = 1000;

  explicit DeliveryBuffer(Consume consume, std::size_t limit = kLimit)
      : consume_(std::move(consume)), limit_(limit) {}

  void deliver(const Object& object) {
    if (stopped_) return;
    pending_.push_back(object);
    if (ready_.size() + completed_.size() + pending_.size() > limit_) flush();
  }

  void complete() {
    completed_.swap(pending_);
    pending_.clear();
  }

  /// The provider call returned: what it completed counts, the rest is lost.
  void endCall() {
    pending_.clear();
    append(ready_, completed_);
  }

  /// The provider call counts as if it had delivered nothing.
  void abandonCall() {
    completed_.clear();
    pending_.clear();
  }

  /// A provider call failed, and the request with it.
  void discard() {
    ready_.clear();
    completed_.clear();
    pending_.clear();
  }

  /// Hands out what counts. Throws what `consume` threw, now or earlier.
  void finish() {
    flush();
    if (failure_ != nullptr) std::rethrow_exception(failure_);
  }

 private:
  static void append(std::vector<Object>& target, std::vector<Object>& source) {
    target.insert(target.end(), std::make_move_iterator(source.begin()),
                  std::make_move_iterator(source.end()));
    source.clear();
  }

  void flush() {
    append(ready_, completed_);
    append(ready_, pending_);
    for (const Object& object : ready_) {
      if (!consumeOne(object)) break;
    }
    ready_.clear();
  }

  bool consumeOne(const Object& object) {
    try {
      stopped_ = stopped_ || !consume_(object);
    } catch (...) {
      failure_ = std::current_exception();
      stopped_ = true;
    }
    return !stopped_;
  }

  Consume consume_;
  std::size_t limit_;
  std::vector<Object> ready_;      // of calls that returned well
  std::vector<Object> completed_;  // of the current call
  std::vector<Object> pending_;    // of the current call, not completed
  bool stopped_ = false;
  std::exception_ptr failure_;
};

}  // namespace cimhost
