#include "tests/cimhost/mof/MofTestSupport.h"

namespace cimhost_test {
namespace {

TEST(MofValue, BecomesTheDefault) {
  const struct {
    std::string declaration;             // A property P.
    std::string expected = declaration;  // As propertyText() writes it.
  } cases[] = {
      {"Boolean P = TRUE", "boolean P = TRUE"},
      {"boolean P = NULL", "boolean P"},
      {"uint8 " + std::string(1024, 'P')},
      {"sint8 P = -128"},
      {"uint64 P = 18446744073709551615"},
      {"sint64 P = -9223372036854775808"},
      {"uint8 P = -0", "uint8 P = 0"},
      {"uint32 P = 017", "uint32 P = 15"},
      {"uint32 P = 101b", "uint32 P = 5"},
      {"uint32 P = 0x1B", "uint32 P = 27"},  // not binary
      {"sint32 P = -11B", "sint32 P = -3"},
      {"real32 P = 2.5", "real32 P = 2.5000000000000000e+00"},
      {"real64 P = 1.5e+3", "real64 P = 1.5000000000000000e+03"},
      {"real64 P = -.5E-1", "real64 P = -5.0000000000000003e-02"},
      {"real64 P = 1.0e-400", "real64 P = 0.0000000000000000e+00"},
      {"char16 P = '\\x20AC'", "char16 P = \xE2\x82\xAC"},
      {"char16 P = '\\''", "char16 P = '"},
      {"datetime P = \"00000010000000.000000:000\"", "datetime P = 00000010000000.000000:000"},
      {"B REF P = \"root/x:B.k=1\"", "reference to B P = root/x:B.k=1"},
      {"string P = \"\"", "string P = "},
      {R"(string P = "a" "b" /* */ "c")", "string P = abc"},
      {R"(string P = "\b\t\n\f\r\"\'\\")", "string P = \b\t\n\f\r\"'\\"},
      {R"(string P = "\x41\x042\X00432")", "string P = ABC2"},
      {R"(string P = "\xD800\xDC00\xDBFF\xDFFF")", "string P = \U00010000\U0010FFFF"},
      {R"(string P = "\xDBFF\xE000\xDC00")", "string P = \uFFFD\uE000\uFFFD"},
      {"string P = \"\xF0\x9F\x98\x80\xC3\xA9\"", "string P = \xF0\x9F\x98\x80\xC3\xA9"},
      {R"(string P = "100 %n%s // no comment /*")", "string P = 100 %n%s // no comment /*"},
      {"uint8 P[] = {}", "uint8[] P = "},
      {"uint8 P[] = null", "uint8[] P"},
      {"uint8 P[3] = {1, 0x2, 11b}", "uint8[3] P = 1 2 3 "},
  };
  for (const auto& row : cases) {
    Mof mof;
    ASSERT_TRUE(mof.read("class A { " + row.declaration + "; };")) << mof.diagnostics();
    const Pegasus::CIMConstClass a = mof.get("A");
    EXPECT_EQ(propertyText(a.getProperty(0)), row.expected + " (A)");
  }
}

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
