#include "cimhost/Diagnostic.h"

#include <gtest/gtest.h>

namespace {

using cimhost::caretLines;
using cimhost::Diagnostic;

TEST(Diagnostic, PlacesAreAsCompilersPrintThem) {
  const auto kError = Diagnostic::Severity::error;
  EXPECT_EQ((Diagnostic{kError, "a.xml", 2, 5, "bad", "<x y>"}.toString()),
            "a.xml:2:5: error: bad\n  <x y>\n      ^");
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
