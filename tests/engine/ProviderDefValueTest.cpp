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
  struct Case {
    ProviderDefValue value;
    int type, number;
    long longNumber;
    bool truth;
    const char* text;
    Ints numbers;
    Texts texts;
  };
  const Case cases[] = {
      {ProviderDefValue(), 0, 0, 0, false, "", {}, {}},
      {INT_MIN, 0, INT_MIN, INT_MIN, false, "", {}, {}},
      {LONG_MAX, 6, 0, LONG_MAX, false, "", {}, {}},
      {true, 5, 0, 0, true, "", {}, {}},
      {"a", 1, 0, 0, false, "a", {}, {}},
      {std::string("b"), 1, 0, 0, false, "b", {}, {}},
      {Ints{3, 4}, 2, 0, 0, false, "", {3, 4}, {}},
      {Texts{"c", ""}, 3, 0, 0, false, "", {}, {"c", ""}},
      {indexString("d"), 4, 0, 0, false, "d", {}, {}},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(valueText(c.value));
    EXPECT_EQ(c.value.getType(), c.type);
    EXPECT_EQ(c.value.getIntValue(), c.number);
    EXPECT_EQ(c.value.getLongValue(), c.longNumber);
    EXPECT_EQ(c.value.getBoolValue(), c.truth);
    EXPECT_EQ(c.value.getStringValue(), c.text);
    EXPECT_EQ(c.value.getIntArray(), c.numbers);
    EXPECT_EQ(c.value.getStringArray(), c.texts);
  }
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
