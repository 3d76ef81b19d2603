#pragma once

#include "HttpClient.h"

#include "cimhost/http/HttpServer.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <deque>
#include <functional>
#include <mutex>
#include <string>
#include <vector>

/// A request with a body, `headers` as whole lines.
inline std::string post(const std::string& body, const std::string& headers = "",
                        const std::string& method = "POST") {
  return method + " /cimom HTTP/1.1\r\nHost: localhost\r\n" + headers +
         "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
}

/// Polls until `done`, within the time of patience.
template <class Done>
void await(Done done) {
  for (int i = 0; i < HttpClient::kPatience && !done(); ++i) usleep(1000);
}

/// A server on a free port whose handler does what the request's body says: `size=N` a reply of N
/// bytes, `abort` an aborted one behind 2,000,000 bytes, `wait` waits for `go`; else the
/// reply is the user, a colon and the body.
class HttpServerTest : public testing::Test {
 protected:
  ~HttpServerTest() override {
    go = true;
    // It logs into the other members.
    server.reset();
  }

  cimhost::HttpServer& start() {
    server = std::make_unique<cimhost::HttpServer>(
        settings,
        [this](const cimhost::CimXmlRequest& request, cimhost::ReplyStream& reply) {
          return handle(request, reply);
        },
        [this](const cimhost::RequestRecord& record) {
          const std::lock_guard<std::mutex> lock(mutex_);
          records_.push_back(record);
        });
    return *server;
  }

  std::uint16_t port() const { return server->port(); }

  HttpReply ask(const std::string& bytes) { return HttpClient(port()).ask(bytes); }

  /// Waits until the log has `count` records.
  std::vector<cimhost::RequestRecord> records(std::size_t count) {
    const auto logged = [this] {
      const std::lock_guard<std::mutex> lock(mutex_);
      return records_;
    };
    await([&] { return logged().size() >= count; });
    return logged();
  }
  /// Waits until `count` requests have reached the handler.
  void waitForCalls(int count) const {
    await([&] { return calls_ >= count; });
  }
  int calls() const { return calls_; }
  std::size_t written() const { return written_; }

  cimhost::HttpSettings settings;
  std::atomic<bool> go{false};
  std::unique_ptr<cimhost::HttpServer> server;

 private:
  cimhost::RequestSummary handle(const cimhost::CimXmlRequest& request,
                                 cimhost::ReplyStream& reply) {
    const std::string body(request.body());
    ++calls_;
    while (body == "wait" && !go) usleep(1000);
    reply.begin(200, {{"Content-Type", "application/xml"}, {"CIMOperation", "MethodResponse"}});
    if (body.rfind("size=", 0) == 0) {
      writeMany(reply, std::strtoul(body.c_str() + 5, nullptr, 10));
    } else if (body == "abort") {
      writeMany(reply, 2000000);
      reply.abort();
    } else {
      reply.write(std::string(request.user()) + ":" + body);
    }
    return {"Echo", request.header("CIMObject").value_or("none"), 200, 0, 1};
  }

  // Lines of 100 bytes that tell their number.
  void writeMany(cimhost::ReplyStream& reply, std::size_t size) {
    for (std::size_t sent = 0; sent < size; sent += 100) {
      std::string line = std::to_string(sent);
      line.resize(std::min<std::size_t>(100, size - sent), '.');
      if (!reply.write(line)) return;
      written_ += line.size();
    }
  }

  std::mutex mutex_;
  std::vector<cimhost::RequestRecord> records_;
  std::atomic<int> calls_{0};
  std::atomic<std::size_t> written_{0};
};
