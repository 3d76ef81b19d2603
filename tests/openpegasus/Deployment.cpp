#include "Deployment.h"

#include "tests/compared/ComparedClasses.h"

namespace fs = std::filesystem;

Deployment::Deployment(CimServer::Providers providers) {
  writeComparedHome(cimhostHome());
  writeComparedHome(tree_.root() / "server");
  server_ = std::make_unique<CimServer>(tree_.root() / "server", providers);
  declareAndRegister();
}

namespace {

std::unique_ptr<Deployment> sharedDeployment;

}  // namespace

Deployment& Deployment::shared() {
  // One that could not be made is not tried again by every test.
  static bool failed = false;
  if (failed) throw std::runtime_error("there is no deployment");
  if (sharedDeployment == nullptr) {
    failed = true;
    sharedDeployment = std::make_unique<Deployment>(CimServer::Providers::inProcess);
    failed = false;
  }
  return *sharedDeployment;
}

void Deployment::releaseShared() {
  sharedDeployment.reset();
}

void Deployment::declareAndRegister() {
  const auto print = [this](const std::string& name, const std::vector<std::string>& command) {
    const ProgramResult result = cimhost(command);
    if (result.code != 0) throw std::runtime_error(result.err);
    const fs::path file = tree_.root() / name;
    TemporaryTree::write(file, result.out);
    return file.string();
  };
  const std::string classes = (cimhostHome() / "mof/root/compare/compare.mof").string();
  const std::string qualifiers = print("qualifiers.mof", {"qualifiers", "root/compare"});
  server_->mustRun("cimmof", {"-n", "root/compare", qualifiers, classes});
  const std::string registration = print("registration.mof", {"registration"});
  server_->mustRun("cimmof", {"-n", "root/PG_InterOp", registration});
}

ProgramResult Deployment::cimhost(const std::vector<std::string>& arguments) const {
  return runProgram({CIMHOST, "--home", cimhostHome().string()}, arguments);
}

ProgramResult Deployment::cimcli(std::vector<std::string> arguments) const {
  arguments.insert(arguments.end(), {"-n", "root/compare"});
  return server_->run("cimcli", arguments);
}
