#include "tests/cimhost/mof/MofTestSupport.h"

namespace cimhost_test {
namespace {

struct ValueCase {
  const char* declaration;  // A property P.
  const char* expected;     // As propertyText() writes it.
};

void PrintTo(const ValueCase& c, std::ostream* out) {
  *out << c.expected;
}

class MofValue : public testing::TestWithParam<ValueCase> {};

TEST_P(MofValue, BecomesTheDefault) {
  Mof mof;
  ASSERT_TRUE(mof.read(std::string("class A { ") + GetParam().declaration + "; };"))
      << mof.diagnostics();
  const Pegasus::CIMConstClass a = mof.get("A");
  EXPECT_EQ(propertyText(a.getProperty(0)), std::string(GetParam().expected) + " (A)");
}

INSTANTIATE_TEST_SUITE_P(
    Types, MofValue,
    testing::Values(
        ValueCase{"boolean P", "boolean P"}, ValueCase{"boolean P = TRUE", "boolean P = TRUE"},
        ValueCase{"Boolean P = False", "boolean P = FALSE"},
        ValueCase{"boolean P = NULL", "boolean P"}, ValueCase{"uint8 P = 255", "uint8 P = 255"},
        ValueCase{"sint8 P = -128", "sint8 P = -128"},
        ValueCase{"uint16 P = 65535", "uint16 P = 65535"},
        ValueCase{"sint16 P = -32768", "sint16 P = -32768"},
        ValueCase{"uint32 P = 4294967295", "uint32 P = 4294967295"},
        ValueCase{"sint32 P = -2147483648", "sint32 P = -2147483648"},
        ValueCase{"uint64 P = 18446744073709551615", "uint64 P = 18446744073709551615"},
        ValueCase{"sint64 P = -9223372036854775808", "sint64 P = -9223372036854775808"},
        ValueCase{"sint64 P = 9223372036854775807", "sint64 P = 9223372036854775807"},
        ValueCase{"uint8 P = -0", "uint8 P = 0"}, ValueCase{"uint32 P = 0x1F", "uint32 P = 31"},
        ValueCase{"uint32 P = 0XfF", "uint32 P = 255"},
        ValueCase{"uint32 P = 017", "uint32 P = 15"}, ValueCase{"uint32 P = 101b", "uint32 P = 5"},
        ValueCase{"uint32 P = 0x1B", "uint32 P = 27"},
        ValueCase{"sint32 P = -11B", "sint32 P = -3"}, ValueCase{"sint32 P = +7", "sint32 P = 7"},
        ValueCase{"real32 P = 2.5", "real32 P = 2.5000000000000000e+00"},
        ValueCase{"real64 P = -.5E-1", "real64 P = -5.0000000000000003e-02"},
        ValueCase{"real64 P = 100", "real64 P = 1.0000000000000000e+02"},
        ValueCase{"real64 P = 1.0e-400", "real64 P = 0.0000000000000000e+00"},
        ValueCase{"char16 P = 'A'", "char16 P = A"},
        ValueCase{"char16 P = '\\x20AC'", "char16 P = \xE2\x82\xAC"},
        ValueCase{"char16 P = '\\''", "char16 P = '"},
        ValueCase{"datetime P = \"20260101120000.000000+060\"",
                  "datetime P = 20260101120000.000000+060"},
        ValueCase{"datetime P = \"00000010000000.000000:000\"",
                  "datetime P = 00000010000000.000000:000"},
        ValueCase{"B REF P", "reference to B P"},
        ValueCase{"B REF P = \"root/x:B.k=1\"", "reference to B P = root/x:B.k=1"}));

INSTANTIATE_TEST_SUITE_P(
    Strings, MofValue,
    testing::Values(ValueCase{R"(string P = "")", "string P = "},
                    ValueCase{R"(string P = "a" "b" /* */ "c")", "string P = abc"},
                    ValueCase{R"(string P = "\b\t\n\f\r\"\'\\")", "string P = \b\t\n\f\r\"'\\"},
                    ValueCase{R"(string P = "\x41\x042\X00432")", "string P = ABC2"},
                    ValueCase{R"(string P = "\xD83D\xDE00")", "string P = \xF0\x9F\x98\x80"},
                    ValueCase{"string P = \"\xF0\x9F\x98\x80\xC3\xA9\"",
                              "string P = \xF0\x9F\x98\x80\xC3\xA9"},
                    ValueCase{R"(string P = "100 %n%s // no comment /*")",
                              "string P = 100 %n%s // no comment /*"}));

INSTANTIATE_TEST_SUITE_P(
    Arrays, MofValue,
    testing::Values(ValueCase{"uint8 P[]", "uint8[] P"},
                    ValueCase{"uint8 P[] = {}", "uint8[] P = "},
                    ValueCase{"uint8 P[] = null", "uint8[] P"},
                    ValueCase{"uint8 P[3] = {1, 0x2, 11b}", "uint8[3] P = 1 2 3 "},
                    ValueCase{"uint8 P[3]", "uint8[3] P"},
                    ValueCase{"string P[] = {\"a\" \"b\", \"c\"}", "string[] P = ab c "},
                    ValueCase{"boolean P[] = {true, FALSE}", "boolean[] P = TRUE FALSE "},
                    ValueCase{"char16 P[] = {'a', 'b'}", "char16[] P = a b "}));

// A NUL written as an escape is a character like others.
TEST(MofValue, EscapedNulIsKept) {
  Mof mof;
  ASSERT_TRUE(mof.read(R"(class A { string P = "a\x0b\x0000c"; };)"));
  Pegasus::String value;
  const Pegasus::CIMClass a = mof.get("A");
  a.getProperty(0).getValue().get(value);
  ASSERT_EQ(value.size(), 4u);  // "\x0b" is one character.
  EXPECT_EQ(value[1], Pegasus::Char16(0x0B));
  EXPECT_EQ(value[2], Pegasus::Char16(0));
}

}  // namespace
}  // namespace cimhost_test
