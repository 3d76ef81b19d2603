#pragma once

#include <charconv>
#include <cstdio>
#include <cstring>
#include <string_view>

/// A trace text for standard output, put together without printf and written in one piece when the
/// object goes (in several when it is longer than the buffer).
///
/// These traces are written for every pair of instances, whatever the log level: they must be
/// cheap.
class TraceLine {
 public:
  TraceLine() { buffer_[0] = '\0'; }
  TraceLine(const TraceLine&) = delete;
  TraceLine& operator=(const TraceLine&) = delete;
  ~TraceLine() { flush(); }

  TraceLine& operator<<(std::string_view text) {
    if (text.size() > sizeof buffer_ - used_) {
      flush();
      if (text.size() > sizeof buffer_) {
        std::fwrite(text.data(), 1, text.size(), stdout);
        return *this;
      }
    }
    std::memcpy(buffer_ + used_, text.data(), text.size());
    used_ += text.size();
    return *this;
  }

  TraceLine& operator<<(int number) {
    char digits[16];
    const auto end = std::to_chars(digits, digits + sizeof digits, number).ptr;
    return *this << std::string_view(digits, static_cast<size_t>(end - digits));
  }

 private:
  void flush() {
    if (used_ != 0) std::fwrite(buffer_, 1, used_, stdout);
    used_ = 0;
  }

  size_t used_ = 0;
  char buffer_[240];
};
