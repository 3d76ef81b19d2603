#pragma once

#include <string>
#include <string_view>
#include <unordered_map>

namespace cimhost {

/// The users of an htpasswd file and the hashes of their passwords, read-only.
///
/// Lines are `name:hash`; empty ones and those that start with `#` are skipped. Hashes are SHA-512
/// crypt ($6$) or bcrypt ($2y$, $2b$).
class UserFile {
 public:
  /// Throws HostError with file and line: unreadable, larger than 1 MiB, a line without a name or
  /// with another kind of hash, a name that comes twice, no user at all.
  explicit UserFile(const std::string& file);

  /// Takes as long for a name that is not there as for one that is: a hash is computed in either
  /// case. Slow by design (milliseconds to seconds). May be called from several threads.
  bool verify(const std::string& name, const std::string& password) const;

  std::size_t size() const { return hashes_.size(); }

 private:
  void addLine(std::string_view line);

  std::unordered_map<std::string, std::string> hashes_;
  std::string anyHash_;  // For names that are not there.
};

}  // namespace cimhost
