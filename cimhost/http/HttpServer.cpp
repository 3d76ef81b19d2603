#include "cimhost/http/HttpServer.h"

#include "cimhost/HostError.h"
#include "cimhost/http/SmallFile.h"

#include <gnutls/gnutls.h>
#include <microhttpd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <mutex>
#include <thread>
#include <utility>
#include <vector>

namespace cimhost {

namespace {

using Clock = std::chrono::steady_clock;

// Each has its connections and is run by one thread at a time.
constexpr std::size_t kEventLoops = 2;
constexpr std::chrono::milliseconds kLongestWait{10000};
// Without a descriptor for another connection.
constexpr std::chrono::milliseconds kAcceptPause{100};
constexpr std::chrono::milliseconds kExpiryPeriod{200};
constexpr std::chrono::milliseconds kIdlePeriod{1};
// With a slow reader, who keeps a thread: when others wait for one, and when none do.
constexpr std::chrono::seconds kPatienceWhenFull{2};
constexpr std::chrono::seconds kPatience{60};
constexpr std::size_t kReadBlock = 32U << 10U;
// Beside request line and headers, the memory of a connection holds what is read and written.
constexpr std::size_t kConnectionBuffers = 16U << 10U;
constexpr const char* kPriorities = "NORMAL:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2";

using ExchangePointer = std::shared_ptr<Exchange>;
using ConnectionPointer = std::shared_ptr<ClientConnection>;
using Response = std::unique_ptr<MHD_Response, void (*)(MHD_Response*)>;

gnutls_datum_t datumOf(std::string& text) {
  return {reinterpret_cast<unsigned char*>(text.data()), static_cast<unsigned>(text.size())};
}

void addHeaders(MHD_Response& response, const HttpHeaders& headers) {
  for (const auto& [name, value] : headers) {
    // An empty value, as of Ext, is not taken otherwise.
    MHD_add_response_header(&response, name.c_str(), value.empty() ? " " : value.c_str());
  }
}

void freeString(void* text) {
  delete static_cast<std::string*>(text);
}

Response wholeResponse(std::string body) {
  auto owned = std::make_unique<std::string>(std::move(body));
  MHD_Response* response = MHD_create_response_from_buffer_with_free_callback_cls(
      owned->size(), owned->data(), freeString, owned.get());
  if (response != nullptr) owned.release();
  return {response, MHD_destroy_response};
}

// A stream's source keeps the exchange and its connection.
struct Source {
  ExchangePointer exchange;
  MHD_Connection* connection;
};

ssize_t readSource(void* closure, std::uint64_t, char* bytes, std::size_t size) {
  const Source& source = *static_cast<Source*>(closure);
  const ssize_t got = source.exchange->pipe().read(
      bytes, size, [&source] { MHD_suspend_connection(source.connection); });
  if (got == ReplyPipe::kEnd) return MHD_CONTENT_READER_END_OF_STREAM;
  if (got == ReplyPipe::kCut) return MHD_CONTENT_READER_END_WITH_ERROR;
  return got;
}

void freeSource(void* closure) {
  delete static_cast<Source*>(closure);
}

Response streamedResponse(const ExchangePointer& exchange, MHD_Connection* connection) {
  auto source = std::make_unique<Source>(Source{exchange, connection});
  MHD_Response* response = MHD_create_response_from_callback(MHD_SIZE_UNKNOWN, kReadBlock,
                                                             readSource, source.get(), freeSource);
  if (response != nullptr) source.release();
  return {response, MHD_destroy_response};
}

MHD_Result send(MHD_Connection* connection, Exchange& exchange, int status, Response response) {
  if (response == nullptr) return MHD_NO;
  exchange.replying(status);
  return MHD_queue_response(connection, static_cast<unsigned>(status), response.get());
}

MHD_Result sendRejection(MHD_Connection* connection, Exchange& exchange, bool last) {
  const Rejection& rejection = *exchange.rejection();
  Response response = wholeResponse(exchange.rejectionText());
  if (response == nullptr) return MHD_NO;
  addHeaders(*response, rejection.headers);
  MHD_add_response_header(response.get(), "Content-Type", "text/plain");
  if (last) MHD_add_response_header(response.get(), "Connection", "close");
  return send(connection, exchange, rejection.status, std::move(response));
}

MHD_Result sendReply(MHD_Connection* connection, const ExchangePointer& exchange, bool last) {
  ReplyPipe& pipe = exchange->pipe();
  Response response =
      pipe.isWhole() ? wholeResponse(pipe.takeWhole()) : streamedResponse(exchange, connection);
  if (response == nullptr) return MHD_NO;
  addHeaders(*response, exchange->request().replyHeaders(pipe.takeHeaders()));
  if (pipe.status() == MHD_HTTP_SERVICE_UNAVAILABLE) addHeaders(*response, {{"Retry-After", "1"}});
  if (last) MHD_add_response_header(response.get(), "Connection", "close");
  return send(connection, *exchange, pipe.status(), std::move(response));
}

MHD_Result copyHeader(void* closure, MHD_ValueKind, const char* name, std::size_t nameSize,
                      const char* value, std::size_t valueSize) {
  HttpRequest& request = *static_cast<HttpRequest*>(closure);
  request.addHeader({name, nameSize},
                    value == nullptr ? std::string_view() : std::string_view(value, valueSize));
  return MHD_YES;
}

}  // namespace

// A part of the connections: those of one daemon, which one thread at a time runs.
struct HttpServer::EventLoop {
  struct NewConnection {
    int socket;
    sockaddr_storage address;
    socklen_t size;
    std::unique_ptr<ConnectionTable::Place> place;
  };

