// Definition values, as plug-ins answer, turned into CIM values of every type.

#include <gmock/gmock.h>

#include <climits>

#include "CimText.h"
#include "provider/CimConversion.h"

namespace {

using Numbers = std::vector<int>;
using Texts = std::vector<std::string>;

const long kWide = sizeof(long) == 8 ? LONG_MIN : -5;
const Numbers kNumbers = {65, -1};

TEST(CimValueOf, Answer) {
  const struct {
    CIMType type;
    ProviderDefValue answer;
    std::string expected;  // The value's text.
  } cases[] = {
      {CIMTYPE_BOOLEAN, -2, "TRUE"},
      {CIMTYPE_BOOLEAN, 0, "FALSE"},
      {CIMTYPE_UINT8, 511, "255"},
      {CIMTYPE_SINT8, 255, "-1"},
      {CIMTYPE_UINT16, -1, "65535"},
      {CIMTYPE_SINT16, 0x18000, "-32768"},
      {CIMTYPE_UINT32, -1, "4294967295"},
      {CIMTYPE_SINT32, INT_MIN, "-2147483648"},
      {CIMTYPE_UINT64, -1, "18446744073709551615"},
      {CIMTYPE_UINT64, kWide, std::to_string(static_cast<unsigned long long>(kWide))},
      {CIMTYPE_SINT64, kWide, std::to_string(kWide)},
      // Only 64-bit properties read a long.
      {CIMTYPE_SINT32, kWide, "0"},
      {CIMTYPE_REAL32, 3, "3.0000000000000000e+00"},
      {CIMTYPE_REAL64, -2, "-2.0000000000000000e+00"},
      {CIMTYPE_CHAR16, 0x10041, "A"},
      // A boolean constant has no integer.
      {CIMTYPE_BOOLEAN, true, "FALSE"},
      {CIMTYPE_STRING, "\xc3\xa9 %s\"", "\xc3\xa9 %s\""},
      {CIMTYPE_STRING, 5, ""},
      {CIMTYPE_DATETIME, "20260101120000.000000-000", "20260101120000.000000+000"},
      {CIMTYPE_REFERENCE, "root/t:B.z=1,a=\"x\"", "root/t:B.a=\"x\",z=1"},
      {CIMTYPE_BOOLEAN, kNumbers, "TRUE TRUE "},
      {CIMTYPE_UINT64, kNumbers, "65 18446744073709551615 "},
      // U+FFFF is no character.
      {CIMTYPE_CHAR16, kNumbers, "A \xef\xbf\xbd "},
      {CIMTYPE_STRING, Texts{"a b", "", "c"}, "a b  c "},
      {CIMTYPE_DATETIME, Texts{"20260101120000.000000+060", "00000001000000.000000:000"},
       "20260101120000.000000+060 00000001000000.000000:000 "},
  };
  for (const auto& c : cases) {
    const int code = c.answer.getType();
    const bool isArray =
        code == ProviderDefValue::kIntArray || code == ProviderDefValue::kStringArray;
    EXPECT_EQ(textOf(Vaneth::toCimValue(c.answer, c.type, isArray)),
              std::string(cimTypeToString(c.type)) + (isArray ? "[] " : " ") + c.expected);
  }
}

TEST(CimValueRefusals, TextsOfNoSuchValue) {
  EXPECT_THROW(Vaneth::toCimValue("today", CIMTYPE_DATETIME, false), Exception);
  EXPECT_THROW(Vaneth::toCimValue("no path!", CIMTYPE_REFERENCE, false), Exception);
  EXPECT_THROW(Vaneth::toCimValue("\xff", CIMTYPE_STRING, false), Exception);
}

TEST(KeyBindingTypes, AreThoseOfTheValuesThemselves) {
  for (int code = CIMTYPE_BOOLEAN; code <= CIMTYPE_REFERENCE; ++code) {
    const CIMType type = static_cast<CIMType>(code);
    EXPECT_EQ(Vaneth::keyBindingType(type),
              CIMKeyBinding(CIMName("k"), CIMValue(type, false)).getType())
        << cimTypeToString(type);
  }
}

}  // namespace
