#include "cimhost/http/ListenSocket.h"

#include "cimhost/HostError.h"

#include <arpa/inet.h>
#include <netdb.h>
#include <netinet/in.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>

namespace cimhost {

namespace {

constexpr int kBacklog = 511;

using AddressList = std::unique_ptr<addrinfo, void (*)(addrinfo*)>;

AddressList parse(const std::string& address, std::uint16_t port) {
  addrinfo hints{};
  hints.ai_flags = AI_NUMERICHOST | AI_NUMERICSERV | AI_PASSIVE;
  hints.ai_socktype = SOCK_STREAM;
  addrinfo* found = nullptr;
  const int error = getaddrinfo(address.c_str(), std::to_string(port).c_str(), &hints, &found);
  if (error != 0) throw HostError(address + ": " + gai_strerror(error));
  return {found, freeaddrinfo};
}

bool openOn(int descriptor, const addrinfo& address) {
  const int on = 1;
  return descriptor >= 0 && setsockopt(descriptor, SOL_SOCKET, SO_REUSEADDR, &on, sizeof on) == 0 &&
         bind(descriptor, address.ai_addr, address.ai_addrlen) == 0 &&
         listen(descriptor, kBacklog) == 0;
}

const in6_addr& v6(const sockaddr& address) {
  return reinterpret_cast<const sockaddr_in6&>(address).sin6_addr;
}

const in_addr& v4(const sockaddr& address) {
  return reinterpret_cast<const sockaddr_in&>(address).sin_addr;
}

}  // namespace

ListenSocket::ListenSocket(const std::string& address, std::uint16_t port) {
  const AddressList found = parse(address, port);
  descriptor_ = socket(found->ai_family, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
  if (openOn(descriptor_, *found)) return;
  const std::string problem = std::strerror(errno);
  if (descriptor_ >= 0) close(descriptor_);
  throw HostError("cannot listen on " + address + " port " + std::to_string(port) + ": " + problem);
}

ListenSocket::~ListenSocket() {
  close(descriptor_);
}

std::uint16_t ListenSocket::port() const {
  sockaddr_storage address{};
  socklen_t size = sizeof address;
  if (getsockname(descriptor_, reinterpret_cast<sockaddr*>(&address), &size) != 0) return 0;
  return ntohs(address.ss_family == AF_INET6
                   ? reinterpret_cast<const sockaddr_in6&>(address).sin6_port
                   : reinterpret_cast<const sockaddr_in&>(address).sin_port);
}

int ListenSocket::accept(sockaddr* address, socklen_t& size) const {
  int accepted = -1;
  do {
    accepted = accept4(descriptor_, address, &size, SOCK_CLOEXEC | SOCK_NONBLOCK);
  } while (accepted < 0 && (errno == EINTR || errno == ECONNABORTED));
  return accepted;
}

void ListenSocket::refuse() {
  shutdown(descriptor_, SHUT_RDWR);
}

std::string addressText(const sockaddr& address) {
  char text[INET6_ADDRSTRLEN] = "?";
  if (address.sa_family == AF_INET6) {
    inet_ntop(AF_INET6, &v6(address), text, sizeof text);
  } else if (address.sa_family == AF_INET) {
    inet_ntop(AF_INET, &v4(address), text, sizeof text);
  }
  constexpr const char* kMapped = "::ffff:";
  const std::string result = text;
  const bool mapped = result.rfind(kMapped, 0) == 0 && result.find('.') != std::string::npos;
  return mapped ? result.substr(std::strlen(kMapped)) : result;
}

std::string addressGroup(const sockaddr& address) {
  if (address.sa_family != AF_INET6 || IN6_IS_ADDR_V4MAPPED(&v6(address))) {
    return addressText(address);
  }
  return std::string(reinterpret_cast<const char*>(&v6(address)), 8);
}

}  // namespace cimhost
