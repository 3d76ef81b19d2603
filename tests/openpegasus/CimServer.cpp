#include "CimServer.h"

#include "tests/cimhost/http/HttpClient.h"
#include "tests/support/TemporaryTree.h"

namespace fs = std::filesystem;

namespace {

int freePort() {
  const int listener = socket(AF_INET, SOCK_STREAM, 0);
  sockaddr_in address{};
  address.sin_family = AF_INET;
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  socklen_t size = sizeof address;
  const bool bound = listener >= 0 &&
                     bind(listener, reinterpret_cast<sockaddr*>(&address), size) == 0 &&
                     getsockname(listener, reinterpret_cast<sockaddr*>(&address), &size) == 0;
  close(listener);
  if (!bound) throw std::runtime_error("no free port");
  return ntohs(address.sin_port);
}

bool answers(int port) {
  return HttpClient(static_cast<std::uint16_t>(port)).isConnected();
}

}  // namespace

std::string CimServer::whyUnavailable() {
  const fs::path home = OPENPEGASUS_HOME;
  if (home.empty()) return "OpenPegasus_ROOT named no installed server when this was built";
  for (const char* part : {"bin/cimserver", "bin/cimmof", "bin/cimcli", "repository"}) {
    if (!fs::exists(home / part)) return "no " + (home / part).string();
  }
  return "";
}

CimServer::CimServer(const fs::path& root, Providers providers)
    : root_(root), providers_(providers), port_(freePort()) {
  layOut();
  start();
}

CimServer::~CimServer() {
  if (server_->isRunning()) stop();
}

void CimServer::layOut() const {
  const fs::path installed = OPENPEGASUS_HOME;
  const fs::path pegasus = root_ / "pegasus";
  for (const char* folder : {"pegasus/lib", "pegasus/trace", "run", "lib", "logs"}) {
    fs::create_directories(root_ / folder);
  }
  fs::create_directory_symlink(fs::canonical(installed / "bin"), pegasus / "bin");
  for (const auto& library : fs::directory_iterator(installed / "lib")) {
    fs::create_symlink(fs::absolute(library.path()), pegasus / "lib" / library.path().filename());
  }
  fs::create_symlink(OPENPEGASUS_PROVIDER, pegasus / "lib" / "libCommonProvider.so");
  fs::copy(fs::canonical(installed / "repository"), pegasus / "repository",
           fs::copy_options::recursive);
}

std::vector<std::string> CimServer::environment() const {
  const std::string pegasus = (root_ / "pegasus").string();
  return {"/usr/bin/env", "PEGASUS_HOME=" + pegasus, "LD_LIBRARY_PATH=" + pegasus + "/lib"};
}

void CimServer::start() {
  std::vector<std::string> words = environment();
  words.push_back((root_ / "pegasus/bin/cimserver").string());
  const char* const agents = providers_ == Providers::inAgents ? "true" : "false";
  words.insert(words.end(),
               {"daemon=false", "enableHttpConnection=true", "enableHttpsConnection=false",
                "enableAuthentication=false", "httpPort=" + std::to_string(port_),
                std::string("forceProviderProcesses=") + agents});
  const std::string log = (root_ / "server.log").string();
  const int output = open(log.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600);
  server_ = std::make_unique<ServerProcess>(words, (root_ / "run").string(), output, output);
  close(output);
  ServerProcess::waitUntil([this] { return answers(port_) || !server_->isRunning(); });
  if (!answers(port_)) {
    throw std::runtime_error("the server did not start: " + TemporaryTree::read(log));
  }
}

bool CimServer::stop() {
  run("cimserver", {"-s"});
  return server_->wait() == 0;
}

ProgramResult CimServer::run(const std::string& program,
                             const std::vector<std::string>& arguments) const {
  std::vector<std::string> words = environment();
  words.insert(words.end(),
               {"timeout", "-k", "5", "60", (root_ / "pegasus/bin" / program).string()});
  return runProgram(words, arguments);
}

void CimServer::mustRun(const std::string& program,
                        const std::vector<std::string>& arguments) const {
  const ProgramResult result = run(program, arguments);
  if (result.code == 0) return;
  throw std::runtime_error(program + ": " + std::to_string(result.code) + "\n" + result.out +
                           result.err);
}
