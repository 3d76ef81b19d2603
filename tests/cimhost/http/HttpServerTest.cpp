#include "HttpServerFixture.h"

#include "cimhost/HostError.h"

#include <gmock/gmock.h>

#include <sys/resource.h>

#include <thread>

namespace {

using namespace cimhost;
using testing::HasSubstr;

struct RequestCase {
  const char* name;
  std::string request;
  int status;
  std::string body;  // Of status 200.
};

class HttpRequests : public HttpServerTest, public testing::WithParamInterface<RequestCase> {};

TEST_P(HttpRequests, AreAnswered) {
  settings.limits.requestSize = 100000;
  start();
  const HttpReply reply = ask(GetParam().request);
  EXPECT_EQ(reply.status, GetParam().status);
  EXPECT_TRUE(reply.complete);
  if (GetParam().status == 200) {
    EXPECT_EQ(reply.body, GetParam().body);
  }
  EXPECT_EQ(calls(), reply.status == 200 && GetParam().body != "ok\n" ? 1 : 0);
}

constexpr const char* kMan = "Man: http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=73\r\n";

std::string mandatory(const std::string& man) {
  return post("x", man, "M-POST");
}

INSTANTIATE_TEST_SUITE_P(
    Table, HttpRequests,
    testing::Values(
        RequestCase{"Post", post("hello"), 200, ":hello"},
        RequestCase{"PostWithoutBody", post(""), 200, ":"},
        RequestCase{"OtherPath", "POST /a/b?c HTTP/1.1\r\nHost: x\r\nContent-Length: 1\r\n\r\nx",
                    200, ":x"},
        RequestCase{"Chunked",
                    "POST / HTTP/1.1\r\nHost: x\r\nTransfer-Encoding: chunked\r\n\r\n"
                    "3\r\nabc\r\n2\r\nde\r\n0\r\n\r\n",
                    200, ":abcde"},
        RequestCase{"Http10", "POST / HTTP/1.0\r\nContent-Length: 1\r\n\r\nx", 200, ":x"},
        RequestCase{"Health", "GET /healthz HTTP/1.1\r\nHost: x\r\n\r\n", 200, "ok\n"},
        RequestCase{"NoHost", "POST / HTTP/1.1\r\nContent-Length: 1\r\n\r\nx", 400, ""},
        RequestCase{"Get", "GET /cimom HTTP/1.1\r\nHost: x\r\n\r\n", 501, ""},
        RequestCase{"Put", post("x", "", "PUT"), 501, ""},
        RequestCase{"Options", "OPTIONS * HTTP/1.1\r\nHost: x\r\n\r\n", 501, ""},
        RequestCase{"Mandatory", mandatory(kMan), 200, ":x"},
        RequestCase{"MandatoryQuoted",
                    mandatory("MAN: \"http://www.dmtf.org/cim/mapping/http/v1.0\"; x=1;ns=01\r\n"),
                    200, ":x"},
        RequestCase{"NoMan", mandatory(""), 400, ""},
        RequestCase{"ManOfOthers", mandatory("Man: http://example.org/ ; ns=73\r\n"), 510, ""},
        RequestCase{"ManWithoutNumber",
                    mandatory("Man: http://www.dmtf.org/cim/mapping/http/v1.0\r\n"), 400, ""},
        RequestCase{"ManWithLongNumber",
                    mandatory("Man: http://www.dmtf.org/cim/mapping/http/v1.0;ns=730\r\n"), 400,
                    ""},
        RequestCase{"MandatoryHttp10",
                    "M-POST / HTTP/1.0\r\n" + std::string(kMan) + "Content-Length: 1\r\n\r\nx", 400,
                    ""},
        RequestCase{"AsLargeAsAllowed", post(std::string(100000, 'x')), 200,
                    ":" + std::string(100000, 'x')},
        RequestCase{"TooLarge", "POST / HTTP/1.1\r\nHost: x\r\nContent-Length: 100001\r\n\r\n", 413,
                    ""},
        RequestCase{"Huge",
                    "POST / HTTP/1.1\r\nHost: x\r\nContent-Length: 99999999999999999999\r\n\r\n",
                    413, ""},
        RequestCase{"TooLargeChunked",
                    "POST / HTTP/1.1\r\nHost: x\r\nTransfer-Encoding: chunked\r\n\r\n186a1\r\n" +
                        std::string(100001, 'x') + "\r\n0\r\n\r\n",
                    413, ""},
        RequestCase{"NegativeLength", "POST / HTTP/1.1\r\nHost: x\r\nContent-Length: -1\r\n\r\n",
                    400, ""},
        RequestCase{"LongHeaders", post("", "X: " + std::string(200000, 'x') + "\r\n"), 431, ""}),
    [](const auto& each) { return each.param.name; });

TEST_F(HttpServerTest, MandatoryHeadersCarryThePrefixBothWays) {
  start();
  const HttpReply reply = ask(mandatory(std::string(kMan) + "73-CIMObject: a\r\nCIMObject: b\r\n"));
  EXPECT_EQ(reply.header("73-CIMOperation"), "MethodResponse");
  EXPECT_EQ(reply.headers.count("Ext"), 1U);
  EXPECT_THAT(reply.header("Man"), HasSubstr("ns=73"));
  EXPECT_EQ(reply.header("Content-Type"), "application/xml");
  EXPECT_EQ(records(1).at(0).summary.target, "a");
}

TEST_F(HttpServerTest, OneConnectionCarriesManyRequests) {
  start();
  HttpClient client(port());
  const std::string rejected = post("x", "", "PUT");
  client.send(post("1") + post("2") + rejected + post("size=300000") + post("3"));
  EXPECT_EQ(client.receive().body, ":1");
  EXPECT_EQ(client.receive().body, ":2");
  EXPECT_EQ(client.receive().status, 501);
  const HttpReply large = client.receive();
  EXPECT_TRUE(large.chunked && large.complete);
  EXPECT_EQ(large.body.size(), 300000U);
  EXPECT_EQ(large.body.substr(299900, 6), "299900");
  EXPECT_EQ(client.receive().body, ":3");
  EXPECT_EQ(client.ask(post("4")).body, ":4");
}

TEST_F(HttpServerTest, SizesAroundTheLimitsArriveWhole) {
  start();
  HttpClient client(port());
  for (const std::size_t size :
       {std::size_t{0}, std::size_t{1}, ReplyPipe::kWholeSize, ReplyPipe::kWholeSize + 1,
        ReplyPipe::kCapacity, ReplyPipe::kCapacity + 1, std::size_t{3000000}}) {
    const HttpReply reply = client.ask(post("size=" + std::to_string(size)));
    EXPECT_TRUE(reply.complete);
    EXPECT_EQ(reply.body.size(), size);
    EXPECT_EQ(reply.chunked, size > ReplyPipe::kWholeSize);
  }
}

TEST_F(HttpServerTest, ASlowReaderHoldsTheHandlerBack) {
  start();
  HttpClient client(port(), 4096);
  client.send(post("size=50000000"));
  for (std::size_t taken = 0; taken < 100000;) taken += client.take(1000);
  // What is not yet taken waits in the pipe and the sockets.
  EXPECT_LT(written(), 10000000U);
  std::size_t rest = 0;
  for (std::size_t part = 0; (part = client.take(1000000)) > 0 && rest < 49900000;) rest += part;
  EXPECT_GE(rest, 49800000U);
}

TEST_F(HttpServerTest, AClientThatGoesAwayEndsTheHandler) {
  start();
  {
    HttpClient client(port(), 4096);
    client.send(post("size=50000000"));
    client.take(1000);
  }
  const RequestRecord record = records(1).at(0);
  EXPECT_FALSE(record.complete);
  EXPECT_LT(written(), 50000000U);
  // The end comes together with the bytes before it, long before the connection has been silent.
  for (int i = 0; i < 20; ++i) HttpClient(port()).send("POST / HTTP/1.1\r\nHost: x\r\n");
  EXPECT_EQ(records(21).size(), 21U);
  EXPECT_EQ(ask(post("x")).status, 200);
}

TEST_F(HttpServerTest, AnAbortedReplyIsCutOff) {
  start();
  const HttpReply reply = ask(post("abort"));
  EXPECT_EQ(reply.status, 200);
  EXPECT_FALSE(reply.complete);
  EXPECT_FALSE(records(1).at(0).complete);
}

TEST_F(HttpServerTest, ExpectingClientsAreToldAtOnce) {
  settings.limits.requestSize = 100000;
  start();
  const std::string head = "POST / HTTP/1.1\r\nHost: x\r\nExpect: 100-continue\r\nContent-Length: ";
  EXPECT_EQ(ask(head + "200000\r\n\r\n").status, 413);
  HttpClient client(port());
  client.send(head + "1\r\n\r\n");
  EXPECT_EQ(client.ask("x").body, ":x");
}

TEST_F(HttpServerTest, MoreRequestsThanMayWaitAreTurnedAway) {
  settings.limits.threads = 1;
  settings.limits.queue = 1;
  start();
  HttpClient running(port());
  running.send(post("wait"));
  waitForCalls(1);
  HttpClient first(port());
  HttpClient second(port());
  first.send(post("1"));
  second.send(post("1"));
  // One of the two waits, the other one does not fit.
  const std::vector<RequestRecord> turnedAway = records(1);
  EXPECT_EQ(turnedAway.at(0).summary.httpStatus, 503);
  EXPECT_EQ(ask("GET /healthz HTTP/1.1\r\nHost: x\r\n\r\n").status, 200);
  go.open();
  EXPECT_EQ(running.receive().status, 200);
  const HttpReply replies[] = {first.receive(), second.receive()};
  EXPECT_EQ(replies[0].status + replies[1].status, 703);
  EXPECT_EQ((replies[0].status == 503 ? replies[0] : replies[1]).header("Retry-After"), "1");
}

TEST_F(HttpServerTest, RequestsThatHangHoldNoOthersUp) {
  settings.limits.threads = 4;
  start();
  // Each hangs in the middle of what its connection's thread had to do.
  std::vector<std::unique_ptr<HttpClient>> hanging;
  for (int i = 0; i < 3; ++i) {
    hanging.push_back(std::make_unique<HttpClient>(port()));
    hanging.back()->send(post("wait"));
    waitForCalls(i + 1);
  }
  std::vector<std::unique_ptr<HttpClient>> others;
  for (int i = 0; i < 4; ++i) {
    others.push_back(std::make_unique<HttpClient>(port()));
    EXPECT_EQ(others.back()->ask(post("x")).body, ":x");
    EXPECT_EQ(others.front()->ask(post("size=1000000")).body.size(), 1000000U);
  }
  go.open();
  for (const auto& each : hanging) EXPECT_EQ(each->receive().body, ":wait");
}

// They keep all threads; when somebody waits for one, they are cut.
TEST_F(HttpServerTest, SlowReadersHoldNoOthersUpForLong) {
  settings.limits.threads = 2;
  start();
  std::vector<std::unique_ptr<HttpClient>> slow;
  for (int i = 0; i < 2; ++i) {
    slow.push_back(std::make_unique<HttpClient>(port(), 4096));
    slow.back()->send(post("size=50000000"));
    slow.back()->take(1000);
  }
  EXPECT_EQ(ask(post("x")).body, ":x");
  EXPECT_EQ(ask(post("x")).body, ":x");
  slow.clear();
  for (const RequestRecord& record : records(4)) {
    EXPECT_EQ(record.note == "was read too slowly", !record.complete) << record.note;
  }
}

TEST_F(HttpServerTest, SilentConnectionsAreClosed) {
  settings.limits.idleTimeout = std::chrono::seconds(1);
  start();
  for (const char* text :
       {"", "POST / HTTP/1.1\r\nHo", "GET /healthz HTTP/1.1\r\nHost: x\r\n\r\n"}) {
    HttpClient client(port());
    client.send(text);
    EXPECT_TRUE(client.isClosed()) << text;
  }
}

TEST_F(HttpServerTest, DrippingRequestsAreCutAfterTheirTime) {
  settings.limits.requestTimeout = std::chrono::seconds(1);
  start();
  HttpClient client(port());
  client.send("POST / HTTP/1.1\r\nHost: x\r\nContent-Length: 100000\r\n\r\n");
  std::atomic<bool> stop{false};
  std::thread drip([&] {
    for (; !stop; std::this_thread::sleep_for(std::chrono::milliseconds(50))) client.send("x");
  });
  EXPECT_TRUE(client.isClosed());
  stop = true;
  drip.join();
  EXPECT_EQ(calls(), 0);
}

TEST_F(HttpServerTest, ARequestThatRunsTooLongIsAnsweredForIt) {
  settings.limits.requestTimeout = std::chrono::seconds(1);
  start();
  EXPECT_EQ(ask(post("wait")).status, 503);
  go.open();
  const RequestRecord record = records(1).at(0);
  EXPECT_EQ(record.summary.httpStatus, 503);
  EXPECT_EQ(record.note, "took too long");
}

TEST_F(HttpServerTest, ConnectionsPerAddressAreLimited) {
  settings.limits.connectionsPerAddress = 2;
  start();
  HttpClient first(port());
  HttpClient second(port());
  ASSERT_EQ(first.ask(post("1")).status, 200);
  ASSERT_EQ(second.ask(post("2")).status, 200);
  {
    HttpClient third(port());
    EXPECT_EQ(third.ask(post("3")).status, 0);
  }
  EXPECT_EQ(first.ask(post("1")).status, 200);
}

TEST_F(HttpServerTest, RunningRequestsEndBeforeTheServerDoes) {
  start();
  HttpClient client(port());
  HttpClient idle(port());
  ASSERT_EQ(idle.ask(post("x")).status, 200);
  client.send(post("wait"));
  waitForCalls(2);
  server->drain();
  EXPECT_FALSE(HttpClient(port()).isConnected());
  EXPECT_EQ(idle.ask("GET /healthz HTTP/1.1\r\nHost: x\r\n\r\n").status, 503);
  EXPECT_FALSE(server->waitUntilIdle(std::chrono::milliseconds(10)));
  go.open();
  const HttpReply reply = client.receive();
  EXPECT_EQ(reply.body, ":wait");
  EXPECT_EQ(reply.header("Connection"), "close");
  EXPECT_TRUE(server->waitUntilIdle(std::chrono::seconds(20)));
  server->stop();
}

TEST_F(HttpServerTest, StoppingCutsWhatIsStuck) {
  start();
  HttpClient stuck(port());
  HttpClient reading(port(), 4096);
  HttpClient sending(port());
  sending.send("POST / HTTP/1.1\r\nHost: x\r\nContent-Length: 100\r\n\r\n");
  reading.send(post("size=50000000"));
  stuck.send(post("wait"));
  waitForCalls(2);
  reading.take(1);
  server->drain();
  server->cut();
  EXPECT_EQ(stuck.receive().status, 503);
  EXPECT_FALSE(reading.receive().complete);
  EXPECT_TRUE(sending.isClosed());
  go.open();
  server->stop();
  EXPECT_EQ(records(3).size(), 3U);
}

TEST_F(HttpServerTest, ManyClientsAtOnce) {
  start();
  std::vector<std::thread> clients;
  std::atomic<int> good{0};
  for (int i = 0; i < 8; ++i) {
    clients.emplace_back([&, i] {
      HttpClient client(port());
      for (int j = 0; j < 100; ++j) {
        const std::size_t size = j % 10 == 0 ? 150000 : static_cast<std::size_t>(100 * i + j);
        if (client.ask(post("size=" + std::to_string(size))).body.size() == size) ++good;
      }
    });
  }
  for (std::thread& client : clients) client.join();
  EXPECT_EQ(good, 800);
  EXPECT_EQ(records(800).size(), 800U);
}

TEST_F(HttpServerTest, AnAddressInUseIsTold) {
  start();
  settings.port = port();
  const auto second = [this] { HttpServer other(settings, nullptr, nullptr); };
  EXPECT_THROW(second(), HostError);
}

}  // namespace
