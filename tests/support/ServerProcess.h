#pragma once

#include <fcntl.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <string>
#include <thread>
#include <vector>

/// A server as a process of its own, which ends with this object, or with the test's process.
class ServerProcess {
 public:
  /// Its output and its errors go to these descriptors.
  ServerProcess(std::vector<std::string> command, const std::string& directory, int output,
                int errors = STDERR_FILENO) {
    std::vector<char*> argv;
    for (std::string& word : command) argv.push_back(word.data());
    argv.push_back(nullptr);
    id_ = fork();
    if (id_ != 0) return;
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    if (chdir(directory.c_str()) == 0 && dup2(output, 1) == 1 && dup2(errors, 2) == 2) {
      execv(argv[0], argv.data());
    }
    _exit(127);
  }
  ~ServerProcess() {
    kill(SIGTERM);
    wait();
  }
  ServerProcess(const ServerProcess&) = delete;
  ServerProcess& operator=(const ServerProcess&) = delete;

  pid_t id() const { return id_; }

  bool isRunning() {
    if (id_ > 0 && waitpid(id_, &status_, WNOHANG) == id_) id_ = -1;
    return id_ > 0;
  }

  void kill(int signal) {
    if (isRunning()) ::kill(id_, signal);
  }

  /// Waits until it has ended by itself. Its exit code, or 128 + signal; -1 when half a minute was
  /// not enough and it was killed.
  int wait() {
    if (waitUntil([this] { return !isRunning(); })) {
      return WIFEXITED(status_) ? WEXITSTATUS(status_) : 128 + WTERMSIG(status_);
    }
    kill(SIGKILL);
    waitpid(id_, &status_, 0);
    id_ = -1;
    return -1;
  }

  /// True as soon as the condition holds, false after half a minute.
  template <class Condition>
  static bool waitUntil(Condition condition) {
    for (int i = 0; i < 600 && !condition(); ++i) {
      std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
    return condition();
  }

 private:
  pid_t id_ = -1;
  int status_ = 0;
};
