#pragma once

#include "cimhost/xml/CimXmlService.h"

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <mutex>
#include <string>

namespace cimhost {

/// What the log tells of one request.
struct RequestRecord {
  std::string client;  ///< Address without port.
  std::string user;
  RequestSummary summary;   ///< httpStatus 0: nothing was answered.
  std::uint64_t bytes = 0;  ///< Of the reply's body, as far as it was sent.
  std::chrono::milliseconds duration{0};
  bool complete = true;  ///< The client was given the whole reply.
  std::string note;      ///< Why the transport refused the request.
};

/// `time client=... user=... operation=... target=... http=200 cim=0 objects=1 bytes=812 ms=3`,
/// without a line end. Texts of clients are cut at 200 bytes; one that is not plain stands in
/// quotes with escapes. `-` is an empty one.
std::string toLogLine(const RequestRecord& record, std::chrono::system_clock::time_point time);

/// Writes lines to a file or to standard error, whole ones with each system call unless they are
/// very long. May be used from several threads: one that finds another one writing leaves its line
/// to it. Lines that cannot be written at once are lost: nobody waits for the reader of a pipe.
class RequestLog {
 public:
  /// Appends to `file`; empty: standard error. Throws HostError.
  explicit RequestLog(std::string file);
  ~RequestLog();
  RequestLog(const RequestLog&) = delete;
  RequestLog& operator=(const RequestLog&) = delete;

  void write(const RequestRecord& record);
  /// A line of the server itself, with the time in front. Several lines stay several.
  void message(const std::string& text);
  /// Opens the file anew, for whoever moved it away. The old one stays in use when that fails, and
  /// gets a line that says so.
  void reopen();

 private:
  using Lock = std::unique_lock<std::mutex>;

  void append(const std::string& line, Lock& lock);

  std::string file_;
  std::mutex mutex_;
  std::condition_variable written_;
  std::string pending_;
  bool writing_ = false;  // Who sets it alone uses what follows.
  std::string lines_;
  int descriptor_;
};

}  // namespace cimhost
