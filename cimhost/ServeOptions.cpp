#include "cimhost/ServeOptions.h"

#include <arpa/inet.h>
#include <netinet/in.h>

namespace cimhost {

namespace {

bool isV4(const std::string& address, in_addr& parsed) {
  return inet_pton(AF_INET, address.c_str(), &parsed) == 1;
}

bool isV6(const std::string& address, in6_addr& parsed) {
  return inet_pton(AF_INET6, address.c_str(), &parsed) == 1;
}

}  // namespace

bool isLoopback(const std::string& address) {
  in_addr v4{};
  in6_addr v6{};
  if (isV4(address, v4)) return (ntohl(v4.s_addr) >> 24U) == IN_LOOPBACKNET;
  return isV6(address, v6) && IN6_IS_ADDR_LOOPBACK(&v6);
}

std::string serveOptionsProblem(const ServeOptions& options) {
  in_addr v4{};
  in6_addr v6{};
  if (!isV4(options.bind, v4) && !isV6(options.bind, v6)) {
    return "--bind: not an IPv4 or IPv6 address: " + options.bind;
  }
  if (options.tlsCertificate.empty() != options.tlsKey.empty()) {
    return "--tls-cert and --tls-key go together";
  }
  if (options.insecure || isLoopback(options.bind)) return {};
  if (!options.tlsCertificate.empty() && !options.users.empty()) return {};
  return "--bind " + options.bind +
         " can be reached from other machines: it needs --tls-cert, --tls-key and --users, or "
         "--insecure";
}

}  // namespace cimhost
