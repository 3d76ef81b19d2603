#include "tests/cimhost/mof/MofTestSupport.h"

#include <vector>

namespace cimhost_test {
namespace {

struct ErrorCase {
  std::string mof;
  std::string expected;  // The first line, without "t.mof:" and "error: ".
};

// Each text gives one diagnostic, with its place.
void expectErrors(const std::vector<ErrorCase>& cases) {
  for (const ErrorCase& row : cases) {
    SCOPED_TRACE(row.mof.substr(0, 200));
    Mof mof;
    EXPECT_FALSE(mof.read(row.mof));
    EXPECT_EQ(mof.firstLine(), "t.mof:" + row.expected);
    EXPECT_EQ(mof.reader.diagnostics().size(), 1u);
  }
}

// A class with these features in line 2.
std::string in(const std::string& features) {
  return "class A {\n" + features + "\n};";
}

TEST(MofError, Tokens) {
  expectErrors({
      {std::string("// \0", 4), "1:4: NUL byte in the text"},
      {"// \xC3(", "1:4: byte 0xC3 is not valid UTF-8"},
      {"/* \n \xE2\x82", "2:2: byte 0xE2 is not valid UTF-8"},
      {"class A {};\n /* never", "2:2: unterminated comment"},
      {"/*/", "1:1: unterminated comment"},
      {in("string P = \"abc\n\";"), "2:12: unterminated string"},
      {in("string P = \"\\q\";"), "2:13: unknown escape sequence"},
      {in("string P = \"\\xg\";"), "2:13: expected one to four hexadecimal digits after '\\x'"},
      {in("char16 P = '';"), "2:12: empty character literal"},
      {in("char16 P = 'ab';"), "2:12: unterminated character literal"},
      {in("char16 P = '\xF0\x9F\x98\x80';"), "2:12: the character does not fit in 16 bits"},
      {in("uint8 P = 08;"), "2:11: malformed number '08'"},
      {in("uint8 P = 0x;"), "2:11: malformed number '0x'"},
      {in("real32 P = 1.;"), "2:12: malformed number '1.'"},
      {in("uint64 P = 18446744073709551616;"), "2:12: number '18446744073709551616' is too large"},
      {in("real64 P = 1.0e999;"), "2:12: number '1.0e999' is too large"},
      {"#pragme x", "1:1: expected '#pragma'"},
      {"class " + std::string(1025, 'x') + " {};", "1:7: name of more than 1024 bytes"},
      {"\x1B[31m", "1:1: unexpected character U+001B"},
      {"%n%s%s%n", "1:1: unexpected '%'"},
      {"class A as $", "1:12: expected a name after '$'"},
  });
}

TEST(MofError, Grammar) {
  expectErrors({
      {"class A as B {};", "1:12: expected an alias ('$name'), found 'B'"},
      {"[[[[[[", "1:2: expected the name of a qualifier, found '['"},
      {in("uint8 P[] = {1,};"), "2:16: expected a value, found '}'"},
      {in("uint8 P[] = {{1}};"), "2:14: expected a value, found '{'"},
      {in("uint8 P[0];"), "2:9: array size outside 1 to 65536"},
      {in("uint8 P[65537];"), "2:9: array size outside 1 to 65536"},
      {in("uint8 P[x];"), "2:9: expected an array size or ']', found 'x'"},
      {in("A REF M();"), "2:1: a method cannot return a reference"},
      {in("uint8 M(uint8 a,);"), "2:17: expected a data type, found ')'"},
      {in("uint8 M(uint8 a = 1);"), "2:17: expected ')', found '='"},
      {in("[Key : Sometimes] uint8 P;"), "2:8: expected a flavor, found 'Sometimes'"},
      {in("[Description(\"x\") : ToSubclass Restricted] uint8 P;"),
       "2:32: flavor 'Restricted' contradicts an earlier one"},
      {"Qualifier Q : uint8;", "1:20: expected ', scope(...)', found ';'"},
      {"Qualifier Q : uint8, scope(all);", "1:28: expected a kind of element, found 'all'"},
      {"instance A {};", "1:10: expected 'of', found 'A'"},
      {"#pragma include", "1:9: #pragma include needs a string in parentheses"},
      {"#pragma namespace(\"root/1\")", "1:19: 'root/1' is not a namespace"},
      {"#pragma include(\"nowhere/no.mof\")",
       "1:17: cannot read 'nowhere/no.mof': No such file or directory"},
  });
}

TEST(MofError, Values) {
  expectErrors({
      {in("uint8 P = -1;"), "2:11: the value is out of range for uint8"},
      {in("sint64 P = 9223372036854775808;"), "2:12: the value is out of range for sint64"},
      {in("sint64 P = -9223372036854775809;"), "2:12: the value is out of range for sint64"},
      {in("real32 P = 1.0e39;"), "2:12: the value is out of range for real32"},
      {in("uint8 P = 1.5;"), "2:11: expected a uint8 value, found a real"},
      {in("datetime P = \"20261301000000.000000+000\";"),
       "2:14: \"20261301000000.000000+000\" is not a datetime"},
      {in("datetime P = \"\\x1B[31m\\x0\\xD800\";"), "2:14: \" [31m ???\" is not a datetime"},
      {in("A REF P = \"not a path!\";"), "2:11: \"not a path!\" is not an object path"},
      {in("A REF P = $a;"), "2:11: expected a reference value, found an alias"},
      {in("uint8 P[] = 1;"), "2:13: expected a list of values in braces"},
      {in("uint8 P = {1};"), "2:11: expected one value, found a list"},
      {in("uint8 P[] = {1, null};"), "2:17: expected a uint8 value, found null"},
      {in("uint8 P[3] = {1, 2};"), "2:14: expected 3 values, found 2"},
      {in("A REF P[];"), "2:7: a property cannot be an array of references"},
      {"Qualifier Q : uint8 = 300, scope(any);", "1:23: the value is out of range for uint8"},
  });
}

TEST(MofError, Meaning) {
  // A subclass of B with these features in line 2, the first of them in column 15.
  const auto subclass = [](const std::string& features) {
    return "class B { [Key] uint8 K; [MaxLen(5)] string S; uint8 M([In] uint8 a); };\n"
           "class A : B { " +
           features + " };";
  };
  const std::string fixed = " cannot be overridden: the superclass fixes its value";
  expectErrors({
      {"class A {}; class\na {};", "2:1: class 'a' is declared already"},
      {"class A : A {};", "1:11: unknown superclass 'A'"},
      {in("uint8 P; string p;"), "2:17: 'p' is declared twice"},
      {in("uint8 M(); string m();"), "2:19: 'm' is declared twice"},
      {in("uint8 M(uint8 a, uint8 A);"), "2:24: 'A' is declared twice"},
      {in("[Kye] uint8 P;"), "2:2: unknown qualifier 'Kye'"},
      {in("[Key, KEY] uint8 P;"), "2:7: qualifier 'KEY' is given twice"},
      {"[Key] class A {};", "1:2: qualifier 'Key' is not allowed here"},
      {"[Aggregation] class A {};", "1:2: qualifier 'Aggregation' is not allowed here"},
      {in("[Max(1)] uint8 P;"), "2:2: qualifier 'Max' is not allowed here"},
      {subclass("uint16 K;"), "2:22: the overridden property has another type"},
      {subclass("uint8 K[];"), "2:21: the overridden property has another type"},
      {subclass("string M();"), "2:22: the overridden method has another return type"},
      {subclass("uint8 M(string a);"), "2:30: the overridden method's parameter has another type"},
      {subclass("[Key(false)] uint8 K;"), "2:16: qualifier 'Key'" + fixed},
      {subclass("uint8 M([In(false)] uint8 a);"), "2:24: qualifier 'In'" + fixed},
      {"[Association] class C {}; [Association(false)] class D : C {};",
       "1:28: qualifier 'Association'" + fixed},
      {"class A { [MaxLen(1) : DisableOverride] string S; };\n"
       "class B : A { [MaxLen(1) : EnableOverride] string S; };\n"
       "class C : B { [MaxLen(2)] string S; };",
       "3:16: qualifier 'MaxLen'" + fixed},
      {subclass("[Override(\"S\")] string T;"),
       "2:16: qualifier 'Override' must give the same name"},
      {subclass("[Override(\"T\")] string T;"),
       "2:16: there is nothing to override in the superclass"},
  });
}

// What is too large is refused in a short time, not stored.
TEST(MofError, Limits) {
  std::string properties;
  for (int i = 0; i < 1001; ++i) properties += "uint8 P" + std::to_string(i) + ";";
  std::string qualifiers = "[";
  for (int i = 0; i < 1000001; ++i) qualifiers += "a,";
  expectErrors({
      {"class A {" + properties + "};",
       "1:10906: More than 1000 elements in a container are not supported."},
      {"[Description(" + std::string(3000000, '"') + ")] class A {",
       "1:3000026: expected a data type, found the end of the text"},
      {qualifiers, "1:2000002: the declaration is too large"},
      {in("uint8 P = 1" + std::string(1000000, '0') + ";"),
       "2:11: number '1000000000000000000000000000000000000000...' is too large"},
  });
}

TEST(MofError, ShowsTheLineWithACaretUnderThePlace) {
  const std::string blanks(1000, ' ');
  const struct {
    std::string mof, expected;
  } cases[] = {
      {"class A {\n\t/* \xC3\xA9 */ uint8 P = 256;\r\n};",
       "t.mof:2:21: error: the value is out of range for uint8\n"
       " /* \xC3\xA9 */ uint8 P = 256;\n"
       "                   ^\n"},
      // What a terminal would obey is replaced.
      {"~ \x1B[2J \x9B \x7F \xC2\x9B", "t.mof:1:1: error: unexpected '~'\n~  [2J ?    \n^\n"},
      // Long lines are cut around the place.
      {"class A {" + blanks + "uint8 P = 256;" + blanks + "};",
       "t.mof:1:1020: error: the value is out of range for uint8\n..." + std::string(70, ' ') +
           "uint8 P = 256;" + std::string(76, ' ') + "...\n" + std::string(83, ' ') + "^\n"},
  };
  for (const auto& row : cases) {
    Mof mof;
    EXPECT_FALSE(mof.read(row.mof));
    EXPECT_EQ(mof.diagnostics(), row.expected);
  }
}

}  // namespace
}  // namespace cimhost_test
