#pragma once

#include <array>
#include <ostream>
#include <streambuf>

namespace cimhost {

/// Writes to a file descriptor that it owns.
class DescriptorBuffer final : public std::streambuf {
 public:
  explicit DescriptorBuffer(int descriptor);
  ~DescriptorBuffer() override;
  DescriptorBuffer(const DescriptorBuffer&) = delete;
  DescriptorBuffer& operator=(const DescriptorBuffer&) = delete;

 protected:
  int_type overflow(int_type character) override;
  int sync() override;

 private:
  int descriptor_;
  std::array<char, 8192> buffer_;
};

/// Keeps the program's results apart from what a provider prints: takes the process's standard
/// output over and points file descriptor 1 elsewhere, to /dev/null or with `trace` to standard
/// error.
///
/// Create it before the provider is loaded, and only once: descriptor 1 is not given back.
class ResultStream {
 public:
  /// Throws HostError when a descriptor cannot be had.
  explicit ResultStream(bool trace);
  std::ostream& stream() { return stream_; }

 private:
  DescriptorBuffer buffer_;
  std::ostream stream_;
};

}  // namespace cimhost
