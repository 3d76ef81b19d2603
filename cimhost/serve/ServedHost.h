#pragma once

#include "cimhost/Host.h"
#include "cimhost/serve/RequestGate.h"
#include "cimhost/xml/CimXmlService.h"

#include <chrono>
#include <memory>
#include <string>

namespace cimhost {

/// The host of one home directory, its provider and its service, which can be exchanged for those
/// of the directory's present files while requests come in.
class ServedHost {
 public:
  /// Reads the home directory and loads the provider library `libraryFile`. Throws HostError.
  ServedHost(const std::string& home, std::string libraryFile);

  const Host& host() const { return *current_->host; }

  /// As CimXmlService::answer; waits while a reload exchanges the host.
  RequestSummary answer(const CimXmlRequest& request, ReplyStream& reply);

  /// Reads the home directory again. Without errors in it, the new host takes over once no request
  /// runs, at most `patience` later. Throws HostError with a reason of one or more lines when the
  /// old one goes on; when even its provider cannot be loaded any more, the reason says so.
  /// Not while another reload or unload() runs.
  void reload(std::chrono::milliseconds patience);

  /// Terminates the provider; throws HostError when that fails. Not while requests run.
  void unload() { current_->host->unloadProvider(); }

 private:
  struct Served {
    explicit Served(const std::string& home);
    std::unique_ptr<Host> host;
    CimXmlService service;
  };

  void takeOver(std::unique_ptr<Served> next);

  std::string home_;
  std::string libraryFile_;
  std::unique_ptr<Served> current_;
  RequestGate gate_;
};

/// All problems, each as `cimhost check` prints it, with line ends between them.
std::string problemsText(const std::vector<Diagnostic>& problems);

}  // namespace cimhost
