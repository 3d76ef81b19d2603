#include "cimhost/ResultStream.h"

#include "cimhost/HostError.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <string>

namespace cimhost {

namespace {

[[noreturn]] void fail() {
  throw HostError(std::string("standard output: ") + std::strerror(errno));
}

int takeStandardOutput() {
  const int descriptor = fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1);
  if (descriptor < 0) fail();
  return descriptor;
}

void redirectStandardOutput(bool trace) {
  if (trace) {
    if (dup2(STDERR_FILENO, STDOUT_FILENO) < 0) fail();
    return;
  }
  const int nowhere = open("/dev/null", O_WRONLY | O_CLOEXEC);
  if (nowhere < 0 || dup2(nowhere, STDOUT_FILENO) < 0) fail();
  close(nowhere);
}

}  // namespace

DescriptorBuffer::DescriptorBuffer(int descriptor) : descriptor_(descriptor) {
  setp(buffer_.data(), buffer_.data() + buffer_.size());
}

DescriptorBuffer::~DescriptorBuffer() {
  sync();
  close(descriptor_);
}

DescriptorBuffer::int_type DescriptorBuffer::overflow(int_type character) {
  if (sync() != 0) return traits_type::eof();
  if (traits_type::eq_int_type(character, traits_type::eof()))
    return traits_type::not_eof(character);
  return sputc(traits_type::to_char_type(character));
}

int DescriptorBuffer::sync() {
  const char* next = pbase();
  while (next < pptr()) {
    const ssize_t written = write(descriptor_, next, static_cast<std::size_t>(pptr() - next));
    if (written < 0 && errno == EINTR) continue;
    if (written < 0) break;
    next += written;
  }
  const bool all = next == pptr();
  setp(buffer_.data(), buffer_.data() + buffer_.size());
  return all ? 0 : -1;
}

ResultStream::ResultStream(bool trace) : buffer_(takeStandardOutput()), stream_(&buffer_) {
  redirectStandardOutput(trace);
}

}  // namespace cimhost