  EventLoop(HttpServer& itsServer, std::size_t itsIndex) : server(itsServer), index(itsIndex) {}
  ~EventLoop() {
    for (const NewConnection& each : arrived) close(each.socket);
    if (daemon != nullptr) MHD_stop_daemon(daemon);
  }
  EventLoop(const EventLoop&) = delete;
  EventLoop& operator=(const EventLoop&) = delete;

  void add(NewConnection connection) {
    {
      const std::lock_guard<std::mutex> lock(mutex);
      arrived.push_back(std::move(connection));
    }
    server.services_.pool.kick(index);
  }

  void run() {
    std::vector<NewConnection> added;
    {
      const std::lock_guard<std::mutex> lock(mutex);
      added.swap(arrived);
    }
    for (NewConnection& each : added) {
      place = std::move(each.place);
      // Closes the socket when it fails.
      MHD_add_connection(daemon, each.socket, reinterpret_cast<const sockaddr*>(&each.address),
                         each.size);
      place.reset();
    }
    MHD_run(daemon);
  }

  std::chrono::milliseconds due() const {
    MHD_UNSIGNED_LONG_LONG wait = 0;
    const bool known = MHD_get_timeout(daemon, &wait) == MHD_YES;
    return known ? std::min(kLongestWait, std::chrono::milliseconds(wait)) : kLongestWait;
  }

  int descriptor() const { return MHD_get_daemon_info(daemon, MHD_DAEMON_INFO_EPOLL_FD)->epoll_fd; }

  HttpServer& server;
  std::size_t index;
  MHD_Daemon* daemon = nullptr;
  std::mutex mutex;
  std::vector<NewConnection> arrived;
  std::unique_ptr<ConnectionTable::Place> place;  // Of the connection that is being added.
};

// What the library calls; `closure` is the server or an event loop of it. Nothing may be thrown
// into it.
struct HttpCallbacks {
  static void connectionChanged(void* closure, MHD_Connection* connection, void** context,
                                MHD_ConnectionNotificationCode code) try {
    HttpServer::EventLoop& loop = *static_cast<HttpServer::EventLoop*>(closure);
    if (code == MHD_CONNECTION_NOTIFY_STARTED) {
      *context = addConnection(loop, connection);
    } else if (*context != nullptr) {
      const std::unique_ptr<ConnectionPointer> owned(static_cast<ConnectionPointer*>(*context));
      loop.server.connections_.remove(owned->get());
      *context = nullptr;
    }
  } catch (const std::exception&) {
    // A connection without a context gets no exchange, and is closed by its first request.
  }

  static void* requestStarted(void* closure, const char*, MHD_Connection* connection) try {
    const HttpServer::EventLoop& loop = *static_cast<HttpServer::EventLoop*>(closure);
    HttpServer& server = loop.server;
    const ConnectionPointer* client = clientOf(connection);
    if (client == nullptr) return nullptr;
    auto exchange =
        std::make_shared<Exchange>(server.services_, loop.index, *client, [&loop, connection] {
          MHD_resume_connection(connection);
          loop.server.services_.pool.kick(loop.index);
        });
    (*client)->begin(exchange, Clock::now() + server.services_.limits.requestTimeout);
    return new ExchangePointer(std::move(exchange));
  } catch (const std::exception&) {
    return nullptr;
  }

