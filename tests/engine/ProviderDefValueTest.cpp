#include "engine/ProviderDefValue.h"

#include "tests/engine/ValueText.h"
#include "tests/support/LogLevel.h"
#include "tests/support/StdoutCapture.h"
#include "tests/support/TemporaryTree.h"

#include <gtest/gtest.h>

#include <climits>

namespace {

using Value = const ProviderDefValue&;

ProviderDefValue indexString(const char* text) {
  ProviderDefValue value(text);
  value.setIndexStringType();
  return value;
}

}  // namespace

TEST(ProviderDefValue, EachConstructorSetsItsTypeAndItsFieldAlone) {
  for (int type = 0; type < 7; ++type) {
    SCOPED_TRACE(type);
    const ProviderDefValue& value = oneOfEachType().at(static_cast<size_t>(type));
    EXPECT_EQ(value.getType(), type);
    EXPECT_EQ(value.getIntValue(), type == 0 ? 7 : 0);
    EXPECT_EQ(value.getLongValue(), type == 0 || type == 6 ? 7 : 0);
    EXPECT_EQ(value.getBoolValue(), type == 5);
    EXPECT_EQ(value.getStringValue(), type == 1 ? "seven" : type == 4 ? "index" : "");
    EXPECT_EQ(value.getIntArray(), type == 2 ? Ints{7} : Ints());
    EXPECT_EQ(value.getStringArray(), type == 3 ? Texts{"seven"} : Texts());
  }
  EXPECT_EQ(valueText({ProviderDefValue(), INT_MIN, LONG_MAX, std::string("b")}),
            "0 0; 0 -2147483648; 6 " + std::to_string(LONG_MAX) + "; 1 b; ");
}

TEST(ProviderDefValue, StringConstructorAloneIsLogged) {
  const TemporaryTree tree;
  const LogLevel level(9);
  const Values values{1, 2L, true, Ints{3}};
  EXPECT_EQ(tree.log(), "");
  const ProviderDefValue text(std::string("%s"));
  EXPECT_EQ(tree.log(), "ProviderDefValue Constructor (string)\n");
}

TEST(ProviderDefValue, Equal) {
  const std::tuple<ProviderDefValue, ProviderDefValue, bool> cases[] = {
      {5, 5, true},
      {5, 6, false},
      {5, 5L, false},
      {5L, 5L, false},
      {true, true, false},
      {indexString("a"), indexString("a"), false},
      {indexString("a"), "a", false},
      {"abc", "abc", true},
      {"abc", "ABC", false},
      {"", "%n%s", false},
      {std::string("a\0b", 3), std::string("a\0c", 3), false},
      {"1", 1, false},
      {Ints{}, Ints{}, true},
      {Ints{1, 2}, Ints{1, 2}, true},
      {Ints{1, 2}, Ints{2, 1}, false},
      {Ints{1}, Ints{1, 2}, false},
      {Ints{}, Texts{}, false},
      {Texts{"a", "b"}, Texts{"a", "b"}, true},
      {Texts{"a", "b"}, Texts{"a", "B"}, false},
      {Texts{"a"}, Texts{"a", "a"}, false},
  };
  for (const auto& [a, b, expected] : cases) {
    const auto text = [](Value value) { return std::string(value.getStringValue().c_str()); };
    StdoutCapture out;
    const bool equal = a.equal(b);
    const std::string trace = out.text();
    SCOPED_TRACE(valueText(Values{a, b}));
    EXPECT_EQ(equal, expected);
    EXPECT_EQ(trace, "ProviderDefValue::equal(ProviderDefValue value)" +
                         (a.getType() == 1 && b.getType() == 1
                              ? "Comparing strings: " + text(a) + ", " + text(b) + "\n"
                              : ""));
  }
}

// include() is the mirror of partof(), row by row; neither writes a trace.
TEST(PartOf, AndInclude) {
  const std::tuple<ProviderDefValue, ProviderDefValue, bool> cases[] = {
      // Two strings: true unless the first match is at position 0.
      {"abc", "xabc", true},
      {"abc", "abcd", false},
      {"abc", "abcabc", false},
      {"abc", "zzz", true},
      {"abc", "", true},
      {"", "zzz", false},
      {2, Ints{1, 2}, true},
      {3, Ints{1, 2}, false},
      {0, Ints{}, false},
      {Ints{1, 1, 2}, Ints{2, 1}, true},
      {Ints{1, 3}, Ints{2, 1}, false},
      {Ints{}, Ints{}, true},
      {Ints{3}, Ints{}, false},
      {"b", Texts{"a", "b"}, true},
      {"B", Texts{"a", "b"}, false},
      {"", Texts{"ab"}, false},
      // A string array is never part of a string array; an integer array always is.
      {Ints{1}, Texts{"1"}, true},
      {Ints{1}, Texts{}, true},
      {Texts{"a"}, Texts{"a"}, false},
  };
  for (const auto& [part, whole, expected] : cases) {
    SCOPED_TRACE(valueText(Values{part, whole}));
    StdoutCapture out;
    const bool isPart = part.partof(whole), includes = whole.include(part);
    EXPECT_EQ(out.text(), "");
    EXPECT_EQ(isPart, expected);
    EXPECT_EQ(includes, expected);
  }
}

TEST(PartOf, IsFalseForEveryOtherPairOfTypes) {
  const bool decidedByContent[7][7] = {
      // whole: 0, 1, 2, 3, 4, 5, 6
      {false, false, true, false},  // part: integer
      {false, true, false, true},   // string
      {false, false, true, true},   // integer array
  };
  for (const ProviderDefValue& part : oneOfEachType()) {
    for (const ProviderDefValue& whole : oneOfEachType()) {
      if (decidedByContent[part.getType()][whole.getType()]) continue;
      EXPECT_FALSE(part.partof(whole) || whole.include(part)) << valueText(Values{part, whole});
    }
  }
}
