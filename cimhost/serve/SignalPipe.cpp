#include "cimhost/serve/SignalPipe.h"

#include "cimhost/HostError.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <string>

namespace cimhost {

namespace {

constexpr std::array<int, 3> kSignals = {SIGTERM, SIGINT, SIGHUP};

// Of the handlers, which know nothing else.
int pipeEnds[2] = {-1, -1};

void record(int signal) {
  const int before = errno;
  const auto byte = static_cast<unsigned char>(signal);
  // A full pipe holds enough of them.
  if (write(pipeEnds[1], &byte, 1) < 0) errno = before;
  errno = before;
}

void ignore(int) {}

void handle(int signal, void (*handler)(int)) {
  struct sigaction action {};
  action.sa_handler = handler;
  action.sa_flags = SA_RESTART;
  sigaction(signal, &action, nullptr);
}

}  // namespace

SignalPipe::SignalPipe() {
  if (pipe2(pipeEnds, O_CLOEXEC | O_NONBLOCK) != 0) {
    throw HostError(std::string("pipe: ") + std::strerror(errno));
  }
  // The thread sanitizer prepares for signals in a thread's first blocking call, and loses one that
  // arrives meanwhile: let that be here.
  static_cast<void>(poll(nullptr, 0, 0));
  for (const int signal : kSignals) handle(signal, record);
  handle(SIGPIPE, ignore);
}

SignalPipe::~SignalPipe() {
  for (const int signal : kSignals) handle(signal, SIG_DFL);
  handle(SIGPIPE, SIG_DFL);
  for (int& end : pipeEnds) {
    close(end);
    end = -1;
  }
}

int SignalPipe::wait(std::chrono::milliseconds time) {
  using Clock = std::chrono::steady_clock;
  const auto end = Clock::now() + time;
  for (;;) {
    pollfd entry{pipeEnds[0], POLLIN, 0};
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(end - Clock::now());
    const bool forEver = time.count() < 0;
    const int ready =
        poll(&entry, 1, forEver ? -1 : static_cast<int>(std::max<long long>(left.count(), 0)));
    unsigned char byte = 0;
    if (ready > 0 && read(pipeEnds[0], &byte, 1) == 1) return byte;
    if (ready == 0) return 0;
  }
}

void dieOf(int signal) {
  handle(signal, SIG_DFL);
  raise(signal);
  std::_Exit(EXIT_FAILURE);
}

}  // namespace cimhost
