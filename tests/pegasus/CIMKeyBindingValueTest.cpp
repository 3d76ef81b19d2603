#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMValue.h>
#include <gtest/gtest.h>

#include <cmath>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

constexpr auto kBoolean = CIMKeyBinding::BOOLEAN;
constexpr auto kString = CIMKeyBinding::STRING;
constexpr auto kNumeric = CIMKeyBinding::NUMERIC;
constexpr auto kReference = CIMKeyBinding::REFERENCE;

struct KeyCase {
  CIMValue value;
  CIMKeyBinding::Type type;
  std::string expected;
};

TEST(CIMKeyBindingValue, TakesTypeAndTextFromTheValue) {
  const KeyCase cases[] = {
      {Boolean(true), kBoolean, "TRUE"},
      {Boolean(false), kBoolean, "FALSE"},
      {Uint8(5), kNumeric, "5"},
      {2.9, kNumeric, "2.8999999999999999e+00"},
      {2.9f, kNumeric, "2.9000000953674316e+00"},
      {Char16('A'), kString, "A"},
      {String("a\"b"), kString, "a\"b"},
      {CIMDateTime(), kString, "00000000000000.000000:000"},
      {CIMObjectPath(String("root/demo:B.z=1,a=\"x\"")), kReference, "root/demo:B.a=\"x\",z=1"},
      {CIMValue(CIMTYPE_STRING, false), kString, ""},
      {CIMValue(CIMTYPE_UINT32, false), kNumeric, ""},
      {CIMValue(CIMTYPE_REFERENCE, false), kReference, ""},
  };
  for (const KeyCase& c : cases) {
    const CIMKeyBinding key(CIMName("k"), c.value);
    EXPECT_EQ(text(key.getValue()), c.expected);
    EXPECT_EQ(key.getType(), c.type) << c.expected;
  }
}

TEST(CIMKeyBindingValue, RefusesArraysAndObjects) {
  const CIMValue refused[] = {Array<Uint32>(2), CIMValue(CIMTYPE_STRING, true),
                              CIMValue(CIMInstance(CIMName("A"))), CIMValue(CIMTYPE_OBJECT, false)};
  for (const CIMValue& value : refused) {
    EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { CIMKeyBinding(CIMName("k"), value); }),
              "type mismatch");
  }
}

struct EqualCase {
  const char* key;
  CIMKeyBinding::Type type;
  CIMValue value;
  bool expected;
};

TEST(CIMKeyBindingValue, ReadsTheTextAsTheTypeOfTheValue) {
  const EqualCase cases[] = {
      {"true", kBoolean, Boolean(true), true},
      {"1", kBoolean, Boolean(true), false},
      {"0x10", kNumeric, Uint8(16), true},
      {"256", kNumeric, Uint8(0), false},
      {"-128", kNumeric, Sint8(-128), true},
      {"-129", kNumeric, Sint8(127), false},
      {"18446744073709551615", kNumeric, Uint64(-1), true},
      {"18446744073709551616", kNumeric, Uint64(0), false},
      {"1.5", kNumeric, 1.5, true},
      {"", kNumeric, Uint32(0), false},
      {"", kNumeric, 0.0, false},
      {".05", kNumeric, 0.05, true},
      {"+1.5E+2", kNumeric, 150.0f, true},
      {"1", kNumeric, 1.0, false},
      {"1e0", kNumeric, 1.0, false},
      {"1.5e", kNumeric, 1.5, false},
      {" 1.5", kNumeric, 1.5, false},
      {"1.5e400", kNumeric, HUGE_VAL, false},
      {"A", kString, Char16('A'), true},
      {"AB", kString, Char16('A'), true},
      {"", kString, Char16(0), true},
      {"a", kString, String("a"), true},
      {"a", kString, String("A"), false},
      {"00000000000000.000000:000", kString, CIMDateTime(), true},
      {"no date", kString, CIMDateTime(), false},
      {"A.b=2,a=1", kReference, CIMObjectPath(String("a.A=1,B=2")), true},
      {"no path!", kReference, CIMObjectPath(String("A")), false},
      {"1", kString, Uint32(1), false},
      {"1", kNumeric, Array<Uint32>(1, Uint32(1)), false},
      {"1", kNumeric, CIMValue(CIMTYPE_UINT32, false), false},
      {"A", kString, CIMInstance(CIMName("A")), false},
  };
  for (const EqualCase& c : cases) {
    CIMKeyBinding key(CIMName("k"), String(c.key), c.type);
    EXPECT_EQ(key.equal(c.value), c.expected) << c.key << " / " << text(c.value.toString());
  }
  CIMKeyBinding stamp(CIMName("k"), String("20260101120000.000000+000"), kString);
  EXPECT_THROW(stamp.equal(CIMDateTime()), TypeMismatchException);
}

}  // namespace
