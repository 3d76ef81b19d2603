#pragma once

#include <gmock/gmock.h>

#include "tests/examples/hostinfo/HostinfoLibrary.h"
#include "tests/support/TemporaryTree.h"

/// A directory tree that stands for a host's /proc and /sys while the object lives.
class FakeHost {
 public:
  FakeHost() { setenv("HOSTINFO_ROOT", tree_.root().c_str(), 1); }
  ~FakeHost() { unsetenv("HOSTINFO_ROOT"); }

  /// Writes a file in one step: a reader sees the old text or the new one.
  void write(const std::string& path, const std::string& text) const {
    const std::filesystem::path target = tree_.root().string() + path;
    std::filesystem::create_directories(target.parent_path());
    TemporaryTree::write(tree_.root() / "new", text);
    std::filesystem::rename(tree_.root() / "new", target);
  }

  void writeMounts(const std::string& text) const { write("/proc/self/mounts", text); }

  /// Makes a real directory, on a real file system, and returns its path.
  std::string makeDirectory(const std::string& name) const {
    std::filesystem::create_directories(tree_.root() / name);
    return tree_.root() / name;
  }

 private:
  TemporaryTree tree_;
};

/// Tests of the library on a host that is made up.
class FakeHostTest : public testing::Test {
 protected:
  FakeHost host_;
  HostinfoLibrary library_;
};
