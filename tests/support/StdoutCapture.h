#pragma once

#include <gtest/gtest.h>

#include <string>

/// Keeps what the process writes to standard output, from here to text() or the end of the object,
/// which restores standard output. One at a time.
class StdoutCapture {
 public:
  StdoutCapture() { testing::internal::CaptureStdout(); }
  ~StdoutCapture() { text(); }
  StdoutCapture(const StdoutCapture&) = delete;
  StdoutCapture& operator=(const StdoutCapture&) = delete;

  /// Ends the capture and gives everything that was written.
  std::string text() {
    const bool ends = isOpen_;
    isOpen_ = false;
    return ends ? testing::internal::GetCapturedStdout() : std::string();
  }

 private:
  bool isOpen_ = true;
};
