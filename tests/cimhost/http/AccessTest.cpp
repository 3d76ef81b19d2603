// Who may come in: users, delays, TLS.

#include "HttpServerFixture.h"

#include "../../support/RunProgram.h"
#include "../../support/TemporaryTree.h"

#include "cimhost/HostError.h"
#include "cimhost/http/FailureDelays.h"

#include <crypt.h>
#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using testing::HasSubstr;

// A cheap hash of "secret": the cost is the hash's own matter.
std::string hashOf(const char* setting) {
  crypt_data data{};
  return crypt_r("secret", setting, &data);
}
const std::string kSha512 = hashOf("$6$rounds=1000$saltsalt$");
const std::string kBcrypt = hashOf("$2y$04$abcdefghijklmnopqrstuu");

// The same hash with another number of rounds, or cost.
std::string costing(const std::string& cost, const std::string& hash) {
  const std::size_t at = hash == kBcrypt ? 4 : 10;
  return "a:" + hash.substr(0, at) + cost + hash.substr(hash.find('$', at)) + "\n";
}

std::string basic(const std::string& encoded) {
  return "Authorization: Basic " + encoded + "\r\n";
}

class UsersTest : public HttpServerTest {
 protected:
  static std::string write(const std::string& text) {
    TemporaryTree::write("users", text);
    return "users";
  }
  void startWithUsers() {
    settings.users = std::make_shared<Authenticator>(
        write("# who\nalice:" + kSha512 + "\r\n\nbob:" + kBcrypt + "\n"));
    start();
  }

 private:
  TemporaryTree tree_;
};

TEST_F(UsersTest, AreCheckedBeforeTheHandler) {
  const struct {
    std::string header;
    const char* body;  // Empty: refused.
  } cases[] = {
      {basic("YWxpY2U6c2VjcmV0"), "alice:x"},
      {"authorization: bAsIc  Ym9iOnNlY3JldA==\r\n", "bob:x"},
      {"", ""},
      {basic("YWxpY2U6c2VjcmVU"), ""},      // another password
      {basic("YWxpY2U6c2VjcmV0AA=="), ""},  // the password, a NUL
      {basic("Y2Fyb2w6c2VjcmV0"), ""},      // nobody's name
      {basic("YWxpY2U="), ""},              // no colon
      {basic("!!!!"), ""},
      {basic(""), ""},
      {"Authorization: Bearer YWxpY2U6c2VjcmV0\r\n", ""},
      {basic(std::string(4000, 'A')), ""},
  };
  startWithUsers();
  for (const auto& row : cases) {
    SCOPED_TRACE(row.header.substr(0, 100));
    const int before = calls();
    HttpClient client(port());
    // The second time what has been verified is remembered; of the others nothing is.
    for (int i = 0; i < 2; ++i) {
      const HttpReply reply = client.ask(post("x", row.header));
      const bool refused = *row.body == '\0';
      EXPECT_EQ(reply.status, refused ? 401 : 200);
      EXPECT_EQ(reply.body, refused ? "not authorized\n" : row.body);
      EXPECT_EQ(reply.headers.count("WWW-Authenticate"), refused ? 1U : 0U);
      EXPECT_EQ(calls() - before, refused ? 0 : i + 1);
    }
  }
  EXPECT_EQ(ask("GET /healthz HTTP/1.1\r\nHost: x\r\n\r\n").status, 200);
}

TEST_F(UsersTest, WrongPasswordsSlowTheAddressDown) {
  startWithUsers();
  const std::string wrong = post("x", basic("YWxpY2U6c2VjcmVU"));
  for (int i = 0; i < FailureDelays::kFreeFailures; ++i) ask(wrong);
  const auto before = std::chrono::steady_clock::now();
  EXPECT_EQ(ask(wrong).status, 401);
  EXPECT_GE(std::chrono::steady_clock::now() - before, FailureDelays::kFirstDelay / 2);
  // Right ones come in, and end it.
  EXPECT_EQ(ask(post("x", basic("Ym9iOnNlY3JldA=="))).status, 200);
  EXPECT_EQ(records(5).at(0).note, "wrong credentials of alice");
}

