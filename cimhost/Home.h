#pragma once

#include <string>

namespace cimhost {

/// The directory that stands for a server's installation: run/ (the working directory: definition
/// files), lib/ (plug-in modules), logs/ (log and its configuration) and mof/ (class declarations).
///
/// Keeps absolute paths, so it stays right when the working directory changes.
class Home {
 public:
  /// Throws HostError unless `directory` holds run/ and mof/.
  explicit Home(const std::string& directory);

  std::string run() const { return root_ + "/run"; }
  std::string lib() const { return root_ + "/lib"; }
  std::string mof() const { return root_ + "/mof"; }
  std::string configuration() const { return root_ + "/logs/CommonProvider.ini"; }
  const std::string& root() const { return root_; }

  /// Makes run/ the process's working directory, against which the provider resolves ".", "../lib"
  /// and "../logs". Throws HostError.
  void enterRun() const;

  /// `path` as it is named below the home directory; unchanged when it lies elsewhere.
  std::string relative(const std::string& path) const;

 private:
  std::string root_;
};

}  // namespace cimhost
