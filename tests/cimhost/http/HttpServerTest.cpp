#include "HttpServerFixture.h"

#include <gmock/gmock.h>

#include <ctime>
#include <thread>

namespace {

using namespace cimhost;
using testing::HasSubstr;

const std::string kHealth = "GET /healthz HTTP/1.1\r\nHost: x\r\n\r\n";
const std::string kUri = "http://www.dmtf.org/cim/mapping/http/v1.0";

// Some bytes on a socket of little room, so that a long reply does not vanish into it.
struct SlowClient : HttpClient {
  explicit SlowClient(std::uint16_t port, const std::string& bytes = post("size=50000000"))
      : HttpClient(port, 4096) {
    send(bytes);
    take(1);
  }
};

std::string head(const std::string& fields, const std::string& version = "1.1\r\nHost: x") {
  return "POST /a?b HTTP/" + version + "\r\n" + fields + "\r\n\r\n";
}

std::string length(const std::string& value) {
  return head("Content-Length: " + value);
}

std::string mandatory(const std::string& fields) {
  return post("x", fields + "\r\n", "M-POST");
}

TEST_F(HttpServerTest, RequestsAreAnsweredOrRefused) {
  const std::string chunked = head("Transfer-Encoding: chunked");
  const std::string full(100000, 'x');
  const struct {
    std::string request;
    int status;
    std::string body;
  } cases[] = {
      {post(""), 200, ":"},
      {length("1") + "x", 200, ":x"},
      {chunked + "3\r\nabc\r\n2\r\nde\r\n0\r\n\r\n", 200, ":abcde"},
      {head("Content-Length: 1", "1.0") + "x", 200, ":x"},
      {head("Content-Length: 1", "1.1") + "x", 400, ""},  // no Host
      {kHealth, 200, "ok\n"},
      {"GET /cimom HTTP/1.1\r\nHost: x\r\n\r\n", 501, ""},
      {post("x", "", "PUT"), 501, ""},
      {"OPTIONS * HTTP/1.1\r\nHost: x\r\n\r\n", 501, ""},
      {mandatory("Man: " + kUri + " ; ns=73"), 200, ":x"},
      {mandatory("MAN: \"" + kUri + "\"; x=1;ns=01"), 200, ":x"},
      {mandatory("X: y"), 400, ""},
      {mandatory("Man: http://example.org/ ; ns=73"), 510, ""},
      {mandatory("Man: " + kUri), 400, ""},
      {mandatory("Man: " + kUri + ";ns=730"), 400, ""},
      {"M-" + head("Man: " + kUri + ";ns=73\r\nContent-Length: 1", "1.0") + "x", 400, ""},
      {post(full), 200, ":" + full},
      {length("100001"), 413, ""},
      {length("99999999999999999999"), 413, ""},
      {chunked + "186a1\r\n" + full + "x\r\n0\r\n\r\n", 413, ""},
      {length("-1"), 400, ""},
      {head("Expect: 100-continue\r\nContent-Length: 100001"), 413, ""},
      {head("Expect: 100-continue\r\nContent-Length: 1") + "x", 200, ":x"},
      {post("", "X: " + full + full + "\r\n"), 431, ""},
  };
  settings.limits.requestSize = 100000;
  start();
  for (const auto& row : cases) {
    SCOPED_TRACE(row.request.substr(0, 200));
    const int before = calls();
    const HttpReply reply = ask(row.request);
    EXPECT_EQ(reply.status, row.status);
    EXPECT_TRUE(reply.complete);
    EXPECT_EQ(reply.status == 200 ? reply.body : "", row.body);
    EXPECT_EQ(calls() - before, row.status == 200 && row.body != "ok\n" ? 1 : 0);
  }
}

TEST_F(HttpServerTest, MandatoryHeadersCarryThePrefixBothWays) {
  start();
  const HttpReply reply =
      ask(mandatory("Man: " + kUri + ";ns=73\r\n73-CIMObject: a\r\nCIMObject: b"));
  EXPECT_EQ(reply.header("73-CIMOperation"), "MethodResponse");
  EXPECT_EQ(reply.headers.count("Ext"), 1U);
  EXPECT_THAT(reply.header("Man"), HasSubstr("ns=73"));
  EXPECT_EQ(reply.header("Content-Type"), "application/xml");
  EXPECT_EQ(records(1).at(0).summary.target, "a");
}

TEST_F(HttpServerTest, OneConnectionCarriesManyRequests) {
  start();
  HttpClient client(port());
  client.send(post("1") + post("2") + post("x", "", "PUT") + post("size=300000") + post("3"));
  EXPECT_EQ(client.receive().body, ":1");
  EXPECT_EQ(client.receive().body, ":2");
  EXPECT_EQ(client.receive().status, 501);
  EXPECT_EQ(client.receive().body.substr(299900, 6), "299900");
  EXPECT_EQ(client.receive().body, ":3");
  for (const std::size_t size :
       {std::size_t{0}, ReplyPipe::kWholeSize, ReplyPipe::kWholeSize + 1, ReplyPipe::kCapacity,
        ReplyPipe::kCapacity + 1, std::size_t{3000000}}) {
    const HttpReply reply = client.ask(post("size=" + std::to_string(size)));
    EXPECT_TRUE(reply.complete);
    EXPECT_EQ(reply.body.size(), size);
    EXPECT_EQ(reply.chunked, size > ReplyPipe::kWholeSize);
  }
}

TEST_F(HttpServerTest, ASlowReaderHoldsTheHandlerBack) {
  start();
  SlowClient client(port());
  for (std::size_t taken = 0; taken < 100000;) taken += client.take(1000);
  // What is not yet taken waits in the pipe and the sockets.
  EXPECT_LT(written(), 10000000U);
  std::size_t rest = 0;
  for (std::size_t part = 0; (part = client.take(1000000)) > 0 && rest < 49900000;) rest += part;
  EXPECT_GE(rest, 49800000U);
}

TEST_F(HttpServerTest, CutRepliesAreLoggedAndTheServerGoesOn) {
  start();
  SlowClient(port()).close();
  EXPECT_FALSE(records(1).at(0).complete);
  EXPECT_LT(written(), 50000000U);
  EXPECT_EQ(ask(post("abort")).status, 200);
  EXPECT_FALSE(ask(post("abort")).complete);
  // The end comes together with the bytes before it, long before the connection has been silent.
  for (int i = 0; i < 20; ++i) HttpClient(port()).send("POST / HTTP/1.1\r\nHost: x\r\n");
  EXPECT_EQ(records(23).size(), 23U);
  EXPECT_EQ(ask(post("x")).status, 200);
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
  EXPECT_EQ(records(1).at(0).summary.httpStatus, 503);
  EXPECT_EQ(ask(kHealth).status, 200);
  go = true;
  EXPECT_EQ(running.receive().status, 200);
  const HttpReply replies[] = {first.receive(), second.receive()};
  EXPECT_EQ(replies[0].status + replies[1].status, 703);
  EXPECT_EQ((replies[0].status == 503 ? replies[0] : replies[1]).header("Retry-After"), "1");
}

TEST_F(HttpServerTest, RequestsThatHangHoldNoOthersUp) {
  settings.limits.threads = 4;
  start();
  // Each hangs in the middle of what its connection's thread had to do.
  std::deque<HttpClient> hanging;
  for (int i = 0; i < 3; ++i) {
    hanging.emplace_back(port()).send(post("wait"));
    waitForCalls(i + 1);
  }
  std::deque<HttpClient> others;
  for (int i = 0; i < 4; ++i) {
    EXPECT_EQ(others.emplace_back(port()).ask(post("x")).body, ":x");
    EXPECT_EQ(others.front().ask(post("size=1000000")).body.size(), 1000000U);
  }
  // Nor do threads look again and again whether they have ended: half of the time would be a lot.
  const auto before = std::clock();
  std::this_thread::sleep_for(std::chrono::milliseconds(400));
  EXPECT_LT(std::clock() - before, CLOCKS_PER_SEC / 5);
  go = true;
  for (HttpClient& each : hanging) EXPECT_EQ(each.receive().body, ":wait");
}

// They keep all threads; when somebody waits for one, they are cut.
TEST_F(HttpServerTest, SlowReadersHoldNoOthersUpForLong) {
  settings.limits.threads = 2;
  start();
  std::deque<SlowClient> slow;
  for (int i = 0; i < 2; ++i) slow.emplace_back(port());
  EXPECT_EQ(ask(post("x")).body, ":x");
  EXPECT_EQ(ask(post("x")).body, ":x");
  slow.clear();
  bool cut = false;
  for (const RequestRecord& record : records(4)) cut |= record.note == "was read too slowly";
  EXPECT_TRUE(cut);
}

TEST(ReplyPipeTest, ReadersAreSlowOnlyWhileTheMakerWaits) {
  using std::chrono::hours;
  ReplyPipe pipe([] {});
  pipe.begin(200, {});
  pipe.write(std::string(ReplyPipe::kCapacity, 'x'));
  EXPECT_FALSE(pipe.isReadSlowly({}));
  std::thread maker([&] { pipe.write("x"); });
  while (!pipe.isReadSlowly({})) std::this_thread::yield();
  EXPECT_FALSE(pipe.isReadSlowly(hours(1)));
  std::string half(ReplyPipe::kCapacity / 2, ' ');
  pipe.read(half.data(), half.size(), [] {});
  maker.join();
  EXPECT_FALSE(pipe.isReadSlowly({}));
}

TEST_F(HttpServerTest, SilentConnectionsAreClosed) {
  settings.limits.idleTimeout = std::chrono::seconds(1);
  start();
  for (const std::string& text : {std::string(), std::string("POST / HTTP/1.1\r\nHo"), kHealth}) {
    HttpClient client(port());
    client.send(text);
    EXPECT_TRUE(client.isClosed()) << text;
  }
}

TEST_F(HttpServerTest, RequestsThatTakeTooLongAreCut) {
  settings.limits.requestTimeout = std::chrono::seconds(1);
  start();
  HttpClient client(port());
  client.send(length("100000"));
  std::atomic<bool> stop{false};
  std::thread drip([&] {
    for (; !stop; std::this_thread::sleep_for(std::chrono::milliseconds(50))) client.send("x");
  });
  EXPECT_TRUE(client.isClosed());
  stop = true;
  drip.join();
  EXPECT_EQ(calls(), 0);
  EXPECT_EQ(ask(post("wait")).status, 503);
  go = true;
  EXPECT_EQ(records(2).at(1).summary.httpStatus, 503);
  EXPECT_EQ(records(2).at(1).note, "took too long");
}

TEST_F(HttpServerTest, ConnectionsPerAddressAreLimited) {
  settings.limits.connectionsPerAddress = 2;
  start();
  HttpClient first(port());
  HttpClient second(port());
  ASSERT_EQ(first.ask(post("1")).status, 200);
  ASSERT_EQ(second.ask(post("2")).status, 200);
  EXPECT_EQ(ask(post("3")).status, 0);
  EXPECT_EQ(first.ask(post("1")).status, 200);
}

TEST_F(HttpServerTest, RunningRequestsEndBeforeTheServerDoes) {
  start();
  HttpClient client(port());
  HttpClient idle(port());
  HttpClient half(port());
  ASSERT_EQ(idle.ask(post("x")).status, 200);
  client.send(post("wait"));
  waitForCalls(2);
  half.send(head("Expect: 100-continue\r\nContent-Length: 2") + "x");
  half.take(1);
  server->drain();
  EXPECT_TRUE(half.isClosed());
  EXPECT_FALSE(HttpClient(port()).isConnected());
  EXPECT_EQ(idle.ask(kHealth).status, 503);
  EXPECT_FALSE(server->waitUntilIdle(std::chrono::milliseconds(10)));
  go = true;
  const HttpReply reply = client.receive();
  EXPECT_EQ(reply.body, ":wait");
  EXPECT_EQ(reply.header("Connection"), "close");
  EXPECT_TRUE(server->waitUntilIdle(std::chrono::seconds(20)));
  server->stop();
}

TEST_F(HttpServerTest, StoppingCutsWhatIsStuck) {
  start();
  HttpClient stuck(port());
  SlowClient reading(port());
  stuck.send(post("wait"));
  waitForCalls(2);
  server->drain();
  server->cut();
  EXPECT_EQ(stuck.receive().status, 503);
  EXPECT_FALSE(reading.receive().complete);
  go = true;
  server->stop();
  EXPECT_EQ(records(2).size(), 2U);
}

}  // namespace
