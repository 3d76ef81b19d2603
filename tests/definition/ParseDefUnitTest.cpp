#include "definition/ParseDefUnit.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "engine/ciEqual.h"
#include "tests/definition/Reading.h"
#include "tests/support/LogLevel.h"
#include "tests/support/TemporaryTree.h"

namespace {

using namespace std::string_literals;

// "tag" or "text", the flags, the name in brackets, the attributes, the length.
std::string shown(const std::string& text) {
  const ParseDefUnit unit(text.data(), static_cast<int>(text.size()));
  std::string result = unit.getKind() == ParseDefUnit::kTag ? "tag" : "text";
  if (unit.isStart()) result += " start";
  if (unit.isEnd()) result += " end";
  result += " [" + unit.getName() + "]";
  for (const auto& [name, value] : unit.getAttributes()) result += " " + name + "=[" + value + "]";
  return result + " " + std::to_string(unit.getLength());
}

TEST(Unit, IsCutFromTheText) {
  const std::pair<std::string, std::string> cases[] = {
      {"<plugin><b/>", "tag start [plugin] 8"},
      {"<module name='x'/>", "tag start end [module] name=[x] 18"},
      {" \n<a / >", "tag start end [a] 8"},
      {"</ \t\nmodule >", "tag end [module] 13"},
      {"</a b='c'>", "tag end [a] b=[c] 10"},
      {"< a>", "tag start [a] 4"},
      {"<a/b c='d'>", "tag start end [a] 11"},
      {"</>", "tag end [] 3"},
      {"<>x>", "tag start [>x] 4"},
      {"<?xml version=\"1.0\"?>", "tag start [?xml] version=[1.0] 21"},
      {"<!-- c --><a/>", "tag start [!--] 14"},
      {"<a b='1' c='2' b='3'>", "tag start [a] b=[1] c=[2] b=[3] 21"},
      {"<a b='1'c=\"2\"/>", "tag start end [a] b=[1] c=[2] 15"},
      {"<a b='x\"y' c=\"x'y\">", "tag start [a] b=[x\"y] c=[x'y] 19"},
      {"<a b=' <c/>=\n&lt; '>", "tag start [a] b=[ <c/>=\n&lt; ] 20"},
      {"<a b = 'c'>", "tag start [a] b=[c] 11"},
      {"<a b junk/>='c'>", "tag start [a] b=[c] 16"},
      {"<a b=no c='d'>", "tag start [a] b=[d] 14"},
      {"<a b=1><c d='e'>", "tag start [a] b=[e] 16"},
      {"<a =b='c'>", "tag start [a] =b=[c] 10"},
      {"<a b>c='d'>", "tag start [a] b>c=[d] 11"},
      {"  hello world  <a>", "text [hello world] 15"},
      {"\0\x7F\xA0 a\xFF"
       "b \x80\xFF<"s,
       "text [a\xFF"
       "b] 10"},
      {"\x85<\0a\x9F"
       "b\0=\xFF'\xA0'\x01>"s,
       "tag start [a] b=[\xA0] 14"},
      {"a\0b<"s, "text [a\0b] 3"s},
      // Cut off in each state: what was collected is kept, all characters count.
      {"", "text [] 0"},
      {"  ", "text [] 2"},
      {" a b ", "text [a b] 5"},
      {"< ", "tag [] 2"},
      {"<mod", "tag start [mod] 4"},
      {"<m a='1' ", "tag start [m] a=[1] 9"},
      {"<m at ", "tag start [m] 6"},
      {"<m at=v", "tag start [m] 7"},
      {"<m at=\"v'>", "tag start [m] 10"},
      {"<m at='v\">", "tag start [m] 10"},
      {"<m/ ", "tag start end [m] 4"},
  };
  for (const auto& [text, expected] : cases) {
    EXPECT_EQ(shown(text), expected);
    // Traced reading is a second build of the same states; no log file can be opened here.
    const LogLevel level(9);
    EXPECT_EQ(shown(text), expected);
  }
}

TEST(Unit, OfANegativeLengthIsEmpty) {
  const ParseDefUnit unit("<a/>", -1);
  EXPECT_EQ(unit.getKind(), ParseDefUnit::kText);
  EXPECT_EQ(unit.getLength(), 0);
}

TEST(IsSpace, HoldsForThreeRangesOfBytes) {
  std::vector<std::pair<int, int>> ranges;
  for (int c = 0; c < 256; ++c) {
    if (!isSpace(static_cast<unsigned char>(c))) continue;
    if (ranges.empty() || ranges.back().second != c - 1) ranges.emplace_back(c, c);
    ranges.back().second = c;
  }
  EXPECT_EQ(ranges, (std::vector<std::pair<int, int>>{{0, 0x20}, {0x7F, 0xA0}, {0xFF, 0xFF}}));
}

TEST(CiEqual, IgnoresTheCaseOfLettersOnly) {
  EXPECT_TRUE(ci_equal("", ""));
  EXPECT_TRUE(ci_equal("Demo_DISK1", "dEMO_disk1"));
  EXPECT_FALSE(ci_equal("a", "ab"));
  EXPECT_FALSE(ci_equal("[", "{"));  // they differ in the bit that letters differ in
  EXPECT_FALSE(ci_equal("a\0b"s, "a\0c"s));
}

TEST(Trace, NotesEveryCharacterBeforeItIsHandled) {
  const TemporaryTree tree;
  const LogLevel level(9);
  shown("<a b='c'/>");
  shown(" x <b>");
  EXPECT_EQ(tree.log(),
            "Enter ParseDefUnit length=10\nstate 0, char <\nstate 2, char a\nstate 3, char  \n"
            "element a\nstate 4, char b\nstate 5, char =\nstate 7, char '\nstate 9, char c\n"
            "state 9, char '\nAttribute: b=c\nstate 4, char /\nstate 10, char >\n"
            "Enter ParseDefUnit length=6\nstate 0, char  \nstate 0, char x\nstate 1, char  \n"
            "state 1, char <\nCDATA x\n");
}

}  // namespace