  static MHD_Result request(void* closure, MHD_Connection* connection, const char* url,
                            const char* method, const char* version, const char* bytes,
                            std::size_t* size, void** context) try {
    if (*context == nullptr) return MHD_NO;
    const ExchangePointer& exchange = *static_cast<ExchangePointer*>(*context);
    if (exchange->isNew()) {
      exchange->request().setRequestLine(method, version);
      MHD_get_connection_values_n(connection, MHD_HEADER_KIND, copyHeader, &exchange->request());
      exchange->checkHeaders(method, url);
      return exchange->isHopeless() ? sendRejection(connection, *exchange, true) : MHD_YES;
    }
    if (*size > 0) {
      const bool wanted = exchange->receive(bytes, *size);
      *size = 0;
      return wanted ? MHD_YES : MHD_NO;
    }
    const bool last = static_cast<HttpServer*>(closure)->services_.draining;
    if (exchange->rejection()) return sendRejection(connection, *exchange, last);
    if (!exchange->isSubmitted()) {
      // The library asks again in its next turn; until then most requests have been answered.
      exchange->submit();
      return MHD_YES;
    }
    const auto suspend = [connection] { MHD_suspend_connection(connection); };
    return exchange->pipe().isReady(suspend) ? sendReply(connection, exchange, last) : MHD_YES;
  } catch (const std::exception&) {
    return MHD_NO;
  }

  static void requestEnded(void* closure, MHD_Connection* connection, void** context,
                           MHD_RequestTerminationCode code) try {
    if (*context == nullptr) return;
    const std::unique_ptr<ExchangePointer> exchange(static_cast<ExchangePointer*>(*context));
    *context = nullptr;
    (*exchange)->end(code == MHD_REQUEST_TERMINATED_COMPLETED_OK);
    HttpServer& server = *static_cast<HttpServer*>(closure);
    if (const ConnectionPointer* client = clientOf(connection)) {
      (*client)->begin(nullptr, Clock::now() + 2 * server.services_.limits.idleTimeout);
    }
  } catch (const std::exception&) {
    // The log line is lost.
  }

  // Only what it says while it starts is of interest: later it is about single clients.
  __attribute__((format(printf, 2, 0))) static void complain(void* closure, const char* format,
                                                             va_list arguments) {
    HttpServer& server = *static_cast<HttpServer*>(closure);
    if (server.started_) return;
    char text[256];
    std::vsnprintf(text, sizeof text, format, arguments);
    server.daemonProblem_ = text;
  }

 private:
  static void* addConnection(HttpServer::EventLoop& loop, MHD_Connection* connection) {
    HttpServer& server = loop.server;
    const auto* address = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS);
    const auto* socket = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD);
    if (address == nullptr || socket == nullptr) return nullptr;
    auto client = std::make_unique<ConnectionPointer>(std::make_shared<ClientConnection>(
        socket->connect_fd, addressText(*address->client_addr), addressGroup(*address->client_addr),
        std::move(loop.place)));
    (*client)->begin(nullptr, Clock::now() + server.services_.limits.idleTimeout);
    server.connections_.add(client->get());
    return client.release();
  }

  static const ConnectionPointer* clientOf(MHD_Connection* connection) {
    const auto* info = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_SOCKET_CONTEXT);
    return info == nullptr ? nullptr : static_cast<ConnectionPointer*>(info->socket_context);
  }
};

TlsFiles readTlsFiles(const std::string& certificateFile, const std::string& keyFile) {
  TlsFiles files{readSmallFile(certificateFile), readSmallFile(keyFile)};
  const gnutls_datum_t certificate = datumOf(files.certificate);
  const gnutls_datum_t key = datumOf(files.key);
  gnutls_certificate_credentials_t credentials = nullptr;
  int error = gnutls_certificate_allocate_credentials(&credentials);
  if (error == GNUTLS_E_SUCCESS) {
    error =
        gnutls_certificate_set_x509_key_mem(credentials, &certificate, &key, GNUTLS_X509_FMT_PEM);
    gnutls_certificate_free_credentials(credentials);
  }
  if (error < 0) {
    throw HostError(certificateFile + " with " + keyFile + ": " + gnutls_strerror(error));
  }
  return files;
}

HttpServer::HttpServer(const HttpSettings& settings, RequestHandler handler, RecordSink log)
    : services_(settings.limits, std::move(handler), std::move(log)),
      connections_(settings.limits.connections, settings.limits.connectionsPerAddress),
      socket_(settings.address, settings.port),
      port_(socket_.port()),
      tls_(settings.tls) {
  services_.setUsers(settings.users);
  startLoops();
  scheduleExpiry();
}

HttpServer::~HttpServer() {
  stop();
}

