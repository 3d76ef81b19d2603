#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMValue.h>

#include <cmath>
#include <initializer_list>
#include <limits>
#include <tuple>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

template <class T>
Array<T> arrayOf(std::initializer_list<T> items) {
  Array<T> array;
  for (const auto& item : items) array.append(item);
  return array;
}

String ofUnits(std::initializer_list<Uint16> units) {
  String result;
  for (const Uint16 unit : units) result.append(Char16(unit));
  return result;
}

TEST(CIMValue, WritesEveryTypeAsText) {
  const std::tuple<CIMValue, CIMType, std::string> cases[] = {
      {Boolean(true), CIMTYPE_BOOLEAN, "TRUE"},
      {std::numeric_limits<Uint64>::max(), CIMTYPE_UINT64, "18446744073709551615"},
      {std::numeric_limits<Sint64>::min(), CIMTYPE_SINT64, "-9223372036854775808"},
      {2.9f, CIMTYPE_REAL32, "2.9000000953674316e+00"},
      {-0.0, CIMTYPE_REAL64, "-0.0000000000000000e+00"},
      {std::numeric_limits<double>::max(), CIMTYPE_REAL64, "1.7976931348623157e+308"},
      {HUGE_VAL, CIMTYPE_REAL64, "inf"},
      {std::fabs(std::nan("")), CIMTYPE_REAL64, "nan"},
      {Char16(0x20AC), CIMTYPE_CHAR16, "\xE2\x82\xAC"},
      {Char16(0xD800), CIMTYPE_CHAR16, ""},
      {String("cut\0here", 8), CIMTYPE_STRING, "cut"},
      // Zero and the first half of a character end the text of the whole array.
      {arrayOf<Char16>({Char16('x'), Char16(0), Char16('y')}), CIMTYPE_CHAR16, "x "},
      {arrayOf<Char16>({Char16('x'), Char16(0xD83D), Char16(0xDE00)}), CIMTYPE_CHAR16, "x "},
      {arrayOf<Char16>({Char16(0xDE00), Char16(0xFFFF)}), CIMTYPE_CHAR16,
       "\xEF\xBF\xBD \xEF\xBF\xBD "},
      {arrayOf<String>({"a", String("b\0c", 3), "d"}), CIMTYPE_STRING, "a b"},
      // Half a character takes the next unit with it.
      {ofUnits({'a', 0xD800, 'b', 'c', 0xFFFE, 0xD83D, 0xDE00}), CIMTYPE_STRING,
       "a\xEF\xBF\xBD"
       "c\xEF\xBF\xBD\xF0\x9F\x98\x80"},
      {Array<Uint8>(), CIMTYPE_UINT8, ""},
  };
  for (const auto& [value, type, expected] : cases) {
    EXPECT_EQ(text(value.toString()), expected);
    EXPECT_EQ(value.getType(), type) << expected;
    EXPECT_FALSE(value.isNull()) << expected;
  }
  const char* const literal = "abc";
  EXPECT_EQ(CIMValue(literal).getType(), CIMTYPE_BOOLEAN) << "a pointer is no text";
}

TEST(CIMValue, GetLeavesTheVariableAloneWhenNull) {
  Sint32 number = 77;
  CIMValue(CIMTYPE_SINT32, false).get(number);
  EXPECT_EQ(number, 77);
  Array<Uint32> array(1);
  CIMValue(CIMTYPE_UINT32, true).get(array);
  EXPECT_EQ(array.size(), 1u);
}

template <class T>
std::string getAs(const CIMValue& value) {
  return thrownMessage<TypeMismatchException>([&] {
    T x{};
    value.get(x);
  });
}

TEST(CIMValue, GetNeverConverts) {
  const char* const mismatch = "type mismatch";
  EXPECT_EQ(getAs<Sint32>(Uint32(5)), mismatch);
  EXPECT_EQ(getAs<Array<Uint32>>(Uint32(5)), mismatch);
  EXPECT_EQ(getAs<Uint32>(arrayOf<Uint32>({5})), mismatch);
  EXPECT_EQ(getAs<Boolean>(CIMValue(CIMTYPE_STRING, false)), mismatch);
  EXPECT_EQ(getAs<Uint32>(Uint32(5)), "no exception");
}

TEST(CIMValue, ComparesTypeNullAndContent) {
  const std::tuple<CIMValue, CIMValue, bool> cases[] = {
      {Uint32(5), Sint32(5), false},
      {Uint32(5), Uint32(5), true},
      {Uint32(5), arrayOf<Uint32>({5}), false},
      {CIMValue(CIMTYPE_STRING, false), CIMValue(), false},
      {CIMValue(CIMTYPE_STRING, true, 0), CIMValue(CIMTYPE_STRING, true, 3), true},
      {CIMValue(CIMTYPE_STRING, false), String(), false},
      {-0.0, 0.0, true},
      {std::nan(""), std::nan(""), false},
      {arrayOf<Real32>({1, 2}), arrayOf<Real32>({1}), false},
      {CIMObjectPath(String("a.A=1")), CIMObjectPath(String("A.a=0x1")), true},
      {CIMDateTime(String("20260101120000.000000+060")),
       CIMDateTime(String("20260101110000.000000+000")), true},
      {CIMInstance(CIMName("A")), CIMInstance(CIMName("A")), true},
      {CIMInstance(CIMName("A")), CIMInstance(CIMName("B")), false},
  };
  for (const auto& [x, y, equal] : cases) {
    EXPECT_EQ(x == y, equal) << text(x.toString()) << " / " << text(y.toString());
    EXPECT_EQ(y != x, !equal);
  }
  // An instance does not ask what the other object is.
  const CIMValue instance{CIMObject(CIMInstance(CIMName("A")))};
  const CIMValue ofClass{CIMObject(CIMClass(CIMName("A"), CIMName("Base")))};
  EXPECT_TRUE(instance == ofClass);
  EXPECT_FALSE(ofClass == instance);
}

TEST(CIMValue, ACopyIsIndependent) {
  CIMValue source(arrayOf<String>({"a", "b"}));
  CIMValue copy(source);
  copy.set(String("other"));
  EXPECT_EQ(text(source.toString()), "a b ");
  Array<String> out;
  source.get(out);
  out[0] = String("changed");
  EXPECT_EQ(text(source.toString()), "a b ");
  source.clear();
  EXPECT_EQ(source, CIMValue());
}

TEST(CIMValue, ClonesObjectsInAndOut) {
  const auto number = [](const CIMInstance& instance) {
    return text(instance.getProperty(0).getValue().toString());
  };
  CIMInstance inner(CIMName("Inner"));
  inner.addProperty(CIMProperty(CIMName("p"), Uint32(1)));
  const CIMValue scalar(inner);
  const CIMValue array(Array<CIMInstance>(1, inner));
  inner.getProperty(0).setValue(Uint32(2));
  for (int i = 0; i < 2; ++i) {
    CIMInstance out;
    Array<CIMInstance> outs;
    scalar.get(out);
    array.get(outs);
    EXPECT_EQ(number(out) + number(outs[0]), "11");
    out.getProperty(0).setValue(Uint32(3));
    outs[0].getProperty(0).setValue(Uint32(3));
  }
}

TEST(CIMValue, RefusesUninitializedObjects) {
  const char* const message = "uninitialized object";
  EXPECT_EQ(thrownMessage<UninitializedObjectException>([] { CIMValue(CIMInstance{}); }), message);
  EXPECT_EQ(thrownMessage<UninitializedObjectException>(
                [] { CIMValue(Array<CIMInstance>(2, CIMInstance())); }),
            message);
}

}  // namespace
