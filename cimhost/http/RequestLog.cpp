#include "cimhost/http/RequestLog.h"

#include "cimhost/HostError.h"
#include "cimhost/output/DisplayText.h"

#include <fcntl.h>
#include <limits.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <ctime>
#include <string_view>
#include <utility>

namespace cimhost {

namespace {

constexpr std::size_t kMaximumText = 200;
constexpr std::size_t kUsualLine = 256;
// Of a writer that hangs.
constexpr std::size_t kMaximumPending = 1U << 20U;

// ISO 8601, UTC, milliseconds.
std::string timeText(std::chrono::system_clock::time_point time) {
  using std::chrono::milliseconds;
  const auto sinceEpoch = std::chrono::duration_cast<milliseconds>(time.time_since_epoch());
  // The conversion takes a lock of the whole process: once a second will do.
  thread_local time_t lastSecond = -1;
  thread_local char text[32];
  const auto seconds = static_cast<time_t>(sinceEpoch.count() / 1000);
  if (seconds != lastSecond) {
    tm parts{};
    gmtime_r(&seconds, &parts);
    strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%S", &parts);
    lastSecond = seconds;
  }
  std::string fraction = std::to_string(1000 + sinceEpoch.count() % 1000);
  fraction[0] = '.';
  return text + fraction + "Z";
}

bool isPlain(const std::string& text) {
  return std::all_of(text.begin(), text.end(), [](char character) {
    return character > ' ' && character < '\x7f' && character != '"' && character != '\\';
  });
}

// No text can end its quotes, or the line.
std::string quoted(const std::string& text) {
  std::string escaped;
  for (const char character : text.substr(0, kMaximumText)) {
    if (character == '"' || character == '\\') escaped += '\\';
    escaped += character;
  }
  return '"' + displayText(escaped) + (text.size() > kMaximumText ? "…" : "") + '"';
}

void appendField(std::string& line, const char* name, const std::string& text) {
  line += name;
  if (text.empty()) {
    line += '-';
  } else if (text.size() <= kMaximumText && isPlain(text) && text != "-") {
    line += text;
  } else {
    line += quoted(text);
  }
}

template <class Number>
void appendNumber(std::string& line, const char* name, Number number) {
  line += name;
  line += std::to_string(number);
}

// What a write may have so that it takes everything without a wait when the descriptor is ready:
// whole lines, unless one is longer than that.
std::string_view portion(std::string_view lines, bool regular) {
  if (regular || lines.size() <= PIPE_BUF) return lines;
  const std::size_t end = lines.rfind('\n', PIPE_BUF - 1);
  return lines.substr(0, end == std::string_view::npos ? PIPE_BUF : end + 1);
}

// What cannot be written is lost.
void writeAtOnce(int descriptor, std::string_view lines) {
  struct stat status {};
  const bool regular = fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode);
  while (!lines.empty()) {
    pollfd entry{descriptor, POLLOUT, 0};
    if (!regular && poll(&entry, 1, 0) == 0) return;
    const std::string_view part = portion(lines, regular);
    const ssize_t written = ::write(descriptor, part.data(), part.size());
    if (written < 0 && errno == EINTR) continue;
    if (written <= 0) return;
    lines.remove_prefix(static_cast<std::size_t>(written));
  }
}

int openLog(const std::string& file) {
  return open(file.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0640);
}

}  // namespace

std::string toLogLine(const RequestRecord& record, std::chrono::system_clock::time_point time) {
  const RequestSummary& summary = record.summary;
  std::string line;
  line.reserve(kUsualLine);
  line += timeText(time);
  line += " client=";
  line += record.client;
  appendField(line, " user=", record.user);
  appendField(line, " operation=", summary.operation);
  appendField(line, " target=", summary.target);
  appendNumber(line, " http=", summary.httpStatus);
  appendNumber(line, " cim=", summary.cimStatus);
  appendNumber(line, " objects=", summary.objects);
  appendNumber(line, " bytes=", record.bytes);
  appendNumber(line, " ms=", record.duration.count());
  if (!record.complete) line += " incomplete";
  if (!record.note.empty()) appendField(line, " note=", record.note);
  return line;
}

RequestLog::RequestLog(std::string file)
    : file_(std::move(file)), descriptor_(file_.empty() ? STDERR_FILENO : openLog(file_)) {
  if (descriptor_ < 0) throw HostError(file_ + ": " + std::strerror(errno));
}

RequestLog::~RequestLog() {
  if (!file_.empty()) close(descriptor_);
}

void RequestLog::write(const RequestRecord& record) {
  const std::string line = toLogLine(record, std::chrono::system_clock::now());
  Lock lock(mutex_);
  append(line, lock);
}

void RequestLog::message(const std::string& text) {
  const std::string line = timeText(std::chrono::system_clock::now()) + " " + text;
  Lock lock(mutex_);
  append(line, lock);
  written_.wait(lock, [this] { return !writing_; });
}

void RequestLog::reopen() {
  if (file_.empty()) return;
  const int descriptor = openLog(file_);
  if (descriptor < 0) {
    message(file_ + ": " + std::strerror(errno));
    return;
  }
  Lock lock(mutex_);
  written_.wait(lock, [this] { return !writing_; });
  close(std::exchange(descriptor_, descriptor));
}

void RequestLog::append(const std::string& line, Lock& lock) {
  if (pending_.size() > kMaximumPending) return;
  pending_ += line;
  pending_ += '\n';
  if (std::exchange(writing_, true)) return;
  while (!pending_.empty()) {
    lines_.swap(pending_);
    lock.unlock();
    writeAtOnce(descriptor_, lines_);
    lines_.clear();
    lock.lock();
  }
  writing_ = false;
  written_.notify_all();
}

}  // namespace cimhost
