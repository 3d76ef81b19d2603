#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

#include <gtest/gtest.h>

namespace {

using namespace cimhost;
using Pegasus::Char16;
using Pegasus::String;

TEST(Text, Utf8OfAnyUtf16IsValid) {
  const Char16 lone[] = {Char16('a'), Char16(0xD83D), Char16('b'), Char16(0xDE00), Char16(0)};
  EXPECT_EQ(toUtf8(String(lone, 5)), std::string("a\uFFFDb\uFFFD\0", 9));
  const std::string smile = "\xF0\x9F\x98\x80";
  EXPECT_EQ(toUtf8(fromUtf8(smile)), smile);
  EXPECT_EQ(toUtf8(fromUtf8("\u00e9\u20ac")), "\u00e9\u20ac");
}

TEST(Text, MalformedBytesAreReplacedOneByOne) {
  const struct {
    const char *text, *expected;
  } cases[] = {{"a\xFFz", "a\uFFFDz"},
               {"\xC3", "\uFFFD"},                                 // truncated
               {"\xC0\xAF", "\uFFFD\uFFFD"},                       // overlong
               {"\xED\xA0\x80", "\uFFFD\uFFFD\uFFFD"},             // surrogate
               {"\xF4\x90\x80\x80", "\uFFFD\uFFFD\uFFFD\uFFFD"}};  // above U+10FFFF
  for (const auto& row : cases) EXPECT_EQ(toValidUtf8(row.text), row.expected);
}

TEST(DisplayText, NothingCanMoveTheCursorOrReorderTheLine) {
  EXPECT_EQ(displayText("a\tb\nc\rd\x1b[2J\x7f"), "a\\tb\\nc\\rd\\x1b[2J\\x7f");
  EXPECT_EQ(displayText("\u202Eabc\u2028\u009B\uFEFF"), "\\u202eabc\\u2028\\u009b\\ufeff");
  EXPECT_EQ(displayText("\xFFgr\u00fc\u00df"), "\\xffgr\u00fc\u00df");
}

TEST(DisplayText, WidthsAreThoseOfATerminal) {
  EXPECT_EQ(displayWidth("abc"), 3u);
  EXPECT_EQ(displayWidth("\u00e9e\u0301"), 2u);  // precomposed; with a combining accent
  EXPECT_EQ(displayWidth("\u65e5\u672c"), 4u);   // East Asian wide
  EXPECT_EQ(fitToWidth("abcdef", 6), "abcdef");
  EXPECT_EQ(fitToWidth("abcdefg", 6), "abcde\u2026");
  EXPECT_EQ(fitToWidth("\u65e5\u672c\u8a9e", 4), "\u65e5\u2026");
}

}  // namespace
