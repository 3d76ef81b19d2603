#pragma once

#include <sys/socket.h>

#include <cstdint>
#include <string>

namespace cimhost {

/// A listening TCP socket, without delay between a close and the next bind to the same port.
class ListenSocket {
 public:
  /// `address`: IPv4 or IPv6, as digits. Throws HostError.
  ListenSocket(const std::string& address, std::uint16_t port);
  ~ListenSocket();
  ListenSocket(const ListenSocket&) = delete;
  ListenSocket& operator=(const ListenSocket&) = delete;

  int descriptor() const { return descriptor_; }
  std::uint16_t port() const;
  /// The next connection, not blocking, or -1 when there is none. `size`: as of accept(2).
  int accept(sockaddr* address, socklen_t& size) const;
  /// New connections are refused from now on. Any thread.
  void refuse();

 private:
  int descriptor_;
};

/// The address as digits, without port; an IPv4 address that came over IPv6 as IPv4.
std::string addressText(const sockaddr& address);

/// What counts as one client: an IPv4 address, or the first 64 bits of an IPv6 address.
std::string addressGroup(const sockaddr& address);

}  // namespace cimhost
