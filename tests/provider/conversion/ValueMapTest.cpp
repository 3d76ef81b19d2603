// The mapping between numbers and texts that ValueMap and Values qualifiers give.

#include "provider/ValueMap.h"

#include <gmock/gmock.h>

#include "CimText.h"
#include "MakeClass.h"

namespace {

using Texts = std::vector<const char*>;

/// A class whose property "Map" carries the two qualifiers; a list that starts with a null pointer
/// stands for a missing one.
CIMClass mappedClass(const Texts& numbers, const Texts& texts) {
  CIMProperty map = declared("Map", CIMTYPE_UINT16);
  const auto add = [&map](const char* name, const Texts& list) {
    Array<String> values;
    for (const char* text : list) {
      if (text == nullptr) return;
      values.append(String(text));
    }
    map.addQualifier(CIMQualifier(CIMName(name), values));
  };
  add("ValueMap", numbers);
  add("Values", texts);
  return makeClass("T_Mapped", {declared("First", CIMTYPE_STRING), map});
}

using ::textOf;

std::string textOf(int number) {
  return std::to_string(number);
}

template <class Mapping>
std::string outcome(Mapping mapping) {
  try {
    const auto result = mapping();
    return result ? textOf(*result) : "none";
  } catch (const Exception&) {
    return "exception";
  }
}

const Texts kNumbers = {"0", "1", "2"};
const Texts kTexts = {"OK", "Degraded", "Error"};
const Texts kMissing = {nullptr};

TEST(ValueMapping, BothDirections) {
  const struct {
    Texts numbers, texts;
    int number;
    const char *text, *sent, *mappedNumber;  // the text of `number`, the number of `sent`
  } cases[] = {
      {kNumbers, kTexts, 1, "Degraded", "Error", "2"},
      {kNumbers, kTexts, 7, "none", "ok", "none"},
      {kNumbers, {"OK", "Degraded"}, 2, "exception", "OK", "0"},
      {{"0"}, kTexts, 0, "OK", "Error", "exception"},
      {kMissing, kTexts, 1, "exception", "OK", "exception"},
      {kNumbers, kMissing, 1, "exception", "OK", "exception"},
      {{"5", "5", "6"}, {"A", "B", "A"}, 5, "A", "A", "5"},
      {{"01", "1"}, {"A", "B"}, 1, "B", "A", "1"},
      {{"-3", " +4x"}, {"A", "B"}, -3, "A", "B", "4"},
      {{"many"}, {"A"}, 0, "none", "A", "0"},
      {{"99999999999999999999"}, {"A"}, 0, "none", "A", "2147483647"},
  };
  for (const auto& c : cases) {
    CIMClass mapped = mappedClass(c.numbers, c.texts);
    EXPECT_EQ(outcome([&] { return Vaneth::valueMapText(mapped, "map", c.number); }), c.text);
    EXPECT_EQ(outcome([&] { return Vaneth::valueMapNumber(mapped, "map", c.sent); }),
              c.mappedNumber)
        << c.sent;
  }
}

TEST(ValueMappingErrors, PropertyThatTheClassLacks) {
  CIMClass mapped = mappedClass(kNumbers, kTexts);
  EXPECT_THROW(Vaneth::valueMapText(mapped, "Nothing", 1), Exception);
  EXPECT_THROW(Vaneth::valueMapNumber(mapped, "", String("OK")), Exception);
}

}  // namespace
