#pragma once

#include <poll.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <stdexcept>

#include "tests/support/ServerProcess.h"

/// `cimhost serve` as a process of its own, on a port that it chooses.
class CimhostServer {
 public:
  /// Throws std::runtime_error when the server does not tell its port within half a minute.
  CimhostServer(const std::string& program, const std::string& home,
                const std::vector<std::string>& options = {}) {
    std::vector<std::string> words = {program, "--home", home, "serve", "--port", "0"};
    words.insert(words.end(), options.begin(), options.end());
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0) throw std::runtime_error("no pipe");
    server_ = std::make_unique<ServerProcess>(words, ".", ends[1]);
    close(ends[1]);
    pollfd output{ends[0], POLLIN, 0};
    char line[512] = "";
    if (poll(&output, 1, 30000) == 1) line[std::max<ssize_t>(read(ends[0], line, 511), 0)] = '\0';
    close(ends[0]);
    const char* const colon = std::strrchr(line, ':');
    if (std::strstr(line, "listening on") == nullptr || colon == nullptr) {
      throw std::runtime_error("cimhost did not start: " + std::string(line));
    }
    port_ = std::atoi(colon + 1);
  }

  int port() const { return port_; }
  pid_t process() const { return server_->id(); }

  /// Asks the server to end. Its exit code, or 128 + signal; -1 when it had to be killed.
  int stop() {
    server_->kill(SIGTERM);
    return server_->wait();
  }

 private:
  std::unique_ptr<ServerProcess> server_;
  int port_ = 0;
};
