// CIM values read into definition values, for associations and conditions.

#include <Pegasus/Common/CIMDateTime.h>
#include <gtest/gtest.h>

#include <limits>

#include "CimText.h"
#include "engine/ProviderDefArgument.h"
#include "provider/CimConversion.h"
#include "tests/engine/ValueText.h"
#include "tests/support/LogLevel.h"

namespace {

template <class T>
CIMValue arrayValue(std::initializer_list<T> elements) {
  Array<T> array;
  for (const T& element : elements) array.append(element);
  return CIMValue(array);
}

TEST(PropertyValue, IsReadByItsType) {
  const String date("20260101120000.000000-000");
  const std::pair<CIMValue, const char*> cases[] = {
      {CIMValue(Boolean(true)), "0 1"},
      {CIMValue(Sint8(-128)), "0 -128"},
      {CIMValue(Uint32(4294967295u)), "0 -1"},
      {CIMValue(Uint64(0x100000005ull)), "0 5"},
      {CIMValue(Uint64(0x80000000ull)), "0 -2147483648"},
      {CIMValue(Sint64(-1)), "0 -1"},
      {CIMValue(Real32(2.9f)), "0 2"},
      {CIMValue(Real64(-2.9)), "0 -2"},
      {CIMValue(Real64(1e300)), "0 2147483647"},
      {CIMValue(-std::numeric_limits<Real64>::infinity()), "0 -2147483648"},
      {CIMValue(std::numeric_limits<Real32>::quiet_NaN()), "0 0"},
      {CIMValue(Char16(0xFFFE)), "0 65534"},
      {CIMValue(String("\xc3\xa9 %s")), "1 \xc3\xa9 %s"},
      {CIMValue(CIMDateTime(date)), "1 20260101120000.000000+000"},
      {CIMValue(CIMObjectPath(String("root/t:B.z=1,a=\"x\""))), "1 root/t:B.a=\"x\",z=1"},
      {arrayValue<Boolean>({true, false}), "2 {1, 0}"},
      {arrayValue<Uint32>({4294967295u, 1}), "2 {-1, 1}"},
      {arrayValue<Sint32>({}), "2 {}"},
      {arrayValue<Real32>({2.9f, -2.9f}), "2 {2, -2}"},
      {arrayValue<String>({String("a b"), String(), String("c")}), "3 {a b, , c}"},
      {arrayValue<CIMDateTime>({CIMDateTime(date)}), "3 {20260101120000.000000+000}"},
      {arrayValue<CIMObjectPath>({CIMObjectPath(String("A.k=1")), CIMObjectPath(String("x:B"))}),
       "3 {A.k=1, x:B}"},
      // Null is zero or empty.
      {CIMValue(CIMTYPE_REAL64, false), "0 0"},
      {CIMValue(CIMTYPE_STRING, false), "1 "},
      {CIMValue(CIMTYPE_DATETIME, false), "1 00000000000000.000000:000"},
      {CIMValue(CIMTYPE_REFERENCE, false), "1 "},
      {CIMValue(CIMTYPE_UINT8, true), "2 {}"},
  };
  for (const auto& [value, expected] : cases) {
    EXPECT_EQ(valueText(Vaneth::fromCimValue(value, value.getType(), value.isArray())), expected)
        << textOf(value);
  }
}

TEST(PropertyValues, LineUpWithTheNames) {
  const LogLevel quiet(0);
  CIMInstance instance(CIMName("T_Item"));
  instance.addProperty(CIMProperty(CIMName("Name"), CIMValue(String("a"))));
  instance.addProperty(CIMProperty(CIMName("Size"), CIMValue(Uint8(3))));
  EXPECT_EQ(valueText(Vaneth::getPropertyValues(instance, {"size", "Lost", "Name", "Name"})),
            "0 3; 0 0; 1 a; 1 a; ");
  EXPECT_TRUE(Vaneth::getPropertyValues(instance, {}).empty());
}

TEST(CimProperty, IsAlwaysZero) {
  for (const char* query : {"", "SELECT Name FROM T_Item"}) {
    EXPECT_EQ(valueText(getCimProperty(query)), "0 0") << query;
  }
}

}  // namespace