TEST_F(UsersTest, UnusableFilesAreToldWithTheirLine) {
  const struct {
    std::string text;
    const char* problem;
  } cases[] = {
      {"# nobody\n", "no users"},
      {"alice\n", ":1: expected name:hash"},
      {"\n:" + kSha512 + "\n", ":2: expected name:hash"},
      {"alice:$apr1$TqI9WECO$LHZB2DqRlk9nObiB6vJG9.\n", ":1: not a SHA-512"},
      {"alice:" + kSha512 + "x\n", ":1: not a SHA-512"},
      {"alice:$6$\n", ":1: not a SHA-512"},
      {costing("1000001", kSha512), "too many rounds"},
      {costing("15", kBcrypt), "too many rounds"},
      {"a:" + kSha512 + "\na:" + kBcrypt + "\n", ":2: user comes twice"},
      {std::string((1U << 20U) + 1, '\n'), "larger than 1 MiB"},
  };
  for (const auto& each : cases) {
    try {
      const UserFile users(write(each.text));
      ADD_FAILURE() << each.text;
    } catch (const HostError& problem) {
      EXPECT_THAT(problem.what(), HasSubstr(each.problem)) << each.text;
    }
  }
  EXPECT_THROW(UserFile("/"), HostError);
  EXPECT_NO_THROW(UserFile(write(costing("1000000", kSha512))));
  EXPECT_NO_THROW(UserFile(write(costing("14", kBcrypt))));
}

TEST(FailureDelaysTest, AttemptsOfAnAddressGetTheirTurnsOneByOne) {
  using std::chrono::milliseconds;
  FailureDelays delays;
  auto now = FailureDelays::Clock::time_point() + std::chrono::hours(1);
  for (int i = 0; i < FailureDelays::kFreeFailures; ++i) {
    EXPECT_EQ(delays.reserve("a", now), milliseconds(0));
    delays.failed("a", now);
  }
  EXPECT_EQ(delays.reserve("a", now), milliseconds(250));
  EXPECT_EQ(delays.reserve("a", now), milliseconds(500));
  EXPECT_EQ(delays.reserve("b", now), milliseconds(0));
  for (int i = 0; i < 100; ++i) delays.failed("a", now);
  while (delays.reserve("a", now)) {
  }
  EXPECT_EQ(delays.reserve("a", now + FailureDelays::kMemory * 2), milliseconds(0));
  delays.succeeded("a");
  EXPECT_EQ(delays.size(), 0U);
  for (int i = 0; i < 5000; ++i) delays.failed(std::to_string(i), now += milliseconds(1));
  EXPECT_EQ(delays.size(), FailureDelays::kAddresses);
}

TEST_F(HttpServerTest, RepliesCrossTlsWholeFromVersion12On) {
  const TemporaryTree tree;
  const auto openssl = [](const std::string& words) {
    ASSERT_EQ(runProgram({"/bin/sh", "-c", "/usr/bin/openssl " + words}).code, 0) << words;
  };
  openssl(
      "req -x509 -newkey rsa:2048 -nodes -days 2 -subj /CN=localhost -addext "
      "subjectAltName=IP:127.0.0.1 -keyout key -out certificate");
  openssl("genrsa -out other 2048");
  EXPECT_THROW(readTlsFiles("certificate", "other"), HostError);
  EXPECT_THROW(readTlsFiles("key", "key"), HostError);
  EXPECT_THROW(readTlsFiles("certificate", "/"), HostError);
  settings.tls = readTlsFiles("certificate", "key");
  start();
  const auto curl = [this](const std::string& options) {
    return runProgram({"/bin/sh", "-c",
                       "/usr/bin/curl -sS --max-time 20 --cacert certificate " + options +
                           " https://127.0.0.1:" + std::to_string(port()) + "/cimom"});
  };
  EXPECT_EQ(curl("--data-binary hello --tlsv1.3").out, ":hello");
  EXPECT_EQ(curl("--data-binary hello --tls-max 1.2").out, ":hello");
  EXPECT_NE(curl("--data-binary hello --tls-max 1.1 --ciphers DEFAULT@SECLEVEL=0").code, 0);
  EXPECT_EQ(curl("--data-binary size=1000000").out.size(), 1000000U);
  // Plain HTTP is no handshake.
  EXPECT_EQ(ask(post("x")).status, 0);
}

}  // namespace
