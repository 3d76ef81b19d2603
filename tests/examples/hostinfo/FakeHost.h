#pragma once

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>

/// A directory tree that stands for a host's /proc and /sys while the object lives.
class FakeHost {
 public:
  FakeHost() {
    std::string pattern = (std::filesystem::temp_directory_path() / "hostinfo-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("no temporary directory");
    root_ = pattern;
    setenv("HOSTINFO_ROOT", root_.c_str(), 1);
  }
  ~FakeHost() {
    unsetenv("HOSTINFO_ROOT");
    std::filesystem::remove_all(root_);
  }
  FakeHost(const FakeHost&) = delete;
  FakeHost& operator=(const FakeHost&) = delete;

  /// Writes a file in one step: a reader sees the old text or the new one.
  void write(const std::string& path, const std::string& text) const {
    const std::filesystem::path target = root_ + path;
    std::filesystem::create_directories(target.parent_path());
    std::ofstream(root_ + "/new", std::ios::binary) << text;
    std::filesystem::rename(root_ + "/new", target);
  }

  void writeMounts(const std::string& text) const { write("/proc/self/mounts", text); }

  /// Makes a real directory, on a real file system, and returns its path.
  std::string makeDirectory(const std::string& name) const {
    const std::string path = root_ + "/" + name;
    std::filesystem::create_directories(path);
    return path;
  }

 private:
  std::string root_;
};
