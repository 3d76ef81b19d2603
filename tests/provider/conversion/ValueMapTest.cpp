// The mapping between numbers and texts that ValueMap and Values qualifiers give.

#include "provider/ValueMap.h"

#include <gmock/gmock.h>

#include "CimText.h"
#include "MakeClass.h"

using namespace Pegasus;

namespace {

using Texts = std::vector<const char*>;

Array<String> arrayOf(const Texts& texts) {
  Array<String> result;
  for (const char* text : texts) result.append(String(text));
  return result;
}

/// A class whose property "Map" carries the two qualifiers; a list that starts with a null pointer
/// stands for a missing one.
CIMClass mappedClass(const Texts& numbers, const Texts& texts) {
  CIMProperty map = declared("Map", CIMTYPE_UINT16);
  const auto add = [&map](const char* name, const Texts& list) {
    if (!list.empty() && list[0] == nullptr) return;
    map.addQualifier(CIMQualifier(CIMName(name), CIMValue(arrayOf(list))));
  };
  add("ValueMap", numbers);
  add("Values", texts);
  return makeClass("T_Mapped", {declared("First", CIMTYPE_STRING), map});
}

template <class Mapping>
std::string outcome(Mapping mapping) {
  try {
    return mapping();
  } catch (const Exception&) {
    return "exception";
  }
}

struct MapCase {
  const char* name;
  Texts numbers, texts;
  int number;
  const char* text;  ///< Of `number`.
  const char* sent;
  const char* mappedNumber;  ///< Of `sent`.
};

std::ostream& operator<<(std::ostream& out, const MapCase& given) {
  return out << given.name;
}

class ValueMapping : public testing::TestWithParam<MapCase> {};

TEST_P(ValueMapping, BothDirections) {
  const MapCase& given = GetParam();
  CIMClass mapped = mappedClass(given.numbers, given.texts);
  EXPECT_EQ(outcome([&] {
              const auto text = Vaneth::valueMapText(mapped, "map", given.number);
              return text ? textOf(*text) : std::string("none");
            }),
            given.text);
  EXPECT_EQ(outcome([&] {
              const auto number = Vaneth::valueMapNumber(mapped, "map", String(given.sent));
              return number ? std::to_string(*number) : std::string("none");
            }),
            given.mappedNumber);
}

const Texts kNumbers = {"0", "1", "2"};
const Texts kTexts = {"OK", "Degraded", "Error"};
const Texts kMissing = {nullptr};

INSTANTIATE_TEST_SUITE_P(
    Lists, ValueMapping,
    testing::Values(
        MapCase{"Listed", kNumbers, kTexts, 1, "Degraded", "Error", "2"},
        MapCase{"NotListed", kNumbers, kTexts, 7, "none", "ok", "none"},
        MapCase{"ValuesTooShort", kNumbers, {"OK", "Degraded"}, 2, "exception", "OK", "0"},
        MapCase{"ValueMapTooShort", {"0"}, kTexts, 0, "OK", "Error", "exception"},
        MapCase{"NoValueMap", kMissing, kTexts, 1, "exception", "OK", "exception"},
        MapCase{"NoValues", kNumbers, kMissing, 1, "exception", "OK", "exception"},
        MapCase{"FirstOfEqualEntries", {"5", "5", "6"}, {"A", "B", "A"}, 5, "A", "A", "5"},
        MapCase{"LeadingZeroIsAnotherNumber", {"01", "1"}, {"A", "B"}, 1, "B", "A", "1"},
        MapCase{"SignAndBlanksAndTail", {"-3", " +4x"}, {"A", "B"}, -3, "A", "B", "4"},
        MapCase{"NoDigits", {"many"}, {"A"}, 0, "none", "A", "0"},
        MapCase{"BeyondInt", {"99999999999999999999"}, {"A"}, 0, "none", "A", "2147483647"}),
    [](const auto& given) { return given.param.name; });

TEST(ValueMappingErrors, PropertyThatTheClassLacks) {
  CIMClass mapped = mappedClass(kNumbers, kTexts);
  EXPECT_THROW(Vaneth::valueMapText(mapped, "Nothing", 1), Exception);
  EXPECT_THROW(Vaneth::valueMapNumber(mapped, "", String("OK")), Exception);
}

}  // namespace
