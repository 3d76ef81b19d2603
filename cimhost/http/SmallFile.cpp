#include "cimhost/http/SmallFile.h"

#include "cimhost/HostError.h"

#include <filesystem>
#include <fstream>
#include <sstream>

namespace cimhost {

std::string readSmallFile(const std::string& file) {
  constexpr std::uintmax_t kMaximumSize = 1U << 20U;
  namespace fs = std::filesystem;
  std::error_code error;
  if (!fs::is_regular_file(file, error)) throw HostError(file + ": no such file");
  if (fs::file_size(file, error) > kMaximumSize || error) {
    throw HostError(file + ": larger than 1 MiB");
  }
  std::ifstream stream(file, std::ios::binary);
  std::ostringstream text;
  text << stream.rdbuf();
  if (!stream) throw HostError(file + ": cannot be read");
  return text.str();
}

}  // namespace cimhost
