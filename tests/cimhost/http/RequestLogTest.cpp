#include "cimhost/http/RequestLog.h"

#include "../../support/TemporaryTree.h"

#include "cimhost/HostError.h"

#include <gmock/gmock.h>
#include <limits.h>
#include <unistd.h>

#include <atomic>
#include <sstream>
#include <thread>

namespace {

using namespace cimhost;
using testing::EndsWith;
using testing::HasSubstr;

std::string lineOf(const RequestRecord& record, int milliseconds = 1005) {
  const std::chrono::milliseconds time(milliseconds);
  return toLogLine(record, std::chrono::system_clock::time_point(time));
}

TEST(RequestLogTest, OneLineTellsOfARequest) {
  RequestRecord record;
  record.client = "127.0.0.1";
  record.user = "alice";
  record.summary = {"GetInstance", "root/host:Host_FileSystem", 200, 6, 0};
  record.bytes = 812;
  record.duration = std::chrono::milliseconds(3);
  EXPECT_EQ(lineOf(record),
            "1970-01-01T00:00:01.005Z client=127.0.0.1 user=alice operation=GetInstance "
            "target=root/host:Host_FileSystem http=200 cim=6 objects=0 bytes=812 ms=3");
  EXPECT_EQ(lineOf(record, 1999).substr(0, 24), "1970-01-01T00:00:01.999Z");
  EXPECT_EQ(lineOf(record, 2000).substr(0, 24), "1970-01-01T00:00:02.000Z");
  // Texts of clients stay in their field.
  const struct {
    std::string text, field;
  } cases[] = {
      {"", "- "},
      {"-", "\"-\" "},
      {"a\" http=200", "\"a\\\" http=200\" "},
      {"a\\", "\"a\\\\\" "},
      {"a\nb\x1b[31m", "\"a\\nb\\x1b[31m\" "},
      {"\xc3\xa4", "\"\xc3\xa4\" "},
      {"\xff", "\"\\xff\" "},
      {std::string(100000, 'x'), '"' + std::string(200, 'x') + "\xe2\x80\xa6\" "},
  };
  for (const auto& row : cases) {
    record.summary.operation = row.text;
    EXPECT_THAT(lineOf(record), HasSubstr(" operation=" + row.field));
  }
}

TEST(RequestLogTest, ReopeningFollowsTheName) {
  const TemporaryTree tree;
  const auto file = tree.logs() / "requests.log";
  const auto old = tree.logs() / "requests.log.1";
  RequestLog log(file.string());
  log.message("first");
  std::filesystem::rename(file, old);
  log.message("second");
  log.reopen();
  log.message("third");
  EXPECT_THAT(TemporaryTree::read(old), EndsWith("Z second\n"));
  EXPECT_THAT(TemporaryTree::read(file), EndsWith("Z third\n"));
  std::filesystem::remove(file);
  std::filesystem::create_directory(file);
  log.reopen();
  log.write({});
  EXPECT_THROW(RequestLog(file.string()), HostError);
}

TEST(RequestLogTest, LinesOfManyThreadsAreAllThere) {
  constexpr std::size_t kThreads = 4;
  const TemporaryTree tree;
  const auto file = tree.logs() / "requests.log";
  RequestLog log(file.string());
  for (std::size_t round = 1; round <= 300; ++round) {
    std::atomic<std::size_t> ready{0};
    std::vector<std::thread> threads;
    for (std::size_t i = 0; i < kThreads; ++i) {
      threads.emplace_back([&] {
        for (++ready; ready < kThreads;) {
        }
        log.write({});
      });
    }
    for (std::thread& each : threads) each.join();
    ASSERT_EQ(std::filesystem::file_size(file), round * kThreads * (lineOf({}).size() + 1));
  }
  std::istringstream lines(TemporaryTree::read(file));
  for (std::string line; std::getline(lines, line);) {
    ASSERT_EQ(line.substr(23), lineOf({}).substr(23));
  }
}

TEST(RequestLogTest, NobodyWaitsForTheReaderOfAPipe) {
  int ends[2];
  ASSERT_EQ(pipe(ends), 0);
  {
    RequestLog log("/proc/self/fd/" + std::to_string(ends[1]));
    for (int i = 0; i < 3000; ++i) log.message("line " + std::to_string(i));
    std::string text(1U << 20U, ' ');
    text.resize(static_cast<std::size_t>(read(ends[0], text.data(), text.size())));
    EXPECT_THAT(text, HasSubstr(" line 1000\n"));
    EXPECT_EQ(text.back(), '\n');
    // Some room is not room for everything.
    for (int i = 0; i < 3000; ++i) log.message("line " + std::to_string(i));
    EXPECT_GT(read(ends[0], text.data(), PIPE_BUF), 0);
    log.message(std::string(3 * PIPE_BUF, 'x'));
    text.resize(1U << 20U);
    EXPECT_GT(read(ends[0], text.data(), text.size()), 0);
    log.message("again");
    text.resize(static_cast<std::size_t>(read(ends[0], text.data(), text.size())));
    EXPECT_THAT(text, EndsWith("Z again\n"));
  }
  close(ends[0]);
  close(ends[1]);
}

}  // namespace
