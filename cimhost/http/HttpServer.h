#pragma once

#include "cimhost/ServeOptions.h"
#include "cimhost/http/Exchange.h"
#include "cimhost/http/ListenSocket.h"

#include <atomic>
#include <chrono>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

struct MHD_Daemon;

namespace cimhost {

/// Certificate chain and private key, as PEM texts.
struct TlsFiles {
  std::string certificate;
  std::string key;
};

/// Reads both files and checks that they belong together. Throws HostError.
TlsFiles readTlsFiles(const std::string& certificateFile, const std::string& keyFile);

/// What an HttpServer is made from.
struct HttpSettings {
  std::string address = "127.0.0.1";
  std::uint16_t port = 0;  ///< 0: any free one.
  std::optional<TlsFiles> tls;
  std::shared_ptr<Authenticator> users;  ///< Null: nobody is asked.
  ServeLimits limits;
};

/// Takes CIM operations over HTTP/1.1 (DSP0200, 7): POST and M-POST to any path, and `GET
/// /healthz`.
///
/// Its threads move bytes and run requests, at most limits.threads of these at once, and none that
/// takes its time keeps others from theirs. Malformed, oversized, slow and unauthorized requests
/// never reach the handler.
class HttpServer {
 public:
  /// Listens at once. Throws HostError.
  HttpServer(const HttpSettings& settings, RequestHandler handler, RecordSink log);
  /// As stop().
  ~HttpServer();
  HttpServer(const HttpServer&) = delete;
  HttpServer& operator=(const HttpServer&) = delete;

  std::uint16_t port() const { return port_; }

  /// Who may come in from now on. Any thread.
  void setUsers(std::shared_ptr<Authenticator> users) { services_.setUsers(std::move(users)); }

  // Of one thread.
  /// No new connections; new requests get status 503; what runs goes on.
  void drain();
  /// Waits until no request is there any more. False: not within `time`.
  bool waitUntilIdle(std::chrono::milliseconds time);
  /// Ends every reply that is not complete; handlers learn it from their next write.
  void cut() { connections_.cutAll(); }
  /// As drain() and cut(); returns when every handler has returned.
  void stop();

 private:
  friend struct HttpCallbacks;

  struct EventLoop;

  void startLoops();
  MHD_Daemon* startDaemon(EventLoop& loop);
  bool isAccepting() const;
  void acceptConnections();
  void scheduleExpiry();

  ExchangeServices services_;
  ConnectionTable connections_;
  ListenSocket socket_;
  std::uint16_t port_;
  std::optional<TlsFiles> tls_;
  std::vector<std::unique_ptr<EventLoop>> loops_;
  // Of the thread that accepts.
  std::size_t nextLoop_ = 0;
  std::chrono::steady_clock::time_point acceptAgain_{};
  std::string daemonProblem_;
  bool started_ = false;
};

}  // namespace cimhost
