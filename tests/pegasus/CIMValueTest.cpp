#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMValue.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

template <class T>
Array<T> arrayOf(const std::vector<T>& items) {
  Array<T> array;
  for (std::size_t i = 0; i < items.size(); ++i) array.append(items[i]);
  return array;
}

Array<Boolean> booleans(Boolean a, Boolean b) {
  Array<Boolean> array;
  array.append(a);
  array.append(b);
  return array;
}

String ofUnits(const std::vector<Uint16>& units) {
  String result;
  for (const Uint16 unit : units) result.append(Char16(unit));
  return result;
}

struct TextCase {
  CIMValue value;
  CIMType type;
  std::string expected;
};

TEST(CIMValue, WritesEveryTypeAsText) {
  const CIMDateTime stamp(String("20260101120000.000000+060"));
  const CIMObjectPath path(String("A.k=1"));
  const TextCase cases[] = {
      {Boolean(true), CIMTYPE_BOOLEAN, "TRUE"},
      {Boolean(false), CIMTYPE_BOOLEAN, "FALSE"},
      {Uint8(255), CIMTYPE_UINT8, "255"},
      {Sint8(-128), CIMTYPE_SINT8, "-128"},
      {Uint16(65535), CIMTYPE_UINT16, "65535"},
      {Sint16(-32768), CIMTYPE_SINT16, "-32768"},
      {5u, CIMTYPE_UINT32, "5"},
      {-5, CIMTYPE_SINT32, "-5"},
      {std::numeric_limits<Uint64>::max(), CIMTYPE_UINT64, "18446744073709551615"},
      {std::numeric_limits<Sint64>::min(), CIMTYPE_SINT64, "-9223372036854775808"},
      {2.9f, CIMTYPE_REAL32, "2.9000000953674316e+00"},
      {16777217.0f, CIMTYPE_REAL32, "1.6777216000000000e+07"},
      {2.9, CIMTYPE_REAL64, "2.8999999999999999e+00"},
      {-0.0, CIMTYPE_REAL64, "-0.0000000000000000e+00"},
      {1e300, CIMTYPE_REAL64, "1.0000000000000001e+300"},
      {std::numeric_limits<double>::max(), CIMTYPE_REAL64, "1.7976931348623157e+308"},
      {5e-324, CIMTYPE_REAL64, "4.9406564584124654e-324"},
      {HUGE_VAL, CIMTYPE_REAL64, "inf"},
      {std::fabs(std::nan("")), CIMTYPE_REAL64, "nan"},
      {Char16('A'), CIMTYPE_CHAR16, "A"},
      {Char16(0x20AC), CIMTYPE_CHAR16, "\xE2\x82\xAC"},
      {Char16(0xD800), CIMTYPE_CHAR16, ""},
      {String("a\"b"), CIMTYPE_STRING, "a\"b"},
      {String("cut\0here", 8), CIMTYPE_STRING, "cut"},
      {stamp, CIMTYPE_DATETIME, "20260101120000.000000+060"},
      {path, CIMTYPE_REFERENCE, "A.k=1"},
      {booleans(true, false), CIMTYPE_BOOLEAN, "TRUE FALSE "},
      {arrayOf<Sint8>({-1, 65}), CIMTYPE_SINT8, "-1 65 "},
      {arrayOf<Real64>({1.5, -2}), CIMTYPE_REAL64,
       "1.5000000000000000e+00 -2.0000000000000000e+00 "},
      {arrayOf<String>({"a b", "", "c"}), CIMTYPE_STRING, "a b  c "},
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
      {arrayOf<CIMDateTime>({stamp, CIMDateTime()}), CIMTYPE_DATETIME,
       "20260101120000.000000+060 00000000000000.000000:000 "},
      {arrayOf<CIMObjectPath>({path, CIMObjectPath(String("root/b:B"))}), CIMTYPE_REFERENCE,
       "A.k=1 root/b:B "},
      {Array<Uint8>(), CIMTYPE_UINT8, ""},
  };
  for (const TextCase& c : cases) {
    EXPECT_EQ(text(c.value.toString()), c.expected);
    EXPECT_EQ(c.value.getType(), c.type) << c.expected;
    EXPECT_FALSE(c.value.isNull()) << c.expected;
  }
}

TEST(CIMValue, TakesALiteralForABoolean) {
  const char* const literal = "abc";
  const CIMValue value(literal);
  EXPECT_EQ(value.getType(), CIMTYPE_BOOLEAN);
  EXPECT_EQ(text(value.toString()), "TRUE");
}

