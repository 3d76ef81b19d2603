#include "cimhost/http/RequestLog.h"

#include "cimhost/HostError.h"
#include "cimhost/output/DisplayText.h"

#include <fcntl.h>
#include <limits.h>
#include <poll.h>
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

// ISO 8601, UTC, milliseconds.
std::string timeText(std::chrono::system_clock::time_point time) {
  using std::chrono::milliseconds;
  const auto sinceEpoch = std::chrono::duration_cast<milliseconds>(time.time_since_epoch());
  const auto seconds = static_cast<time_t>(sinceEpoch.count() / 1000);
  tm parts{};
  gmtime_r(&seconds, &parts);
  char text[32];
  const std::size_t length = strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%S", &parts);
  std::string fraction = std::to_string(1000 + sinceEpoch.count() % 1000);
  fraction[0] = '.';
  return std::string(text, length) + fraction + "Z";
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
  append(toLogLine(record, std::chrono::system_clock::now()));
}

void RequestLog::message(const std::string& text) {
  append(timeText(std::chrono::system_clock::now()) + " " + text);
}

void RequestLog::reopen() {
  if (file_.empty()) return;
  const int descriptor = openLog(file_);
  if (descriptor < 0) {
    message(file_ + ": " + std::strerror(errno));
    return;
  }
  const std::lock_guard<std::mutex> lock(mutex_);
  close(std::exchange(descriptor_, descriptor));
}

void RequestLog::append(std::string line) {
  line += '\n';
  const std::lock_guard<std::mutex> lock(mutex_);
  std::string_view rest = line;
  while (!rest.empty()) {
    pollfd entry{descriptor_, POLLOUT, 0};
    if (poll(&entry, 1, 0) == 0) return;
    // A pipe that is ready takes as much without a wait.
    const ssize_t written =
        ::write(descriptor_, rest.data(), std::min<std::size_t>(rest.size(), PIPE_BUF));
    if (written < 0 && errno == EINTR) continue;
    if (written <= 0) return;
    rest.remove_prefix(static_cast<std::size_t>(written));
  }
}

}  // namespace cimhost
