#pragma once

#include <filesystem>

/// Makes `home` a home directory of the classes of namespace root/compare, which a CIM server and
/// cimhost serve alike: compare.mof for cimmof and for cimhost, compare.xml, and the plug-in.
inline void writeComparedHome(const std::filesystem::path& home) {
  namespace fs = std::filesystem;
  for (const char* folder : {"run", "lib", "logs", "mof/root/compare"}) {
    fs::create_directories(home / folder);
  }
  fs::create_symlink(COMPARE_PLUGIN, home / "lib/libcompare.so");
  fs::copy(COMPARE_FOLDER "/compare.xml", home / "run");
  fs::copy(COMPARE_FOLDER "/compare.mof", home / "mof/root/compare");
}
