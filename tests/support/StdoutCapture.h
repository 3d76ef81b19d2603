#pragma once

#include <unistd.h>

#include <cstdio>
#include <stdexcept>
#include <string>

/// Keeps what the process writes to standard output in a temporary file, from here to text() or the
/// end of the object, which restores standard output.
class StdoutCapture {
 public:
  StdoutCapture() : file_(std::tmpfile()) {
    std::fflush(stdout);
    before_ = dup(STDOUT_FILENO);
    if (file_ == nullptr || before_ < 0 || dup2(fileno(file_), STDOUT_FILENO) < 0) {
      throw std::runtime_error("cannot capture standard output");
    }
  }

  ~StdoutCapture() {
    restore();
    std::fclose(file_);
  }

  StdoutCapture(const StdoutCapture&) = delete;
  StdoutCapture& operator=(const StdoutCapture&) = delete;

  /// Ends the capture and gives everything that was written.
  std::string text() {
    restore();
    std::string all;
    std::rewind(file_);
    char part[4096];
    for (size_t got; (got = std::fread(part, 1, sizeof part, file_)) > 0;) all.append(part, got);
    return all;
  }

 private:
  void restore() {
    if (before_ < 0) return;
    std::fflush(stdout);
    dup2(before_, STDOUT_FILENO);
    close(before_);
    before_ = -1;
  }

  std::FILE* file_;
  int before_ = -1;
};
