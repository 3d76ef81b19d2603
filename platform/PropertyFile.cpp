#include "platform/PropertyFile.h"

#include "platform/StringConverters.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <sstream>

namespace Vaneth {
namespace {

constexpr off_t kMaxSize = off_t{1024} * 1024;

class Descriptor {
 public:
  // Non-blocking, so that a FIFO in the file's place cannot stop the process.
  explicit Descriptor(const std::string& name)
      : fd_(::open(name.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)) {}
  ~Descriptor() {
    if (fd_ >= 0) ::close(fd_);
  }
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;
  int get() const { return fd_; }

 private:
  int fd_;
};

std::string readWhole(const std::string& name) {
  Descriptor file(name);
  struct stat status {};
  if (file.get() < 0 || fstat(file.get(), &status) != 0 || !S_ISREG(status.st_mode) ||
      status.st_size > kMaxSize) {
    throw PropertyFileError("cannot read " + name);
  }
  std::string text(static_cast<size_t>(status.st_size), '\0');
  size_t used = 0;
  while (used < text.size()) {
    const ssize_t got = ::read(file.get(), &text[used], text.size() - used);
    if (got <= 0) break;
    used += static_cast<size_t>(got);
  }
  text.resize(used);
  return text;
}

std::string trimmed(const std::string& text) {
  static const char kBlanks[] = " \t\r\v\f";
  const size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string::npos) return std::string();
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

}  // namespace

void PropertyFile::open(int mode) {
  if (mode != kReadExisting) throw PropertyFileError("unsupported mode");
  values_.clear();
  std::string text = readWhole(path_.getName());
  if (text.compare(0, 3, "\xEF\xBB\xBF") == 0) text.erase(0, 3);  // byte order mark
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) addLine(trimmed(line));
  isOpen_ = true;
}

void PropertyFile::addLine(const std::string& line) {
  if (line.empty() || line[0] == '#' || line[0] == ';' || line[0] == '[') return;
  const size_t equals = line.find('=');
  if (equals == std::string::npos) return;
  values_[make_wstring(trimmed(line.substr(0, equals)))] =
      make_wstring(trimmed(line.substr(equals + 1)));
}

std::wstring PropertyFile::getValue(const std::wstring& key) const {
  const auto found = values_.find(key);
  if (!isOpen_ || found == values_.end()) throw PropertyFileError("no such key");
  return found->second;
}

void PropertyFile::close() {
  isOpen_ = false;
  values_.clear();
}

}  // namespace Vaneth
