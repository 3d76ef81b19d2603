#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string>

namespace cimhost {

/// What a server allows its clients. Nothing here is unlimited.
struct ServeLimits {
  std::size_t requestSize = 8U << 20U;  ///< Bytes of a request's body.
  std::size_t headerSize = 16U << 10U;  ///< Bytes of request line and headers.
  std::size_t connections = 512;        ///< In all.
  std::size_t connectionsPerAddress = 256;
  std::size_t threads = 8;                   ///< Requests that run at the same time.
  std::size_t queue = 256;                   ///< Requests that wait for a thread.
  std::chrono::seconds idleTimeout{30};      ///< Without a byte on a connection.
  std::chrono::seconds requestTimeout{300};  ///< From a request's first line to its last byte.
};

/// The options of `cimhost serve`. Files as given, relative to the directory of the call.
struct ServeOptions {
  std::string bind = "127.0.0.1";  ///< An IPv4 or IPv6 address.
  std::uint16_t port = 5988;       ///< 0: any free one.
  std::string tlsCertificate;      ///< PEM files; both or none.
  std::string tlsKey;
  std::string users;  ///< htpasswd file; empty: nobody is asked who they are.
  bool insecure = false;
  std::string log;  ///< Empty: standard error.
  std::chrono::seconds shutdownTimeout{30};
  ServeLimits limits;
};

/// True for addresses of 127.0.0.0/8 and ::1.
bool isLoopback(const std::string& address);

/// Why these options cannot be used together; empty when they can. An address that other machines
/// reach needs TLS and users, or `insecure`.
std::string serveOptionsProblem(const ServeOptions& options);

}  // namespace cimhost
