#include "CimServer.h"

#include <signal.h>
#include <sys/prctl.h>

#include <chrono>
#include <thread>

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

// Asks every tenth of a second, up to `tenths` times.
template <class Condition>
bool waitUntil(int tenths, Condition condition) {
  for (int i = 0; i < tenths; ++i) {
    if (condition()) return true;
    std::this_thread::sleep_for(std::chrono::milliseconds(100));
  }
  return false;
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
  if (process_ > 0) stop();
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
  std::vector<char*> argv;
  for (std::string& word : words) argv.push_back(word.data());
  argv.push_back(nullptr);
  const std::string run = (root_ / "run").string();
  const std::string log = (root_ / "server.log").string();
  process_ = fork();
  if (process_ == 0) {
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    const int output = open(log.c_str(), O_WRONLY | O_CREAT | O_APPEND, 0600);
    if (chdir(run.c_str()) == 0 && dup2(output, 1) == 1 && dup2(output, 2) == 2) {
      execv(argv[0], argv.data());
    }
    _exit(127);
  }
  const bool ready =
      waitUntil(300, [this] { return answers(port_) || waitpid(process_, nullptr, WNOHANG) != 0; });
  if (!ready || !answers(port_)) {
    throw std::runtime_error("the server did not start: " + TemporaryTree::read(log));
  }
}

bool CimServer::stop() {
  run("cimserver", {"-s"});
  int status = -1;
  bool ended = waitUntil(300, [&] { return waitpid(process_, &status, WNOHANG) == process_; });
  if (!ended) {
    kill(process_, SIGKILL);
    waitpid(process_, &status, 0);
  }
  process_ = -1;
  return ended && WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

ProgramResult CimServer::run(const std::string& program,
                             const std::vector<std::string>& arguments) const {
  std::vector<std::string> words = environment();
  words.insert(words.end(),
               {"timeout", "-k", "5", "60", (root_ / "pegasus/bin" / program).string()});
  words.insert(words.end(), arguments.begin(), arguments.end());
  return runProgram(words);
}

void CimServer::mustRun(const std::string& program,
                        const std::vector<std::string>& arguments) const {
  const ProgramResult result = run(program, arguments);
  if (result.code == 0) return;
  throw std::runtime_error(program + ": " + std::to_string(result.code) + "\n" + result.out +
                           result.err);
}
