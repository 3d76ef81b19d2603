#include "cimhost/Home.h"

#include "cimhost/HostError.h"

#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>

namespace cimhost {

namespace {

void requireDirectory(const std::string& path) {
  std::error_code error;
  if (!std::filesystem::is_directory(path, error)) {
    throw HostError(path + ": " + (error ? error.message() : "not a directory"));
  }
}

}  // namespace

Home::Home(const std::string& directory) {
  requireDirectory(directory);
  std::error_code error;
  root_ = std::filesystem::canonical(directory, error).string();
  if (error) throw HostError(directory + ": " + error.message());
  requireDirectory(run());
  requireDirectory(mof());
}

void Home::enterRun() const {
  if (chdir(run().c_str()) != 0) throw HostError(run() + ": " + std::strerror(errno));
}

std::string Home::relative(const std::string& path) const {
  const std::string prefix = root_ + "/";
  return path.compare(0, prefix.size(), prefix) == 0 ? path.substr(prefix.size()) : path;
}

}  // namespace cimhost
