#include "cimhost/http/RequestLog.h"

#include "../../support/TemporaryTree.h"

#include "cimhost/HostError.h"

#include <gmock/gmock.h>
#include <unistd.h>

namespace {

using namespace cimhost;
using testing::EndsWith;
using testing::HasSubstr;

std::string lineOf(const RequestRecord& record) {
  return toLogLine(record, std::chrono::system_clock::time_point(std::chrono::milliseconds(1005)));
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
    log.message("again");
    text.resize(static_cast<std::size_t>(read(ends[0], text.data(), text.size())));
    EXPECT_THAT(text, EndsWith("Z again\n"));
  }
  close(ends[0]);
  close(ends[1]);
}

}  // namespace
