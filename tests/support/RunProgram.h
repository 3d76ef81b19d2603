#pragma once

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

extern char** environ;

/// How a program ended and what it wrote.
struct ProgramResult {
  int code = -1;  ///< Exit code; 128 + signal when a signal ended it.
  std::string out;
  std::string err;
};

/// Runs a command with more arguments to its end, with an empty standard input. Its output goes
/// through files, so no amount of it can block.
inline ProgramResult runProgram(std::vector<std::string> command,
                                const std::vector<std::string>& arguments = {}) {
  command.insert(command.end(), arguments.begin(), arguments.end());
  char outName[] = "/tmp/program-out-XXXXXX";
  char errName[] = "/tmp/program-err-XXXXXX";
  const int out = mkstemp(outName);
  const int err = mkstemp(errName);
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
  posix_spawn_file_actions_adddup2(&actions, out, STDOUT_FILENO);
  posix_spawn_file_actions_adddup2(&actions, err, STDERR_FILENO);
  std::vector<char*> argv;
  for (std::string& word : command) argv.push_back(word.data());
  argv.push_back(nullptr);
  pid_t child = 0;
  const int failed = posix_spawn(&child, argv[0], &actions, nullptr, argv.data(), environ);
  posix_spawn_file_actions_destroy(&actions);
  close(out);
  close(err);
  if (failed != 0) throw std::runtime_error("cannot run " + command[0]);
  int status = 0;
  waitpid(child, &status, 0);

  const auto take = [](const char* name) {
    std::ostringstream all;
    all << std::ifstream(name).rdbuf();
    unlink(name);
    return all.str();
  };
  return {WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status), take(outName),
          take(errName)};
}
