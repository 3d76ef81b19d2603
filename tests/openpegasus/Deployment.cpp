#include "Deployment.h"

#include "tests/compared/ComparedClasses.h"

namespace fs = std::filesystem;

Deployment::Deployment(CimServer::Providers providers) {
  std::string name = (fs::temp_directory_path() / "openpegasus-XXXXXX").string();
  if (mkdtemp(name.data()) == nullptr) throw std::runtime_error("cannot make " + name);
  root_ = name;
  writeComparedHome(cimhostHome());
  writeComparedHome(root_ / "server");
  server_ = std::make_unique<CimServer>(root_ / "server", providers);
  declareAndRegister();
}

namespace {

std::unique_ptr<Deployment>& sharedDeployment() {
  static std::unique_ptr<Deployment> deployment;
  return deployment;
}

}  // namespace

Deployment& Deployment::shared() {
  std::unique_ptr<Deployment>& deployment = sharedDeployment();
  if (deployment == nullptr) {
    deployment = std::make_unique<Deployment>(CimServer::Providers::inProcess);
  }
  return *deployment;
}

void Deployment::releaseShared() {
  sharedDeployment().reset();
}

Deployment::~Deployment() {
  server_.reset();
  std::error_code ignored;
  fs::remove_all(root_, ignored);
}

void Deployment::declareAndRegister() {
  const ProgramResult registration = cimhost({"registration"});
  if (registration.code != 0) throw std::runtime_error(registration.err);
  TemporaryTree::write(root_ / "registration.mof", registration.out);
  server_->mustRun(
      "cimmof", {"-n", "root/compare", (cimhostHome() / "mof/root/compare/compare.mof").string()});
  server_->mustRun("cimmof", {"-n", "root/PG_InterOp", (root_ / "registration.mof").string()});
}

ProgramResult Deployment::cimhost(std::vector<std::string> arguments) const {
  arguments.insert(arguments.begin(), {CIMHOST, "--home", cimhostHome().string()});
  return runProgram(arguments);
}

ProgramResult Deployment::cimcli(std::vector<std::string> arguments) const {
  arguments.insert(arguments.end(), {"-n", "root/compare"});
  return server_->run("cimcli", arguments);
}
