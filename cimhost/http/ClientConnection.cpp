#include "cimhost/http/ClientConnection.h"

#include "cimhost/http/Exchange.h"

#include <sys/socket.h>

#include <utility>

namespace cimhost {

void ClientConnection::begin(std::shared_ptr<Exchange> exchange, Clock::time_point deadline) {
  // The last use of an exchange writes the log: not under the lock.
  std::shared_ptr<Exchange> previous = std::move(exchange);
  const std::lock_guard<std::mutex> lock(mutex_);
  exchange_.swap(previous);
  deadline_ = deadline;
  warned_ = false;
  endSeen_ = false;
}

// The library learns of events, not of states: an end that arrives together with the bytes before
// it goes unseen. Seen twice, because bytes may be on their way through the library.
bool ClientConnection::isAbandoned() {
  if (exchange_ != nullptr && exchange_->isSubmitted()) return false;
  char byte = 0;
  const bool ended = recv(socket_, &byte, 1, MSG_PEEK | MSG_DONTWAIT) == 0;
  return std::exchange(endSeen_, ended) && ended;
}

void ClientConnection::expire(Clock::time_point now, Clock::duration grace,
                              Clock::duration patience) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (exchange_ != nullptr && exchange_->pipe().isReadSlowly(patience)) {
    exchange_->cut("was read too slowly");
  }
  if (now < deadline_ && !isAbandoned()) return;
  if (exchange_ == nullptr || warned_ || !exchange_->cut("took too long")) {
    shutdown(socket_, SHUT_RDWR);
  }
  warned_ = true;
  deadline_ = now + grace;
}

void ClientConnection::cut() {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (exchange_ == nullptr || !exchange_->cut("the server stops")) shutdown(socket_, SHUT_RDWR);
}

void ClientConnection::cutIncomplete() {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (exchange_ != nullptr && !exchange_->isSubmitted()) shutdown(socket_, SHUT_RDWR);
}

std::unique_ptr<ConnectionTable::Place> ConnectionTable::reserve(const std::string& group) {
  const std::lock_guard<std::mutex> lock(mutex_);
  if (reserved_ >= maximum_) return nullptr;
  const auto entry = ofGroup_.try_emplace(group, 0).first;
  if (entry->second >= maximumOfGroup_) return nullptr;
  auto place = std::make_unique<Place>(*this, group);
  ++entry->second;
  ++reserved_;
  return place;
}

void ConnectionTable::release(const std::string& group) {
  const std::lock_guard<std::mutex> lock(mutex_);
  const auto found = ofGroup_.find(group);
  if (--found->second == 0) ofGroup_.erase(found);
  --reserved_;
}

void ConnectionTable::add(ClientConnection* connection) {
  const std::lock_guard<std::mutex> lock(mutex_);
  connections_.insert(connection);
}

void ConnectionTable::remove(ClientConnection* connection) {
  const std::lock_guard<std::mutex> lock(mutex_);
  connections_.erase(connection);
}

void ConnectionTable::expire(ClientConnection::Clock::time_point now,
                             ClientConnection::Clock::duration grace,
                             ClientConnection::Clock::duration patience) {
  const std::lock_guard<std::mutex> lock(mutex_);
  for (ClientConnection* each : connections_) each->expire(now, grace, patience);
}

void ConnectionTable::cutAll() {
  const std::lock_guard<std::mutex> lock(mutex_);
  for (ClientConnection* each : connections_) each->cut();
}

void ConnectionTable::cutIncomplete() {
  const std::lock_guard<std::mutex> lock(mutex_);
  for (ClientConnection* each : connections_) each->cutIncomplete();
}

}  // namespace cimhost
