#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "tests/support/RunProgram.h"
#include "tests/support/ServerProcess.h"

/// An installed OpenPegasus server with a repository, configuration and provider of its own, in a
/// directory of its own, on a free port of the loopback interface.
///
/// The installation is only read. The server runs as long as the object lives; every wait is
/// bounded.
class CimServer {
 public:
  /// Where the provider's code runs: in the server's process or in an agent's.
  enum class Providers { inProcess, inAgents };

  /// Why there can be no server here; empty when there can.
  static std::string whyUnavailable();

  /// Lays everything out below `root`: pegasus/ is the server's home, run/, lib/ and logs/ are the
  /// provider's. Throws std::runtime_error.
  CimServer(const std::filesystem::path& root, Providers providers);
  ~CimServer();
  CimServer(const CimServer&) = delete;
  CimServer& operator=(const CimServer&) = delete;

  /// Throws std::runtime_error when no connection can be made within half a minute.
  void start();
  /// As an administrator stops it. True when the process ended by itself with code 0.
  bool stop();
  pid_t process() const { return server_->id(); }
  int port() const { return port_; }
  std::filesystem::path home() const { return root_; }

  /// Runs one of the server's own programs, for at most a minute.
  ProgramResult run(const std::string& program, const std::vector<std::string>& arguments) const;
  /// The same; throws std::runtime_error with its output when it fails.
  void mustRun(const std::string& program, const std::vector<std::string>& arguments) const;

 private:
  void layOut() const;
  std::vector<std::string> environment() const;

  std::filesystem::path root_;
  Providers providers_;
  int port_ = 0;
  std::unique_ptr<ServerProcess> server_;
};
