#include "cimhost/mof/MofSource.h"

#include "cimhost/mof/Printable.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <string_view>
#include <system_error>

namespace cimhost {
namespace {

constexpr std::size_t kMaxFileSize = std::size_t{64} << 20;
constexpr std::size_t kMaxCaretColumn = 80;
constexpr std::size_t kMaxSourceLength = 160;

class Descriptor {
 public:
  explicit Descriptor(int fd) : fd_(fd) {}
  ~Descriptor() {
    if (fd_ >= 0) close(fd_);
  }
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;
  int get() const { return fd_; }

 private:
  int fd_;
};

[[noreturn]] void failWithErrno() {
  throw std::runtime_error(std::generic_category().message(errno));
}

void checkFile(int fd) {
  struct stat status {};
  if (fstat(fd, &status) != 0) failWithErrno();
  if (S_ISDIR(status.st_mode)) throw std::runtime_error("is a directory, not a file");
  if (!S_ISREG(status.st_mode)) throw std::runtime_error("is not a regular file");
}

std::string readAll(int fd) {
  std::string text;
  char block[65536];
  for (;;) {
    const ssize_t count = read(fd, block, sizeof block);
    if (count < 0 && errno == EINTR) continue;
    if (count < 0) failWithErrno();
    if (count == 0) return text;
    text.append(block, static_cast<std::size_t>(count));
    if (text.size() > kMaxFileSize) throw std::runtime_error("is larger than 64 MiB");
  }
}

// Fills `source` and `caret`, keeping a window around `place` of a long line.
void quoteLine(MofDiagnostic& diagnostic, std::string_view line, std::size_t place) {
  std::size_t offset = 0;
  if (place > kMaxCaretColumn) {
    offset = place - kMaxCaretColumn;
    while (offset < place && (static_cast<unsigned char>(line[offset]) & 0xC0) == 0x80) ++offset;
    diagnostic.source = "...";
    diagnostic.caret = 3;
  }
  const std::size_t end = std::min(line.size(), offset + kMaxSourceLength);
  bool reached = false;
  while (offset < end) {
    reached = reached || offset >= place;
    diagnostic.caret += reached ? 0 : 1;
    offset += appendPrintable(diagnostic.source, line, offset);
  }
  ++diagnostic.caret;
  if (end < line.size()) diagnostic.source += "...";
}

}  // namespace

MofDiagnostic MofSource::diagnosticAt(std::size_t offset, const std::string& message) const {
  const std::string_view all(text);
  offset = std::min(offset, all.size());
  const std::string_view before = all.substr(0, offset);
  const std::size_t newline = before.rfind('\n');
  const std::size_t start = newline == std::string_view::npos ? 0 : newline + 1;
  const std::string_view line = all.substr(start, all.find_first_of("\r\n", offset) - start);
  MofDiagnostic diagnostic;
  diagnostic.file = name;
  diagnostic.line = static_cast<int>(std::count(before.begin(), before.end(), '\n')) + 1;
  diagnostic.column = static_cast<int>(offset - start) + 1;
  diagnostic.message = printable(message);  // It may quote decoded escapes.
  quoteLine(diagnostic, line, offset - start);
  return diagnostic;
}

MofSourcePtr readMofFile(const std::string& path) {
  // Without O_NONBLOCK the open of a pipe that nobody writes to would wait for ever.
  const Descriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
  if (file.get() < 0) failWithErrno();
  checkFile(file.get());
  return std::make_shared<const MofSource>(MofSource{path, readAll(file.get())});
}

}  // namespace cimhost
