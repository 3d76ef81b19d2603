#pragma once

#include <memory>

#include "CimServer.h"
#include "tests/support/TemporaryTree.h"

/// The compared classes, served by a CIM server and by cimhost: each with the same definitions,
/// declarations and plug-in in directories of its own.
class Deployment {
 public:
  explicit Deployment(CimServer::Providers providers);
  /// One for many tests, made at its first use, with the provider in the server's process. A
  /// machine runs one server at a time: release it before another deployment is made.
  static Deployment& shared();
  static void releaseShared();

  CimServer& server() { return *server_; }

  /// A one-shot command of cimhost.
  ProgramResult cimhost(const std::vector<std::string>& arguments) const;
  /// A command of the server's client, in the namespace of the classes.
  ProgramResult cimcli(std::vector<std::string> arguments) const;

  std::filesystem::path cimhostHome() const { return tree_.root() / "cimhost"; }

 private:
  void declareAndRegister();

  TemporaryTree tree_;
  std::unique_ptr<CimServer> server_;
};
