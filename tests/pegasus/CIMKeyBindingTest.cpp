#include <Pegasus/Common/CIMObjectPath.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;

namespace {

using Pairs = std::vector<std::pair<const char*, const char*>>;

void expectEquality(CIMKeyBinding::Type type, bool equal, const Pairs& pairs) {
  for (const auto& [a, b] : pairs) {
    const CIMKeyBinding x("Key", a, type);
    const CIMKeyBinding y("kEY", b, type);
    EXPECT_EQ(x == y, equal) << a << " / " << b;
    EXPECT_EQ(y == x, equal) << b << " / " << a;
  }
}

TEST(CIMKeyBinding, ComparesNumbers) {
  expectEquality(CIMKeyBinding::NUMERIC, true,
                 {{"1", "1"},
                  {"1", "0x1"},
                  {"1", "0X1"},
                  {"1", "+1"},
                  {"-1", "-0x1"},
                  {"0", "-0"},
                  {"0", "+0"},
                  {"0xFF", "255"},
                  {"18446744073709551615", "0xFFFFFFFFFFFFFFFF"},
                  {"18446744073709551616", "18446744073709551616"},
                  {"", ""},
                  {"-9223372036854775808", "-0x8000000000000000"},
                  {"+9223372036854775807", "0x7FFFFFFFFFFFFFFF"}});
  expectEquality(CIMKeyBinding::NUMERIC, false,
                 {{"1", "01"},
                  {"1", "-1"},
                  {"1", "1 "},
                  {"1", "1.0000000000000000e+00"},
                  {"0", "00"},
                  {"2.9000000000000000e+00", "2.9e0"},
                  {"abc", "ABC"},
                  {"0", "0x"},
                  {"18446744073709551616", "0"},
                  {"9223372036854775808", "+9223372036854775808"},
                  {"-9223372036854775809", "9223372036854775807"},
                  {"0", "+"},
                  {"0", "-"},
                  {"26", "0x1G"},
                  {"0x10000000000000000", "0"}});
}

TEST(CIMKeyBinding, ComparesTruthValuesAndText) {
  expectEquality(CIMKeyBinding::BOOLEAN, true, {{"true", "TRUE"}, {"maybe", "MAYBE"}});
  expectEquality(CIMKeyBinding::BOOLEAN, false, {{"TRUE", "1"}, {"TRUE", "FALSE"}, {"TRUE", ""}});
  expectEquality(CIMKeyBinding::STRING, true, {{"abc", "abc"}, {"", ""}});
  expectEquality(CIMKeyBinding::STRING, false, {{"abc", "ABC"}, {"abc", "abc "}, {"1", "01"}});
}

TEST(CIMKeyBinding, ComparesReferences) {
  expectEquality(CIMKeyBinding::REFERENCE, true,
                 {{"root/demo:A.k=\"v\"", "ROOT/DEMO:a.K=\"v\""},
                  {"A.a=1,b=2", "A.b=2,a=1"},
                  {"A.a=1", "A.a=0x1"},
                  {"//h/root:A.k=1", "//H/root:A.k=1"},
                  {"not a path!", "not a path!"},
                  {"C.r=\"A.a=1,b=2\"", "C.r=\"a.B=2,A=0x1\""}});
  expectEquality(CIMKeyBinding::REFERENCE, false,
                 {{"A.k=\"v\"", "A.k=\"V\""},
                  {"root:A.k=1", "A.k=1"},
                  {"//h/root:A.k=1", "root:A.k=1"},
                  {"not a path!", "Not a path!"},
                  {"A.a=1", "not a path!"},
                  {"C.r=\"A.a=1\"", "C.r=\"A.a=2\""}});
}

TEST(CIMKeyBinding, DiffersByNameAndType) {
  const CIMKeyBinding key("Key", "1", CIMKeyBinding::NUMERIC);
  EXPECT_FALSE(key == CIMKeyBinding("Key", "1", CIMKeyBinding::STRING));
  EXPECT_FALSE(key == CIMKeyBinding("Key2", "1", CIMKeyBinding::NUMERIC));
}

}  // namespace
