#include "cimhost/serve/RequestGate.h"

namespace cimhost {

RequestGate::Pass::Pass(RequestGate& gate) : gate_(gate) {
  // Either this sees that the gate is closed, or close() sees it inside.
  ++gate_.inside_;
  while (gate_.closed_) {
    gate_.leave();
    std::unique_lock<std::mutex> lock(gate_.mutex_);
    gate_.changed_.wait(lock, [this] { return !gate_.closed_; });
    ++gate_.inside_;
  }
}

RequestGate::Pass::~Pass() {
  gate_.leave();
}

void RequestGate::leave() {
  if (--inside_ > 0 || !closed_) return;
  const std::lock_guard<std::mutex> lock(mutex_);
  changed_.notify_all();
}

bool RequestGate::close(std::chrono::milliseconds time) {
  std::unique_lock<std::mutex> lock(mutex_);
  closed_ = true;
  if (changed_.wait_for(lock, time, [this] { return inside_ == 0; })) return true;
  closed_ = false;
  changed_.notify_all();
  return false;
}

void RequestGate::open() {
  const std::lock_guard<std::mutex> lock(mutex_);
  closed_ = false;
  changed_.notify_all();
}

}  // namespace cimhost
