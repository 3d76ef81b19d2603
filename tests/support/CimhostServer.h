#pragma once

#include <fcntl.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

/// `cimhost serve` as a process of its own, on a port that it chooses. It ends with this object, or
/// with the test's process.
class CimhostServer {
 public:
  /// Throws std::runtime_error when the server does not tell its port within half a minute.
  CimhostServer(const std::string& program, const std::string& home,
                const std::vector<std::string>& options = {}) {
    std::vector<std::string> words = {program, "--home", home, "serve", "--port", "0"};
    words.insert(words.end(), options.begin(), options.end());
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0) throw std::runtime_error("no pipe");
    start(words, ends[1]);
    close(ends[1]);
    const std::string line = firstLine(ends[0]);
    close(ends[0]);
    const auto colon = line.rfind(':');
    if (line.find("listening on") == std::string::npos || colon == std::string::npos) {
      stop();
      throw std::runtime_error("cimhost did not start: " + line);
    }
    port_ = std::stoi(line.substr(colon + 1));
  }
  ~CimhostServer() { stop(); }
  CimhostServer(const CimhostServer&) = delete;
  CimhostServer& operator=(const CimhostServer&) = delete;

  int port() const { return port_; }
  pid_t process() const { return process_; }

  /// Asks the server to end. Its exit code, or 128 + signal; -1 when it had to be killed.
  int stop() {
    if (process_ < 0) return 0;
    kill(process_, SIGTERM);
    int status = 0;
    pid_t ended = 0;
    for (int i = 0; i < 600 && ended == 0; ++i) {
      ended = waitpid(process_, &status, WNOHANG);
      if (ended == 0) std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
    if (ended == 0) {
      kill(process_, SIGKILL);
      waitpid(process_, &status, 0);
    }
    process_ = -1;
    if (ended == 0) return -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  }

 private:
  void start(std::vector<std::string>& words, int output) {
    std::vector<char*> argv;
    for (std::string& word : words) argv.push_back(word.data());
    argv.push_back(nullptr);
    process_ = fork();
    if (process_ != 0) return;
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    if (dup2(output, 1) == 1) execv(argv[0], argv.data());
    _exit(127);
  }

  static std::string firstLine(int input) {
    fcntl(input, F_SETFL, O_NONBLOCK);
    std::string line;
    for (int i = 0; i < 600; ++i) {
      char character;
      const ssize_t size = read(input, &character, 1);
      if (size == 0 || (size == 1 && character == '\n')) return line;
      if (size == 1) {
        line += character;
        --i;
      } else {
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
      }
    }
    return line;
  }

  pid_t process_ = -1;
  int port_ = 0;
};