void HttpServer::startLoops() {
  std::vector<WorkerPool::Source> sources;
  for (std::size_t i = 0; i < kEventLoops; ++i) {
    loops_.push_back(std::make_unique<EventLoop>(*this, i));
    EventLoop& loop = *loops_.back();
    loop.daemon = startDaemon(loop);
    if (loop.daemon == nullptr) {
      throw HostError("the HTTP server cannot start: " + daemonProblem_);
    }
    sources.push_back({[&loop] { return loop.descriptor(); }, [&loop] { return loop.due(); },
                       [&loop] { loop.run(); }});
  }
  sources.push_back({[this] { return isAccepting() ? socket_.descriptor() : -1; },
                     [this] { return isAccepting() ? kLongestWait : kAcceptPause; },
                     [this] { acceptConnections(); }});
  started_ = true;
  services_.pool.start(std::move(sources));
}

MHD_Daemon* HttpServer::startDaemon(EventLoop& loop) {
  unsigned flags =
      MHD_USE_EPOLL | MHD_USE_NO_LISTEN_SOCKET | MHD_ALLOW_SUSPEND_RESUME | MHD_USE_ERROR_LOG;
  const ServeLimits& limits = services_.limits;
  const auto number = [](MHD_OPTION option, std::size_t value) {
    return MHD_OptionItem{option, static_cast<intptr_t>(value), nullptr};
  };
  std::vector<MHD_OptionItem> options = {
      number(MHD_OPTION_CONNECTION_MEMORY_LIMIT, limits.headerSize + kConnectionBuffers),
      number(MHD_OPTION_CONNECTION_LIMIT, limits.connections),
      number(MHD_OPTION_CONNECTION_TIMEOUT, static_cast<std::size_t>(limits.idleTimeout.count())),
  };
  if (tls_) {
    flags |= MHD_USE_TLS;
    options.push_back({MHD_OPTION_HTTPS_MEM_CERT, 0, tls_->certificate.data()});
    options.push_back({MHD_OPTION_HTTPS_MEM_KEY, 0, tls_->key.data()});
    options.push_back({MHD_OPTION_HTTPS_PRIORITIES, 0, const_cast<char*>(kPriorities)});
  }
  options.push_back({MHD_OPTION_END, 0, nullptr});
  return MHD_start_daemon(flags, 0, nullptr, nullptr, &HttpCallbacks::request, this,   //
                          MHD_OPTION_EXTERNAL_LOGGER, &HttpCallbacks::complain, this,  //
                          MHD_OPTION_NOTIFY_CONNECTION, &HttpCallbacks::connectionChanged,
                          &loop,                                                               //
                          MHD_OPTION_URI_LOG_CALLBACK, &HttpCallbacks::requestStarted, &loop,  //
                          MHD_OPTION_NOTIFY_COMPLETED, &HttpCallbacks::requestEnded, this,     //
                          MHD_OPTION_ARRAY, options.data(), MHD_OPTION_END);
}

bool HttpServer::isAccepting() const {
  return !services_.draining && Clock::now() >= acceptAgain_;
}

void HttpServer::acceptConnections() {
  while (isAccepting()) {
    EventLoop::NewConnection connection{};
    connection.size = sizeof connection.address;
    auto* const address = reinterpret_cast<sockaddr*>(&connection.address);
    connection.socket = socket_.accept(address, connection.size);
    if (connection.socket < 0) {
      const bool none = errno == EAGAIN || errno == EWOULDBLOCK;
      if (!none) acceptAgain_ = Clock::now() + kAcceptPause;
      return;
    }
    connection.place = connections_.reserve(addressGroup(*address));
    if (connection.place != nullptr) {
      loops_[nextLoop_++ % loops_.size()]->add(std::move(connection));
    } else {
      close(connection.socket);
    }
  }
}

void HttpServer::scheduleExpiry() {
  services_.housekeeper.at(Clock::now() + kExpiryPeriod, [this] {
    const auto patience = services_.pool.isFull() ? kPatienceWhenFull : kPatience;
    connections_.expire(Clock::now(), services_.limits.idleTimeout, patience);
    scheduleExpiry();
  });
}

void HttpServer::drain() {
  if (services_.draining.exchange(true)) return;
  socket_.refuse();
  connections_.cutIncomplete();
}

bool HttpServer::waitUntilIdle(std::chrono::milliseconds time) {
  const auto end = Clock::now() + time;
  while (services_.count > 0) {
    if (Clock::now() >= end) return false;
    std::this_thread::sleep_for(kIdlePeriod);
  }
  return true;
}

void HttpServer::stop() {
  drain();
  cut();
  services_.pool.stop();
  services_.housekeeper.stop();
  // Nothing may be suspended when a daemon stops: no request is from cut() on.
  loops_.clear();
}

}  // namespace cimhost
