#pragma once

#include <chrono>
#include <cstddef>
#include <memory>
#include <mutex>
#include <string>
#include <unordered_map>
#include <unordered_set>

namespace cimhost {

class ClientConnection;
class Exchange;

/// The open connections of a server, and how many more it takes. A connection is removed before its
/// socket is closed, so what expire() and cut() do always meets the right socket. May be used from
/// several threads.
class ConnectionTable {
 public:
  ConnectionTable(std::size_t maximum, std::size_t maximumOfGroup)
      : maximum_(maximum), maximumOfGroup_(maximumOfGroup) {}

  /// The place of a connection, from here to the end of the object.
  class Place {
   public:
    Place(ConnectionTable& table, std::string group) : table_(table), group_(std::move(group)) {}
    ~Place() { table_.release(group_); }
    Place(const Place&) = delete;
    Place& operator=(const Place&) = delete;

   private:
    ConnectionTable& table_;
    std::string group_;
  };

  /// A place for a connection that comes from there, or null when it may not.
  std::unique_ptr<Place> reserve(const std::string& group);
  void add(ClientConnection* connection);
  void remove(ClientConnection* connection);
  void expire(std::chrono::steady_clock::time_point now, std::chrono::steady_clock::duration grace,
              std::chrono::steady_clock::duration patience);
  void cutAll();
  void cutIncomplete();

 private:
  void release(const std::string& group);

  std::size_t maximum_;
  std::size_t maximumOfGroup_;
  std::mutex mutex_;
  std::unordered_set<ClientConnection*> connections_;
  std::size_t reserved_ = 0;
  std::unordered_map<std::string, std::size_t> ofGroup_;
};

/// One client's connection, and the request that it carries at the moment.
///
/// A connection has a time by which something must have ended: its request, or the wait for the
/// next one. May be used from several threads.
class ClientConnection {
 public:
  using Clock = std::chrono::steady_clock;

  ClientConnection(int socket, std::string address, std::string group,
                   std::unique_ptr<ConnectionTable::Place> place)
      : socket_(socket),
        address_(std::move(address)),
        group_(std::move(group)),
        place_(std::move(place)) {}

  const std::string& address() const { return address_; }
  /// What counts as one client where failures are counted.
  const std::string& group() const { return group_; }

  /// `exchange` is the current one, or none, until `deadline`.
  void begin(std::shared_ptr<Exchange> exchange, Clock::time_point deadline);
  /// When the deadline has passed: ends the request with status 503 or, when it is not complete or
  /// was given `grace` already, the connection.
  /// Ends the connection as well when the client has left in the middle of a request.
  /// Cuts a reply, too, that has been read too slowly for `patience`.
  void expire(Clock::time_point now, Clock::duration grace, Clock::duration patience);
  void cut();
  /// Ends the connection when it carries a part of a request.
  void cutIncomplete();

 private:
  bool isAbandoned();

  int socket_;
  std::string address_;
  std::string group_;
  std::unique_ptr<ConnectionTable::Place> place_;
  std::mutex mutex_;
  std::shared_ptr<Exchange> exchange_;
  Clock::time_point deadline_ = Clock::time_point::max();
  bool warned_ = false;
  bool endSeen_ = false;
};

}  // namespace cimhost
