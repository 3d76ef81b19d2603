#include "cimhost/http/Authenticator.h"

#include "cimhost/HostError.h"

#include <gnutls/crypto.h>
#include <gnutls/gnutls.h>
#include <string.h>
#include <strings.h>

namespace cimhost {

namespace {

constexpr std::size_t kMaximumSize = 1024;
constexpr std::string_view kScheme = "Basic ";

std::optional<std::string> decodeBase64(std::string_view text) {
  std::string copy(text);
  gnutls_datum_t encoded{reinterpret_cast<unsigned char*>(copy.data()),
                         static_cast<unsigned>(copy.size())};
  gnutls_datum_t decoded{nullptr, 0};
  if (gnutls_base64_decode2(&encoded, &decoded) != GNUTLS_E_SUCCESS) return std::nullopt;
  std::string result(reinterpret_cast<char*>(decoded.data), decoded.size);
  gnutls_memset(decoded.data, 0, decoded.size);
  gnutls_free(decoded.data);
  return result;
}

}  // namespace

Credentials::~Credentials() {
  explicit_bzero(password.data(), password.size());
}

std::optional<Credentials> parseBasic(std::string_view authorization) {
  if (authorization.size() > kMaximumSize || authorization.size() <= kScheme.size()) {
    return std::nullopt;
  }
  if (strncasecmp(authorization.data(), kScheme.data(), kScheme.size()) != 0) return std::nullopt;
  authorization.remove_prefix(kScheme.size());
  authorization.remove_prefix(std::min(authorization.find_first_not_of(' '), authorization.size()));
  const auto decoded = decodeBase64(authorization);
  if (!decoded) return std::nullopt;
  const std::size_t colon = decoded->find(':');
  if (colon == std::string::npos) return std::nullopt;
  return Credentials(decoded->substr(0, colon), decoded->substr(colon + 1));
}

Authenticator::Authenticator(const std::string& usersFile) : users_(usersFile), key_{} {
  if (gnutls_rnd(GNUTLS_RND_KEY, key_.data(), key_.size()) != GNUTLS_E_SUCCESS) {
    throw HostError("no random numbers for a key");
  }
}

Authenticator::Digest Authenticator::digestOf(const Credentials& credentials) const {
  std::string text = credentials.user + ":" + credentials.password;
  Digest digest{};
  gnutls_hmac_fast(GNUTLS_MAC_SHA256, key_.data(), key_.size(), text.data(), text.size(),
                   digest.data());
  explicit_bzero(text.data(), text.size());
  return digest;
}

bool Authenticator::isKnown(const Credentials& credentials) const {
  const Digest digest = digestOf(credentials);
  const std::lock_guard<std::mutex> lock(mutex_);
  const auto found = known_.find(credentials.user);
  return found != known_.end() &&
         gnutls_memcmp(found->second.data(), digest.data(), digest.size()) == 0;
}

bool Authenticator::verify(const Credentials& credentials) {
  if (isKnown(credentials)) return true;
  if (!users_.verify(credentials.user, credentials.password)) return false;
  const Digest digest = digestOf(credentials);
  const std::lock_guard<std::mutex> lock(mutex_);
  known_[credentials.user] = digest;
  return true;
}

}  // namespace cimhost
