#include "cimhost/http/UserFile.h"

#include "cimhost/HostError.h"

#include <crypt.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <memory>

namespace cimhost {

namespace {

constexpr std::uintmax_t kMaximumSize = 1U << 20U;

struct HashKind {
  const char* prefix;
  std::size_t digest;  // Characters behind the last $ that are no salt, or all of salt and digest.
};

constexpr HashKind kHashKinds[] = {{"$6$", 86}, {"$2y$", 53}, {"$2b$", 53}};

bool isSupportedHash(const std::string& hash) {
  for (const HashKind& kind : kHashKinds) {
    if (hash.rfind(kind.prefix, 0) != 0) continue;
    const std::size_t dollar = hash.rfind('$');
    return hash.size() - dollar - 1 == kind.digest &&
           crypt_checksalt(hash.c_str()) == CRYPT_SALT_OK;
  }
  return false;
}

bool equalInConstantTime(std::string_view left, std::string_view right) {
  if (left.size() != right.size()) return false;
  unsigned difference = 0;
  for (std::size_t i = 0; i < left.size(); ++i) {
    difference |= static_cast<unsigned char>(left[i]) ^ static_cast<unsigned char>(right[i]);
  }
  return difference == 0;
}

std::ifstream openUsers(const std::string& file) {
  namespace fs = std::filesystem;
  std::error_code error;
  // Opening a pipe would wait for a writer.
  if (!fs::is_regular_file(file, error)) throw HostError(file + ": no such users file");
  if (fs::file_size(file, error) > kMaximumSize || error) {
    throw HostError(file + ": larger than 1 MiB");
  }
  std::ifstream stream(file);
  if (!stream) throw HostError(file + ": cannot be read");
  return stream;
}

}  // namespace

UserFile::UserFile(const std::string& file) {
  std::ifstream stream = openUsers(file);
  int number = 0;
  for (std::string line; std::getline(stream, line);) {
    ++number;
    try {
      addLine(line);
    } catch (const HostError& problem) {
      throw HostError(file + ":" + std::to_string(number) + ": " + problem.what());
    }
  }
  if (hashes_.empty()) throw HostError(file + ": no users");
}

void UserFile::addLine(std::string_view line) {
  if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
  if (line.empty() || line.front() == '#') return;
  const std::size_t colon = line.find(':');
  if (colon == std::string_view::npos || colon == 0) throw HostError("expected name:hash");
  const std::string hash(line.substr(colon + 1));
  if (!isSupportedHash(hash)) {
    throw HostError("not a SHA-512 ($6$) or bcrypt ($2y$, $2b$) hash");
  }
  if (!hashes_.emplace(line.substr(0, colon), hash).second) throw HostError("user comes twice");
  if (anyHash_.empty()) anyHash_ = hash;
}

bool UserFile::verify(const std::string& name, const std::string& password) const {
  const auto found = hashes_.find(name);
  const bool known = found != hashes_.end();
  const std::string& hash = known ? found->second : anyHash_;
  const auto data = std::make_unique<crypt_data>();
  const char* computed = crypt_r(password.c_str(), hash.c_str(), data.get());
  const bool equal = computed != nullptr && equalInConstantTime(computed, hash);
  explicit_bzero(data.get(), sizeof *data);
  // A password with a NUL would be hashed without what follows it.
  const bool complete = password.find('\0') == std::string::npos;
  return known && equal && complete;
}

}  // namespace cimhost
