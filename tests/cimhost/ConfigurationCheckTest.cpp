#include "../support/TemporaryTree.h"

#include "cimhost/ConfigurationCheck.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>

namespace {

using cimhost::caretLines;
using cimhost::Diagnostic;

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

TEST(ConfigurationCheck, FilesOfAnotherKindOrSizeAreNotRead) {
  const TemporaryTree tree;
  const auto checkFile = [&tree](const char* name) {
    const auto problems = cimhost::checkConfigurationFile((tree.root() / name).string(), name);
    return problems.empty() ? "" : problems.front().toString();
  };
  std::filesystem::create_directory(tree.root() / "directory");
  TemporaryTree::write(tree.root() / "limit", std::string(1U << 20U, '\n'));
  TemporaryTree::write(tree.root() / "beyond", std::string((1U << 20U) + 1, '\n'));
  EXPECT_EQ(checkFile("absent"), "");
  EXPECT_EQ(checkFile("directory"), "directory: error: not a regular file");
  EXPECT_EQ(checkFile("limit"), "");
  EXPECT_EQ(checkFile("beyond"), "beyond: error: larger than 1 MiB");
}

TEST(ConfigurationCheck, AFloodOfProblemsIsBounded) {
  std::string text(5000, 'x');
  for (int i = 0; i < 5000; ++i) text += "\nx";
  const std::string problems = check(text);
  EXPECT_EQ(std::count(problems.begin(), problems.end(), '|'), 100);
}

TEST(Diagnostic, PlacesAreAsCompilersPrintThem) {
  const auto kError = Diagnostic::Severity::error;
  EXPECT_EQ((Diagnostic{kError, "a.xml", 2, 0, "bad", "<x y>"}.toString()), "a.xml:2: error: bad");
  EXPECT_EQ((Diagnostic{Diagnostic::Severity::warning, "a.xml", 0, 0, "one\ntwo\n", ""}.toString()),
            "a.xml: warning: one\n  two");
  // Safe for a terminal.
  EXPECT_EQ((Diagnostic{kError, "a\x1b.xml", 1, 2, "bad \x1b[2J", "\x1b[1m"}.toString()),
            "a\\x1b.xml:1:2: error: bad \\x1b[2J\n  \\x1b[1m\n      ^");
}

TEST(Diagnostic, TheCaretStandsUnderTheColumn) {
  EXPECT_EQ(caretLines("\tab", 3), "\n   ab\n    ^");
  EXPECT_EQ(caretLines("\u00e9x", 3), "\n  \u00e9x\n   ^");  // bytes, not columns
  EXPECT_EQ(caretLines("ab", 99), "\n  ab\n    ^");
  const std::string far = caretLines(std::string(5000, 'x') + "!" + std::string(5000, 'y'), 5001);
  EXPECT_EQ(far, "\n  " + std::string(60, 'x') + "!" + std::string(39, 'y') + "\n  " +
                     std::string(60, ' ') + "^");
}

}  // namespace
