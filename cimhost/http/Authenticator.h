#pragma once

#include "cimhost/http/UserFile.h"

#include <array>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace cimhost {

struct Credentials {
  std::string user;
  std::string password;

  Credentials() = default;
  Credentials(std::string userName, std::string secret)
      : user(std::move(userName)), password(std::move(secret)) {}
  Credentials(Credentials&&) = default;
  Credentials& operator=(Credentials&&) = default;
  Credentials(const Credentials&) = delete;
  Credentials& operator=(const Credentials&) = delete;
  /// Overwrites the password.
  ~Credentials();
};

/// What the value of an Authorization header holds (Basic, RFC 7617); nullopt for another scheme,
/// for what is not Base64, has no colon, or is longer than 1 KiB.
std::optional<Credentials> parseBasic(std::string_view authorization);

/// Says whether credentials are right.
///
/// Remembers of each user the last credentials that were, as an HMAC-SHA-256 under a random key of
/// this object, so that the slow hash is computed once and no password is kept. May be called from
/// several threads.
class Authenticator {
 public:
  /// Throws HostError as UserFile does.
  explicit Authenticator(const std::string& usersFile);

  /// Quick: true when these very credentials have been found right before.
  bool isKnown(const Credentials& credentials) const;
  /// Slow unless they are known.
  bool verify(const Credentials& credentials);

 private:
  using Digest = std::array<unsigned char, 32>;

  Digest digestOf(const Credentials& credentials) const;

  UserFile users_;
  std::array<unsigned char, 32> key_;
  mutable std::mutex mutex_;
  std::unordered_map<std::string, Digest> known_;
};

}  // namespace cimhost
