#include "diagnostics/debug.h"

#include "tests/support/LogLevel.h"
#include "tests/support/StdoutCapture.h"
#include "tests/support/TemporaryTree.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <climits>
#include <functional>
#include <thread>

namespace {

class Debug : public testing::Test {
 protected:
  Debug() { forgetLogConfiguration(); }
  ~Debug() override { forgetLogConfiguration(); }

  void writeIni(const std::string& text) {
    TemporaryTree::write(tree_.logs() / "CommonProvider.ini", text);
  }
  std::filesystem::path ini() const { return tree_.logs() / "CommonProvider.ini"; }
  bool hasLog() const { return std::filesystem::exists(tree_.logs() / "CommonProvider.log"); }

  // One message of each level in use.
  static void logAll() {
    for (const int level : {1, 7, 8, 9}) debugFormat(level, "%d\n", level);
  }

  TemporaryTree tree_;
};

}  // namespace

TEST_F(Debug, ReadsTheLevelAsADecimalNumber) {
  const std::pair<std::string, int> cases[] = {
      {"LogLevel=+7", 7},
      {"LogLevel=8x9", 8},
      {"LogLevel=0x9", 0},
      {"LogLevel = 8 \r\n", 8},
      {"LogLevel=", 0},
      {"LogLevel=%s%n", 0},
      {"loglevel=9", 0},
      {"", 0},
      {"LogLevel=99999999999999999999999", INT_MAX},
      {"LogLevel=-99999999999999999999999", INT_MIN},
  };
  for (const auto& [text, level] : cases) {
    writeIni(text);
    forgetLogConfiguration();
    debug(INT_MAX, static_cast<const char*>(""));
    EXPECT_EQ(LOG_LEVEL.load(), level) << text;
    EXPECT_EQ(configRead.load(), 1) << text;
  }
}

// Also on a level that is not written: whatever stands in the file's place, it is not asked again.
TEST_F(Debug, ReadsTheConfigurationOnceEvenIfThatFails) {
  const std::function<void()> places[] = {
      [] {},
      [this] { ASSERT_EQ(mkfifo(ini().c_str(), 0600), 0); },
      [this] { writeIni("LogLevel=0"); },
  };
  for (const auto& place : places) {
    forgetLogConfiguration();
    place();
    debug(9, static_cast<const char*>("before\n"));
    std::filesystem::remove(ini());
    tree_.setLogLevel("9");
    debug(1, static_cast<const char*>("after\n"));
    EXPECT_FALSE(hasLog());
    std::filesystem::remove(ini());
  }
}

TEST_F(Debug, AppendsTheTextAsItIs) {
  tree_.setLogLevel("9");
  TemporaryTree::write(tree_.logs() / "CommonProvider.log", "earlier\n");
  const std::string text = "100% %n%s%s%s%s " + std::string(5000, 'x');
  debug(1, text.c_str());
  debugFormat(1, "[%s|%d]", text.c_str(), -7);
  EXPECT_EQ(tree_.log(), "earlier\n" + text + "[" + text + "|-7]");
}

TEST_F(Debug, WritesNonConstTextToStandardOutput) {
  tree_.setLogLevel("8");
  char text[] = "miss %n%s\n";
  StdoutCapture out;
  debug(8, text);
  debug(9, text);
  EXPECT_EQ(out.text(), "miss %n%s\n");
  EXPECT_FALSE(hasLog());
}

TEST_F(Debug, SkipsMessagesWhenThereIsNoPlaceForTheLog) {
  const LogLevel level(9);
  std::filesystem::create_directory(tree_.logs() / "CommonProvider.log");
  logAll();
  std::filesystem::remove_all(tree_.logs());
  logAll();
  EXPECT_FALSE(std::filesystem::exists(tree_.logs()));
}

TEST_F(Debug, DoesNotEvaluateArgumentsBelowTheLevel) {
  const LogLevel level(7);
  int evaluated = 0;
  DEBUG_FORMAT(8, "%d", ++evaluated);
  EXPECT_EQ(evaluated, 0);
  DEBUG_FORMAT(7, "%d", ++evaluated);
  EXPECT_EQ(tree_.log(), "1");
}

TEST_F(Debug, KeepsMessagesOfSeveralThreadsWhole) {
  tree_.setLogLevel("1");
  // Reads the level: meanwhile another thread's is still 0.
  debug(1, static_cast<const char*>(""));
  const auto work = [] {
    for (int i = 0; i < 100; ++i) debug(1, static_cast<const char*>("0123456789\n"));
  };
  std::thread one(work), two(work);
  one.join();
  two.join();
  std::string expected;
  for (int i = 0; i < 200; ++i) expected += "0123456789\n";
  EXPECT_EQ(tree_.log(), expected);
}