TEST(CIMValue, NullHasATypeAndADeclaredSize) {
  for (int code = CIMTYPE_BOOLEAN; code <= CIMTYPE_INSTANCE; ++code) {
    const CIMType type = static_cast<CIMType>(code);
    const CIMValue scalar(type, false, 7);
    const CIMValue array(type, true, 3);
    EXPECT_TRUE(scalar.isNull() && !scalar.isArray() && scalar.getType() == type);
    EXPECT_TRUE(array.isNull() && array.isArray() && array.getType() == type);
    EXPECT_EQ(scalar.getArraySize(), 0u);
    EXPECT_EQ(array.getArraySize(), 3u);
    EXPECT_EQ(text(array.toString()) + text(scalar.toString()), "");
  }
}

TEST(CIMValue, GetLeavesTheVariableAloneWhenNull) {
  Sint32 number = 77;
  CIMValue(CIMTYPE_SINT32, false).get(number);
  EXPECT_EQ(number, 77);
  String str("zz");
  CIMValue(CIMTYPE_STRING, false).get(str);
  EXPECT_EQ(text(str), "zz");
  Array<Uint32> array(1);
  CIMValue(CIMTYPE_UINT32, true).get(array);
  EXPECT_EQ(array.size(), 1u);
  Boolean flag = true;
  CIMValue().get(flag);
  EXPECT_TRUE(flag);
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
  EXPECT_EQ(getAs<Uint64>(Uint32(5)), mismatch);
  EXPECT_EQ(getAs<Array<Uint32>>(Uint32(5)), mismatch);
  EXPECT_EQ(getAs<Uint32>(arrayOf<Uint32>({5})), mismatch);
  EXPECT_EQ(getAs<Real64>(1.5f), mismatch);
  EXPECT_EQ(getAs<Boolean>(CIMValue(CIMTYPE_STRING, false)), mismatch);
  EXPECT_EQ(getAs<String>(CIMValue()), mismatch);
  EXPECT_EQ(getAs<Uint32>(Uint32(5)), "no exception");
}

struct EqualCase {
  CIMValue x, y;
  bool expected;
};

TEST(CIMValue, ComparesTypeNullAndContent) {
  const EqualCase cases[] = {
      {Uint32(5), Sint32(5), false},
      {Uint32(5), Uint32(5), true},
      {Uint32(5), arrayOf<Uint32>({5}), false},
      {CIMValue(CIMTYPE_STRING, false), CIMValue(), false},
      {CIMValue(CIMTYPE_STRING, true, 0), CIMValue(CIMTYPE_STRING, true, 3), true},
      {CIMValue(CIMTYPE_STRING, false), String(), false},
      {String("abc"), String("ABC"), false},
      {-0.0, 0.0, true},
      {std::nan(""), std::nan(""), false},
      {arrayOf<Real32>({1, 2}), arrayOf<Real32>({1}), false},
      {arrayOf<Real32>({1, 2}), arrayOf<Real32>({2, 1}), false},
      {CIMObjectPath(String("a.A=1")), CIMObjectPath(String("A.a=0x1")), true},
      {CIMDateTime(String("20260101120000.000000+060")),
       CIMDateTime(String("20260101110000.000000+000")), true},
      {CIMInstance(CIMName("A")), CIMInstance(CIMName("A")), true},
      {CIMInstance(CIMName("A")), CIMInstance(CIMName("B")), false},
  };
  for (const EqualCase& c : cases) {
    EXPECT_EQ(c.x == c.y, c.expected) << text(c.x.toString()) << " / " << text(c.y.toString());
    EXPECT_EQ(c.y != c.x, !c.expected);
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
  CIMInstance inner(CIMName("Inner"));
  inner.addProperty(CIMProperty(CIMName("p"), Uint32(1)));
  Array<CIMInstance> inners(1, inner);
  const CIMValue scalar(inner);
  const CIMValue array(inners);
  inner.getProperty(0).setValue(Uint32(2));
  CIMInstance out;
  scalar.get(out);
  EXPECT_EQ(text(out.getProperty(0).getValue().toString()), "1");
  out.getProperty(0).setValue(Uint32(3));
  Array<CIMInstance> outs;
  array.get(outs);
  EXPECT_EQ(text(outs[0].getProperty(0).getValue().toString()), "1");
  outs[0].getProperty(0).setValue(Uint32(3));
  scalar.get(out);
  array.get(outs);
  EXPECT_EQ(text(out.getProperty(0).getValue().toString()), "1");
  EXPECT_EQ(text(outs[0].getProperty(0).getValue().toString()), "1");
}

TEST(CIMValue, RefusesUninitializedObjects) {
  const char* const message = "uninitialized object";
  EXPECT_EQ(thrownMessage<UninitializedObjectException>([] { CIMValue(CIMInstance{}); }), message);
  EXPECT_EQ(thrownMessage<UninitializedObjectException>([] { CIMValue(CIMObject{}); }), message);
  EXPECT_EQ(thrownMessage<UninitializedObjectException>(
                [] { CIMValue(Array<CIMInstance>(2, CIMInstance())); }),
            message);
}

}  // namespace
