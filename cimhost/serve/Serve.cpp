#include "cimhost/serve/Serve.h"

#include "cimhost/OperationStatus.h"
#include "cimhost/http/HttpServer.h"
#include "cimhost/http/RequestLog.h"
#include "cimhost/serve/ServedHost.h"
#include "cimhost/serve/ServiceManager.h"
#include "cimhost/serve/SignalPipe.h"

#include <malloc.h>
#include <signal.h>

#include <cstdlib>
#include <filesystem>

namespace cimhost {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds kForEver{-1};
constexpr milliseconds kSlice{50};
constexpr milliseconds kAfterCut{3000};

// The working directory changes before the files are opened again.
std::string absolute(const std::string& file) {
  return file.empty() ? file : std::filesystem::absolute(file).string();
}

std::string urlOf(const ServeOptions& options, std::uint16_t port) {
  const bool v6 = options.bind.find(':') != std::string::npos;
  return std::string(options.tlsKey.empty() ? "http://" : "https://") +
         (v6 ? "[" + options.bind + "]" : options.bind) + ":" + std::to_string(port);
}

std::shared_ptr<Authenticator> readUsers(const std::string& file) {
  return file.empty() ? nullptr : std::make_shared<Authenticator>(file);
}

HttpSettings settingsOf(const ServeOptions& options, const std::string& usersFile) {
  HttpSettings settings;
  settings.address = options.bind;
  settings.port = options.port;
  settings.limits = options.limits;
  settings.users = readUsers(usersFile);
  if (!options.tlsKey.empty()) {
    settings.tls = readTlsFiles(options.tlsCertificate, options.tlsKey);
  }
  return settings;
}

// A large request takes ten times its size for a moment. The system gets it back at once: by
// default each thread would keep up to 64 MiB.
void keepLittleFreeMemory() {
  constexpr int kEnough = 1 << 20;
  mallopt(M_MMAP_THRESHOLD, kEnough);
  mallopt(M_TRIM_THRESHOLD, kEnough);
}

class Server {
 public:
  explicit Server(const CommandLine& line)
      : options_(line.serve),
        usersFile_(absolute(options_.users)),
        log_(absolute(options_.log)),
        settings_(settingsOf(options_, usersFile_)),
        host_(line.home, findProviderLibrary(line.providerFile)),
        http_(
            settings_,
            [this](const CimXmlRequest& request, ReplyStream& reply) {
              return host_.answer(request, reply);
            },
            [this](const RequestRecord& record) { log_.write(record); }) {}

  const Host& host() const { return host_.host(); }
  std::string url() const { return urlOf(options_, http_.port()); }

  int run() {
    notifyServiceManager("READY=1");
    log_.message("serving on " + url());
    int signal = signals_.wait(kForEver);
    for (; signal == SIGHUP; signal = signals_.wait(kForEver)) reload();
    return shutDown();
  }

 private:
  void reload() {
    notifyServiceManager(reloadingState());
    log_.reopen();
    try {
      // All or nothing: both are read before either takes effect.
      auto users = readUsers(usersFile_);
      host_.reload(options_.shutdownTimeout);
      http_.setUsers(std::move(users));
      const std::string warnings = problemsText(host().diagnostics());
      log_.message("reloaded" + (warnings.empty() ? "" : "\n" + warnings));
    } catch (...) {
      log_.message("reload failed; what was served before goes on:\n" +
                   currentExceptionStatus().message);
    }
    notifyServiceManager("READY=1");
  }

  int shutDown() {
    notifyServiceManager("STOPPING=1");
    log_.message("shutting down");
    http_.drain();
    bool idle = waitUntilIdle(options_.shutdownTimeout);
    if (!idle) {
      http_.cut();
      idle = waitUntilIdle(kAfterCut);
    }
    if (!idle) {
      // Its thread cannot be ended, and the provider not terminated under it.
      log_.message("requests still run; the provider is not terminated");
      std::_Exit(ExitCode::kHung);
    }
    http_.stop();
    host_.unload();
    log_.message("stopped");
    return ExitCode::kOk;
  }

  // Ends the process on another signal.
  bool waitUntilIdle(milliseconds time) {
    for (; !http_.waitUntilIdle(kSlice); time -= kSlice) {
      const int signal = signals_.wait(milliseconds(0));
      if (signal == SIGTERM || signal == SIGINT) dieOf(signal);
      if (time <= kSlice) return false;
    }
    return true;
  }

  SignalPipe signals_;
  ServeOptions options_;
  std::string usersFile_;
  RequestLog log_;
  HttpSettings settings_;
  ServedHost host_;
  HttpServer http_;
};

}  // namespace

int runServe(const CommandLine& line, std::ostream& out, std::ostream& error) {
  keepLittleFreeMemory();
  Server server(line);
  const std::string problems = problemsText(server.host().diagnostics());
  if (!problems.empty()) error << problems << std::endl;
  out << "cimhost: listening on " << server.url() << std::endl;
  if (!out) {
    error << "cimhost: the address could not be written\n";
    return ExitCode::kOutput;
  }
  return server.run();
}

}  // namespace cimhost
