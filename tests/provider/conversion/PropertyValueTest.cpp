// CIM values read into definition values, for associations and conditions.

#include <gmock/gmock.h>

#include "ValueTable.h"
#include "engine/ProviderDefArgument.h"
#include "provider/CimConversion.h"
#include "tests/support/LogLevel.h"

using namespace Pegasus;

namespace {

std::string textOf(const ProviderDefValue& value) {
  std::string text;
  switch (value.getType()) {
    case ProviderDefValue::kInteger:
      return std::to_string(value.getIntValue());
    case ProviderDefValue::kString:
      return "'" + value.getStringValue() + "'";
    case ProviderDefValue::kIntArray:
      for (const int number : value.getIntArray()) text += " " + std::to_string(number);
      break;
    case ProviderDefValue::kStringArray:
      for (const std::string& element : value.getStringArray()) text += " '" + element + "'";
      break;
    default:
      return "type " + std::to_string(value.getType());
  }
  return "[" + (text.empty() ? text : text.substr(1)) + "]";
}

class PropertyValue : public testing::TestWithParam<ValueCase> {};

TEST_P(PropertyValue, IsReadByItsDeclaredType) {
  const LogLevel quiet(0);
  const CIMProperty property(CIMName("P"), GetParam().value);
  EXPECT_EQ(textOf(Vaneth::getPropertyValue(property)), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Types, PropertyValue, testing::ValuesIn(valueCases()));

INSTANTIATE_TEST_SUITE_P(Null, PropertyValue,
                         testing::Values(ValueCase{CIMValue(CIMTYPE_BOOLEAN, false), "0"},
                                         ValueCase{CIMValue(CIMTYPE_REAL64, false), "0"},
                                         ValueCase{CIMValue(CIMTYPE_CHAR16, false), "0"},
                                         ValueCase{CIMValue(CIMTYPE_STRING, false), "''"},
                                         ValueCase{CIMValue(CIMTYPE_DATETIME, false),
                                                   "'00000000000000.000000:000'"},
                                         ValueCase{CIMValue(CIMTYPE_REFERENCE, false), "''"},
                                         ValueCase{CIMValue(CIMTYPE_UINT8, true), "[]"},
                                         ValueCase{CIMValue(CIMTYPE_STRING, true), "[]"}));

TEST(PropertyValues, LineUpWithTheNames) {
  const LogLevel quiet(0);
  CIMInstance instance(CIMName("T_Item"));
  instance.addProperty(CIMProperty(CIMName("Name"), CIMValue(String("a"))));
  instance.addProperty(CIMProperty(CIMName("Size"), CIMValue(Uint8(3))));
  std::string texts;
  for (const auto& value : Vaneth::getPropertyValues(instance, {"size", "Lost", "Name", "Name"})) {
    texts += textOf(value) + " ";
  }
  EXPECT_EQ(texts, "3 0 'a' 'a' ");
  EXPECT_TRUE(Vaneth::getPropertyValues(instance, {}).empty());
}

TEST(CimProperty, IsAlwaysZero) {
  for (const char* query : {"", "SELECT Name FROM T_Item"}) {
    EXPECT_EQ(textOf(getCimProperty(query)), "0") << query;
  }
}

}  // namespace
