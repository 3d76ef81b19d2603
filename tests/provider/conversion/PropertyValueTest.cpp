// CIM values read into definition values, for associations and conditions.

#include <Pegasus/Common/CIMDateTime.h>
#include <gtest/gtest.h>

#include <limits>

#include "CimText.h"
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

/// A CIM value and what it is as a definition value, written as the plug-in writes it: 5, 'text',
/// [1 2], ['a' 'b'].
struct ValueCase {
  CIMValue value;
  std::string expected;
};

template <class T>
CIMValue arrayValue(std::initializer_list<T> elements) {
  Array<T> array;
  for (const T& element : elements) array.append(element);
  return CIMValue(array);
}

/// Every CIM type, with the values where a conversion can go wrong.
std::vector<ValueCase> valueCases() {
  const String date("20260101120000.000000-000");
  return {
      {CIMValue(Boolean(true)), "1"},
      {CIMValue(Uint8(255)), "255"},
      {CIMValue(Sint8(-128)), "-128"},
      {CIMValue(Uint16(65535)), "65535"},
      {CIMValue(Sint16(-32768)), "-32768"},
      {CIMValue(Uint32(4294967295u)), "-1"},
      {CIMValue(Sint32(-5)), "-5"},
      {CIMValue(Uint64(0x100000005ull)), "5"},
      {CIMValue(Uint64(0x100000000ull)), "0"},
      {CIMValue(Uint64(0x80000000ull)), "-2147483648"},
      {CIMValue(Sint64(-1)), "-1"},
      {CIMValue(Real32(2.9f)), "2"},
      {CIMValue(Real64(-2.9)), "-2"},
      {CIMValue(Real64(1e300)), "2147483647"},
      {CIMValue(-std::numeric_limits<Real64>::infinity()), "-2147483648"},
      {CIMValue(std::numeric_limits<Real32>::quiet_NaN()), "0"},
      {CIMValue(Char16(0xFFFE)), "65534"},
      {CIMValue(String("\xc3\xa9 %s")), "'\xc3\xa9 %s'"},
      {CIMValue(CIMDateTime(date)), "'20260101120000.000000+000'"},
      {CIMValue(CIMObjectPath(String("root/t:B.z=1,a=\"x\""))), "'root/t:B.a=\"x\",z=1'"},
      {arrayValue<Boolean>({true, false}), "[1 0]"},
      {arrayValue<Uint8>({0, 255}), "[0 255]"},
      {arrayValue<Uint32>({4294967295u, 1}), "[-1 1]"},
      {arrayValue<Sint32>({}), "[]"},
      {arrayValue<Uint64>({0x100000005ull}), "[5]"},
      {arrayValue<Real32>({2.9f, -2.9f}), "[2 -2]"},
      {arrayValue<Real64>({1e300}), "[2147483647]"},
      {arrayValue<Char16>({Char16(65)}), "[65]"},
      {arrayValue<String>({String("a b"), String(), String("c")}), "['a b' '' 'c']"},
      {arrayValue<CIMDateTime>({CIMDateTime(date)}), "['20260101120000.000000+000']"},
      {arrayValue<CIMObjectPath>({CIMObjectPath(String("A.k=1")), CIMObjectPath(String("x:B"))}),
       "['A.k=1' 'x:B']"},
      // Null is zero or empty.
      {CIMValue(CIMTYPE_BOOLEAN, false), "0"},
      {CIMValue(CIMTYPE_REAL64, false), "0"},
      {CIMValue(CIMTYPE_STRING, false), "''"},
      {CIMValue(CIMTYPE_DATETIME, false), "'00000000000000.000000:000'"},
      {CIMValue(CIMTYPE_REFERENCE, false), "''"},
      {CIMValue(CIMTYPE_UINT8, true), "[]"},
  };
}

TEST(PropertyValue, IsReadByItsType) {
  for (const auto& [value, expected] : valueCases()) {
    EXPECT_EQ(textOf(Vaneth::fromCimValue(value, value.getType(), value.isArray())), expected)
        << ::textOf(value);
  }
}

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
