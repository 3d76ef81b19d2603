#pragma once

#include <cstddef>

/// A buffer that is handed to a plug-in function: 1024 bytes, all zero at first, and behind them a
/// guard that shows whether the plug-in wrote past the end.
///
/// The guard is as long as the buffer; what is written beyond it cannot be noticed.
class CallBuffer {
 public:
  static constexpr size_t kSize = 1024;

  CallBuffer();
  CallBuffer(const CallBuffer&) = delete;
  CallBuffer& operator=(const CallBuffer&) = delete;

  char* begin() { return storage_; }
  char* end() { return storage_ + kSize; }

  /// False once something was written behind the 1024 bytes.
  bool isIntact() const;

 private:
  static constexpr size_t kGuard = 1024;
  static constexpr unsigned char kGuardByte = 0xA5;

  alignas(16) char storage_[kSize + kGuard];
};
