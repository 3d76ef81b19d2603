#pragma once

#include "cimhost/ServeOptions.h"
#include "cimhost/http/Authenticator.h"
#include "cimhost/http/ClientConnection.h"
#include "cimhost/http/FailureDelays.h"
#include "cimhost/http/Housekeeper.h"
#include "cimhost/http/HttpRequest.h"
#include "cimhost/http/ReplyPipe.h"
#include "cimhost/http/RequestLog.h"
#include "cimhost/http/WorkerPool.h"

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>

namespace cimhost {

/// Answers one request; called on a worker's thread, several at once. Must not throw.
using RequestHandler = std::function<RequestSummary(const CimXmlRequest&, ReplyStream&)>;
/// Called once for each request when it has ended, on any thread. Must not throw.
using RecordSink = std::function<void(const RequestRecord&)>;

/// What the requests of one server share.
struct ExchangeServices {
  ExchangeServices(const ServeLimits& serveLimits, RequestHandler requestHandler,
                   RecordSink recordSink)
      : limits(serveLimits),
        handler(std::move(requestHandler)),
        log(std::move(recordSink)),
        pool(serveLimits.threads, serveLimits.queue) {}

  std::shared_ptr<Authenticator> users() const;
  void setUsers(std::shared_ptr<Authenticator> users);

  const ServeLimits limits;
  const RequestHandler handler;
  const RecordSink log;
  std::atomic<bool> draining{false};
  std::atomic<std::size_t> bodyBytes{0};  // Of all requests.
  FailureDelays delays;
  std::atomic<std::size_t> count{0};  // How many exchanges are alive.
  // Last, so that their threads end before anything that these use.
  WorkerPool pool;
  Housekeeper housekeeper;

 private:
  std::atomic<bool> asksUsers_{false};
  mutable std::mutex usersMutex_;
  std::shared_ptr<Authenticator> users_;
};

/// One request and its reply: from the request line to the last byte, or the client's end.
///
/// The connection's thread feeds it, a worker answers it, and the one that lets go last writes the
/// log.
class Exchange final : public std::enable_shared_from_this<Exchange> {
 public:
  /// `source`: the connection's one in the pool.
  Exchange(ExchangeServices& services, std::size_t source,
           std::shared_ptr<ClientConnection> connection, ReplyPipe::Callback wake);
  ~Exchange();
  Exchange(const Exchange&) = delete;
  Exchange& operator=(const Exchange&) = delete;

  // On the connection's thread.
  HttpRequest& request() { return request_; }
  /// True until checkHeaders().
  bool isNew() const { return !checked_; }
  /// Once request() has its request line and headers. `url`: the path.
  void checkHeaders(const std::string& method, const std::string& url);
  /// The transport's own answer; nullopt when the handler is to be asked.
  const std::optional<Rejection>& rejection() const { return rejection_; }
  /// Its body. What the client itself sent stays in the log.
  std::string rejectionText() const { return textOf(*rejection_); }
  /// True when a rejection is not worth the wait for the body.
  bool isHopeless() const;
  /// False: more than anybody reads.
  bool receive(const char* bytes, std::size_t size);
  bool isSubmitted() const { return submitted_; }
  /// The request is complete: hands it to a worker. pipe() has the reply.
  void submit();
  ReplyPipe& pipe() { return pipe_; }
  /// A reply with this status is being sent.
  void replying(int status) { sentStatus_ = status; }
  /// The transport is done with it. `complete`: the reply was sent to its end.
  void end(bool complete);

  /// Any thread: ends the reply before its time, for a reason that the log tells. False when the
  /// request is not complete, so that there is nothing to reply to.
  bool cut(const char* reason);

 private:
  static std::string textOf(const Rejection& rejection);
  void reject(Rejection rejection);
  void checkUser();
  void enqueue();
  void run();
  bool authenticate();
  bool waitForTurn();
  void answer(const Rejection& rejection);
  RequestRecord takeRecord();
  void releaseBody();

  ExchangeServices& services_;
  const std::size_t source_;
  std::shared_ptr<ClientConnection> connection_;
  HttpRequest request_;
  ReplyPipe pipe_;
  std::chrono::steady_clock::time_point start_;
  std::optional<Rejection> rejection_;  // Of the connection's thread.
  std::shared_ptr<Authenticator> users_;
  std::optional<Credentials> credentials_;  // To be verified.
  bool hasTurn_ = false;
  std::size_t received_ = 0;
  std::size_t claimed_ = 0;  // Of services_.bodyBytes.
  std::atomic<bool> submitted_{false};
  bool checked_ = false;
  bool health_ = false;
  int sentStatus_ = 0;
  bool complete_ = false;
  std::atomic<const char*> cutReason_{nullptr};
  // Of the worker.
  RequestSummary summary_;
  std::string note_;
};

}  // namespace cimhost
