// Definition values, as plug-ins answer, turned into CIM values of every type.

#include <gmock/gmock.h>

#include <climits>

#include "CimText.h"
#include "provider/CimConversion.h"

using namespace Pegasus;

namespace {

using Numbers = std::vector<int>;
using Texts = std::vector<std::string>;

struct ConversionCase {
  CIMType type;
  ProviderDefValue answer;
  std::string expected;  ///< The value's text.
};

std::ostream& operator<<(std::ostream& out, const ConversionCase& given) {
  return out << cimTypeToString(given.type) << " " << given.expected;
}

const long kWide = sizeof(long) == 8 ? LONG_MIN : -5;

class CimValueOf : public testing::TestWithParam<ConversionCase> {};

TEST_P(CimValueOf, Answer) {
  const ConversionCase& given = GetParam();
  const int code = given.answer.getType();
  const bool isArray =
      code == ProviderDefValue::kIntArray || code == ProviderDefValue::kStringArray;
  EXPECT_EQ(textOf(Vaneth::toCimValue(given.answer, given.type, isArray)),
            std::string(cimTypeToString(given.type)) + (isArray ? "[] " : " ") + given.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Numbers, CimValueOf,
    testing::Values(ConversionCase{CIMTYPE_BOOLEAN, -2, "TRUE"},
                    ConversionCase{CIMTYPE_BOOLEAN, 0, "FALSE"},
                    ConversionCase{CIMTYPE_UINT8, 511, "255"},
                    ConversionCase{CIMTYPE_SINT8, 255, "-1"},
                    ConversionCase{CIMTYPE_UINT16, -1, "65535"},
                    ConversionCase{CIMTYPE_SINT16, 0x18000, "-32768"},
                    ConversionCase{CIMTYPE_UINT32, -1, "4294967295"},
                    ConversionCase{CIMTYPE_SINT32, INT_MIN, "-2147483648"},
                    ConversionCase{CIMTYPE_UINT64, -1, "18446744073709551615"},
                    ConversionCase{CIMTYPE_UINT64, kWide,
                                   std::to_string(static_cast<unsigned long long>(kWide))},
                    ConversionCase{CIMTYPE_SINT64, kWide, std::to_string(kWide)},
                    // Only 64-bit properties read a long.
                    ConversionCase{CIMTYPE_SINT32, kWide, "0"},
                    ConversionCase{CIMTYPE_REAL32, 3, "3.0000000000000000e+00"},
                    ConversionCase{CIMTYPE_REAL64, -2, "-2.0000000000000000e+00"},
                    ConversionCase{CIMTYPE_CHAR16, 0x10041, "A"},
                    // A boolean constant has no integer.
                    ConversionCase{CIMTYPE_BOOLEAN, true, "FALSE"}));

INSTANTIATE_TEST_SUITE_P(
    Texts, CimValueOf,
    testing::Values(
        ConversionCase{CIMTYPE_STRING, "\xc3\xa9 %s\"", "\xc3\xa9 %s\""},
        ConversionCase{CIMTYPE_STRING, 5, ""},
        ConversionCase{CIMTYPE_DATETIME, "20260101120000.000000-000", "20260101120000.000000+000"},
        ConversionCase{CIMTYPE_REFERENCE, "root/t:B.z=1,a=\"x\"", "root/t:B.a=\"x\",z=1"}));

const Numbers kNumbers = {65, -1};

INSTANTIATE_TEST_SUITE_P(
    Arrays, CimValueOf,
    testing::Values(ConversionCase{CIMTYPE_BOOLEAN, kNumbers, "TRUE TRUE "},
                    ConversionCase{CIMTYPE_UINT64, kNumbers, "65 18446744073709551615 "},
                    // U+FFFF is no character.
                    ConversionCase{CIMTYPE_CHAR16, kNumbers, "A \xef\xbf\xbd "},
                    ConversionCase{CIMTYPE_STRING, Texts{"a b", "", "c"}, "a b  c "},
                    ConversionCase{CIMTYPE_DATETIME,
                                   Texts{"20260101120000.000000+060", "00000001000000.000000:000"},
                                   "20260101120000.000000+060 00000001000000.000000:000 "}));

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
