#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>

/// A provider's home in a temporary directory: run/ (which becomes the working directory), lib/ and
/// logs/. Destroying it restores the working directory and removes the tree.
///
/// The working directory belongs to the process: at most one tree at a time.
class TemporaryTree {
 public:
  TemporaryTree() : before_(std::filesystem::current_path()) {
    std::string name = (std::filesystem::temp_directory_path() / "provider-XXXXXX").string();
    if (mkdtemp(name.data()) == nullptr) throw std::runtime_error("cannot make " + name);
    root_ = name;
    for (const char* folder : {"run", "lib", "logs"}) {
      std::filesystem::create_directory(root_ / folder);
    }
    std::filesystem::current_path(run());
  }

  ~TemporaryTree() {
    std::error_code ignored;
    std::filesystem::current_path(before_, ignored);
    std::filesystem::remove_all(root_, ignored);
  }

  TemporaryTree(const TemporaryTree&) = delete;
  TemporaryTree& operator=(const TemporaryTree&) = delete;

  const std::filesystem::path& root() const { return root_; }
  std::filesystem::path run() const { return root_ / "run"; }
  std::filesystem::path lib() const { return root_ / "lib"; }
  std::filesystem::path logs() const { return root_ / "logs"; }

  /// Makes `library` (a file) known as lib/lib`name`.so.
  void addPlugin(const std::string& name, const std::filesystem::path& library) const {
    std::filesystem::create_symlink(library, lib() / ("lib" + name + ".so"));
  }

  /// Writes logs/CommonProvider.ini. The process reads it once (see LogLevel.h).
  void setLogLevel(const std::string& level) const {
    write(logs() / "CommonProvider.ini", "LogLevel = " + level + "\n");
  }

  /// What logs/CommonProvider.log holds; empty when there is none.
  std::string log() const { return read(logs() / "CommonProvider.log"); }

  static void write(const std::filesystem::path& file, const std::string& text) {
    if (file.has_parent_path()) std::filesystem::create_directories(file.parent_path());
    std::ofstream stream(file, std::ios::binary);
    stream << text;
    if (!stream.flush()) throw std::runtime_error("cannot write " + file.string());
  }

  static std::string read(const std::filesystem::path& file) {
    std::ostringstream text;
    std::ifstream stream(file, std::ios::binary);
    if (stream) text << stream.rdbuf();
    return text.str();
  }

 private:
  std::filesystem::path before_;
  std::filesystem::path root_;
};
