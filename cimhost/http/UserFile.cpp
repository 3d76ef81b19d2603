#include "cimhost/http/UserFile.h"

#include "cimhost/HostError.h"
#include "cimhost/http/SmallFile.h"

#include <crypt.h>
#include <string.h>

#include <cstdlib>
#include <memory>
#include <sstream>

namespace cimhost {

namespace {

struct HashKind {
  const char* prefix;
  std::size_t digest;  // Characters behind the last $ that are no salt, or all of salt and digest.
  const char* cost;    // What the number of rounds, or its logarithm, stands behind.
  long maximumCost;    // About a second: anybody may ask for it.
};

constexpr HashKind kHashKinds[] = {
    {"$6$", 86, "$6$rounds=", 1000000}, {"$2y$", 53, "$2y$", 14}, {"$2b$", 53, "$2b$", 14}};

bool isAffordable(const std::string& hash, const HashKind& kind) {
  const std::string cost = kind.cost;
  return hash.rfind(cost, 0) != 0 ||
         std::strtol(hash.c_str() + cost.size(), nullptr, 10) <= kind.maximumCost;
}

bool isSupportedHash(const std::string& hash) {
  for (const HashKind& kind : kHashKinds) {
    if (hash.rfind(kind.prefix, 0) != 0) continue;
    const std::size_t dollar = hash.rfind('$');
    return hash.size() - dollar - 1 == kind.digest && isAffordable(hash, kind) &&
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

}  // namespace

UserFile::UserFile(const std::string& file) {
  std::istringstream stream(readSmallFile(file));
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
    throw HostError("not a SHA-512 ($6$) or bcrypt ($2y$, $2b$) hash, or one of too many rounds");
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
