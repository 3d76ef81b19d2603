#include <Pegasus/Common/CIMInstance.h>

#include <cmath>
#include <tuple>
#include <utility>
#include <vector>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

constexpr auto kBoolean = CIMKeyBinding::BOOLEAN;
constexpr auto kString = CIMKeyBinding::STRING;
constexpr auto kNumeric = CIMKeyBinding::NUMERIC;
constexpr auto kReference = CIMKeyBinding::REFERENCE;

using Pairs = std::vector<std::pair<const char*, const char*>>;

void expectEquality(CIMKeyBinding::Type type, bool equal, const Pairs& pairs) {
  for (const auto& [a, b] : pairs) {
    const CIMKeyBinding x("Key", a, type), y("kEY", b, type);
    EXPECT_EQ(x == y, equal) << a << " / " << b;
    EXPECT_EQ(y == x, equal) << b << " / " << a;
  }
}

TEST(CIMKeyBinding, ComparesByType) {
  expectEquality(kNumeric, true, {{"1", "0x1"}, {"1", "0X1"}, {"1", "+1"}, {"-1", "-0x1"}});
  expectEquality(kNumeric, true, {{"0", "-0"}, {"0xFF", "255"}, {"", ""}});
  expectEquality(kNumeric, true, {{"18446744073709551615", "0xFFFFFFFFFFFFFFFF"}});
  expectEquality(kNumeric, true, {{"18446744073709551616", "18446744073709551616"}});
  expectEquality(kNumeric, true, {{"-9223372036854775808", "-0x8000000000000000"}});
  expectEquality(kNumeric, false, {{"1", "01"}, {"1", "-1"}, {"1", "1 "}, {"1", "1.0e+00"}});
  expectEquality(kNumeric, false, {{"0", "00"}, {"0", "0x"}, {"0", "+"}, {"0", "-"}});
  expectEquality(kNumeric, false, {{"2.90e+00", "2.9e0"}, {"abc", "ABC"}, {"26", "0x1G"}});
  expectEquality(kNumeric, false, {{"18446744073709551616", "0"}, {"0x10000000000000000", "0"}});
  expectEquality(kNumeric, false, {{"9223372036854775808", "+9223372036854775808"}});
  expectEquality(kNumeric, false, {{"-9223372036854775809", "9223372036854775807"}});
  expectEquality(kBoolean, true, {{"true", "TRUE"}, {"maybe", "MAYBE"}});
  expectEquality(kBoolean, false, {{"TRUE", "1"}, {"TRUE", "FALSE"}, {"TRUE", ""}});
  expectEquality(kString, true, {{"abc", "abc"}, {"", ""}});
  expectEquality(kString, false, {{"abc", "ABC"}, {"1", "01"}});
  expectEquality(kReference, true, {{"root/demo:A.k=\"v\"", "ROOT/DEMO:a.K=\"v\""}});
  expectEquality(kReference, true, {{"A.a=1,b=2", "A.b=2,a=0x1"}, {"not a path!", "not a path!"}});
  expectEquality(kReference, false, {{"//h/root:A.k=1", "root:A.k=1"}, {"A.a=1", "not a path!"}});
  const CIMKeyBinding key("Key", "1", kNumeric);
  EXPECT_FALSE(key == CIMKeyBinding("Key", "1", kString));
  EXPECT_FALSE(key == CIMKeyBinding("Key2", "1", kNumeric));
}

TEST(CIMKeyBinding, TakesTypeAndTextFromAValue) {
  const std::tuple<CIMValue, CIMKeyBinding::Type, std::string> cases[] = {
      {Boolean(true), kBoolean, "TRUE"},
      {CIMObjectPath(String("root/demo:B.z=1,a=\"x\"")), kReference, "root/demo:B.a=\"x\",z=1"},
      {CIMValue(CIMTYPE_UINT32, false), kNumeric, ""},
      {CIMValue(CIMTYPE_REFERENCE, false), kReference, ""},
  };
  for (const auto& [value, type, expected] : cases) {
    const CIMKeyBinding key(CIMName("k"), value);
    EXPECT_EQ(text(key.getValue()), expected);
    EXPECT_EQ(key.getType(), type) << expected;
  }
  for (const CIMValue& value : {CIMValue(Array<Uint32>(2)), CIMValue(CIMTYPE_STRING, true),
                                CIMValue(CIMInstance(CIMName("A")))}) {
    EXPECT_EQ(thrownMessage<TypeMismatchException>([&] { CIMKeyBinding(CIMName("k"), value); }),
              "type mismatch");
  }
}

TEST(CIMKeyBinding, ReadsItsTextAsTheTypeOfAValue) {
  const std::tuple<const char*, CIMKeyBinding::Type, CIMValue, bool> cases[] = {
      {"1", kBoolean, Boolean(true), false},
      {"0x10", kNumeric, Uint8(16), true},
      {"-129", kNumeric, Sint8(127), false},
      {"18446744073709551615", kNumeric, Uint64(-1), true},
      {"18446744073709551616", kNumeric, Uint64(0), false},
      {"", kNumeric, Uint32(0), false},
      {".05", kNumeric, 0.05, true},
      {"+1.5E+2", kNumeric, 150.0f, true},
      {"1", kNumeric, 1.0, false},
      {"1e0", kNumeric, 1.0, false},
      {" 1.5", kNumeric, 1.5, false},
      {"1.5e400", kNumeric, HUGE_VAL, false},
      {"AB", kString, Char16('A'), true},
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
  for (const auto& [key, type, value, equal] : cases) {
    EXPECT_EQ(CIMKeyBinding(CIMName("k"), String(key), type).equal(value), equal)
        << key << " / " << text(value.toString());
  }
  CIMKeyBinding stamp(CIMName("k"), String("20260101120000.000000+000"), kString);
  EXPECT_THROW(stamp.equal(CIMDateTime()), TypeMismatchException);
}

}  // namespace
