#include "cimhost/ConfigurationCheck.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>

namespace {

std::string check(const std::string& text) {
  std::istringstream stream(text);
  std::string result;
  for (const auto& problem : cimhost::checkConfiguration(stream, "c.ini")) {
    result += problem.toString() + "|";
  }
  return result;
}

TEST(ConfigurationCheck, ProblemsPointAtTheCharacter) {
  EXPECT_EQ(check("# c\n; c\n[section]\n\n  LogLevel = 9\r\nLogLevel=-1\n"), "");
  EXPECT_EQ(check("LogLevel=9\nLogLevel = nine\n"),
            "c.ini:2:12: error: LogLevel is not a decimal number\n"
            "  LogLevel = nine\n"
            "             ^|");
  EXPECT_EQ(check("LogLevel=9x\n").substr(0, 15), "c.ini:1:10: err");
  EXPECT_EQ(check("LogLevel 9").substr(0, 40), "c.ini:1:1: error: expected key = value\n ");
  EXPECT_EQ(check(" =9").substr(0, 20), "c.ini:1:2: error: no");
  EXPECT_EQ(check("LogLevel=").substr(0, 40), "c.ini:1:10: error: LogLevel has no value");
  EXPECT_EQ(check("loglevel=9").substr(0, 40), "c.ini:1:1: warning: unknown key loglevel");
}

TEST(ConfigurationCheck, AFloodOfProblemsIsBounded) {
  std::string text(5000, 'x');
  for (int i = 0; i < 5000; ++i) text += "\nx";
  const std::string problems = check(text);
  EXPECT_EQ(std::count(problems.begin(), problems.end(), '|'), 100);
}

}  // namespace
