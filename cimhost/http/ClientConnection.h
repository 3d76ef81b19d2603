#pragma once

#include <chrono>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_set>

namespace cimhost {

class Exchange;

/// One client's connection, and the request that it carries at the moment.
///
/// A connection has a time by which something must have ended: its request, or the wait for the
/// next one. May be used from several threads.
class ClientConnection {
 public:
  using Clock = std::chrono::steady_clock;

  ClientConnection(int socket, std::string address, std::string group)
      : socket_(socket), address_(std::move(address)), group_(std::move(group)) {}

  const std::string& address() const { return address_; }
  /// What counts as one client where failures are counted.
  const std::string& group() const { return group_; }

  /// `exchange` is the current one, or none, until `deadline`.
  void begin(std::shared_ptr<Exchange> exchange, Clock::time_point deadline);
  /// When the deadline has passed: ends the request with status 503 or, when it is not complete or
  /// was given `grace` already, the connection.
  void expire(Clock::time_point now, Clock::duration grace);
  void cut();

 private:
  int socket_;
  std::string address_;
  std::string group_;
  std::mutex mutex_;
  std::shared_ptr<Exchange> exchange_;
  Clock::time_point deadline_ = Clock::time_point::max();
  bool warned_ = false;
};

/// The open connections of a server. A connection is removed before its socket is closed, so what
/// expire() and cut() do always meets the right socket. May be used from several threads.
class ConnectionTable {
 public:
  void add(ClientConnection* connection);
  void remove(ClientConnection* connection);
  void expire(ClientConnection::Clock::time_point now, ClientConnection::Clock::duration grace);
  void cutAll();

 private:
  std::mutex mutex_;
  std::unordered_set<ClientConnection*> connections_;
};

}  // namespace cimhost
