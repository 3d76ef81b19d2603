#pragma once

#include <chrono>

namespace cimhost {

/// SIGTERM, SIGINT and SIGHUP as something to wait for, from here to the end of the object. SIGPIPE
/// does nothing meanwhile. At most one per process.
///
/// Uses handlers rather than a signal mask: programs that a plug-in starts inherit a mask.
class SignalPipe {
 public:
  /// Throws HostError.
  SignalPipe();
  ~SignalPipe();
  SignalPipe(const SignalPipe&) = delete;
  SignalPipe& operator=(const SignalPipe&) = delete;

  /// The next signal, or 0 after `time`; -1 ms waits for ever.
  int wait(std::chrono::milliseconds time);
};

/// Ends the process as the signal does that nobody handles.
[[noreturn]] void dieOf(int signal);

}  // namespace cimhost
