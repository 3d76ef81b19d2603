#include "cimhost/http/Exchange.h"

#include <malloc.h>

namespace cimhost {

namespace {

using Clock = std::chrono::steady_clock;

constexpr int kUnavailable = 503;
// All bodies together may take this many times what one may.
constexpr std::size_t kBodiesAtOnce = 8;
// A body up to this size is read although nobody wants it, so that the connection stays usable, and
// leaves no memory behind that is worth giving back.
constexpr std::size_t kSmallBody = 64U << 10U;

Rejection unauthorized(const std::string& reason) {
  return {401, reason, {{"WWW-Authenticate", "Basic realm=\"cimhost\", charset=\"UTF-8\""}}};
}

}  // namespace

std::shared_ptr<Authenticator> ExchangeServices::users() const {
  if (!asksUsers_) return nullptr;
  const std::lock_guard<std::mutex> lock(usersMutex_);
  return users_;
}

void ExchangeServices::setUsers(std::shared_ptr<Authenticator> users) {
  const std::lock_guard<std::mutex> lock(usersMutex_);
  users_ = std::move(users);
  asksUsers_ = users_ != nullptr;
}

Exchange::Exchange(ExchangeServices& services, std::size_t source,
                   std::shared_ptr<ClientConnection> connection, ReplyPipe::Callback wake)
    : services_(services),
      source_(source),
      connection_(std::move(connection)),
      pipe_(std::move(wake)),
      start_(Clock::now()) {
  ++services_.count;
}

Exchange::~Exchange() {
  releaseBody();
  if (!health_) services_.log(takeRecord());
  --services_.count;
}

RequestRecord Exchange::takeRecord() {
  RequestRecord record;
  record.client = connection_->address();
  record.user = request_.user();
  record.summary = std::move(summary_);
  record.summary.httpStatus = sentStatus_;
  record.bytes = rejection_ ? 0 : pipe_.bytes();
  record.duration = std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - start_);
  record.complete = complete_;
  const char* const cutReason = cutReason_;
  if (rejection_) {
    record.note = rejection_->reason;
  } else {
    record.note = cutReason != nullptr ? cutReason : note_;
  }
  return record;
}

void Exchange::releaseBody() {
  request_.dropBody();
  services_.bodyBytes -= claimed_;
  claimed_ = 0;
}

void Exchange::checkHeaders(const std::string& method, const std::string& url) {
  checked_ = true;
  const bool draining = services_.draining;
  if (method == "GET" && url == "/healthz") {
    health_ = true;
    reject(draining ? Rejection{kUnavailable, "shutting down", {}} : Rejection{200, "ok", {}});
  } else if (auto problem = request_.checkHeaders(services_.limits.requestSize)) {
    reject(*problem);
  } else if (draining) {
    reject({kUnavailable, "shutting down", {}});
  } else {
    checkUser();
  }
}

void Exchange::reject(Rejection rejection) {
  rejection_ = std::move(rejection);
  releaseBody();
}

void Exchange::checkUser() {
  users_ = services_.users();
  if (users_ == nullptr) return;
  const auto text = request_.header("Authorization");
  auto credentials = text ? parseBasic(*text) : std::nullopt;
  if (!credentials) {
    reject(unauthorized(text ? "credentials that cannot be read" : "no credentials"));
  } else if (users_->isKnown(*credentials)) {
    request_.setUser(credentials->user);
  } else {
    credentials_ = std::move(credentials);
  }
}

bool Exchange::isHopeless() const {
  return rejection_ && request_.contentLength().value_or(0) > kSmallBody;
}

bool Exchange::receive(const char* bytes, std::size_t size) {
  received_ += size;
  // Only a body whose length was not told comes so far.
  if (received_ > 2 * services_.limits.requestSize) return false;
  if (rejection_) return true;
  if (received_ > services_.limits.requestSize) {
    reject({413,
            "requests may have " + std::to_string(services_.limits.requestSize) + " bytes at most",
            {}});
    return true;
  }
  claimed_ += size;
  if ((services_.bodyBytes += size) > kBodiesAtOnce * services_.limits.requestSize) {
    reject({kUnavailable, "too many large requests", {}});
  } else {
    request_.appendBody(bytes, size);
  }
  return true;
}

void Exchange::submit() {
  submitted_ = true;
  enqueue();
}

void Exchange::enqueue() {
  if (services_.pool.tryPush(source_, [self = shared_from_this()] { self->run(); })) return;
  note_ = "too many requests wait";
  pipe_.cut(kUnavailable);
}

void Exchange::run() {
  if (!pipe_.isOver()) {
    if (!authenticate()) return;
    summary_ = services_.handler(request_, pipe_);
    // What reading it took would stay with the thread: ten times as much as the body has.
    const bool large = request_.body().size() > kSmallBody;
    releaseBody();
    if (large) malloc_trim(0);
  }
  pipe_.finish();
}

bool Exchange::authenticate() {
  if (!credentials_) return true;
  const std::string& group = connection_->group();
  if (!users_->isKnown(*credentials_)) {
    if (!hasTurn_ && !waitForTurn()) return false;
    if (!users_->verify(*credentials_)) {
      services_.delays.failed(group, Clock::now());
      answer(unauthorized("wrong credentials of " + credentials_->user));
      return false;
    }
    services_.delays.succeeded(group);
  }
  request_.setUser(credentials_->user);
  credentials_.reset();
  return true;
}

bool Exchange::waitForTurn() {
  const auto now = Clock::now();
  const auto wait = services_.delays.reserve(connection_->group(), now);
  if (!wait) {
    answer({429, "too many wrong credentials", {{"Retry-After", "15"}}});
    return false;
  }
  hasTurn_ = true;
  if (wait->count() == 0) return true;
  services_.housekeeper.at(now + *wait, [self = shared_from_this()] { self->enqueue(); });
  return false;
}

std::string Exchange::textOf(const Rejection& rejection) {
  return (rejection.status == 401 ? "not authorized" : rejection.reason) + "\n";
}

void Exchange::answer(const Rejection& rejection) {
  note_ = rejection.reason;
  HttpHeaders headers = rejection.headers;
  headers.emplace_back("Content-Type", "text/plain");
  pipe_.begin(rejection.status, headers);
  pipe_.write(textOf(rejection));
  pipe_.finish();
}

void Exchange::end(bool complete) {
  complete_ = complete;
  pipe_.close();
}

bool Exchange::cut(const char* reason) {
  if (!submitted_) return false;
  if (pipe_.cut(kUnavailable)) cutReason_ = reason;
  return true;
}

}  // namespace cimhost
