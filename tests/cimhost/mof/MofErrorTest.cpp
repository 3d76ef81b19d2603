#include "tests/cimhost/mof/MofTestSupport.h"

namespace cimhost_test {
namespace {

struct ErrorCase {
  std::string mof;
  std::string expected;  // The first line, without "error: ".
};

void PrintTo(const ErrorCase& c, std::ostream* out) {
  *out << c.expected;
}

class MofError : public testing::TestWithParam<ErrorCase> {};

TEST_P(MofError, IsOneDiagnosticWithItsPlace) {
  Mof mof;
  EXPECT_FALSE(mof.read(GetParam().mof));
  EXPECT_EQ(mof.firstLine(), GetParam().expected);
  EXPECT_EQ(mof.reader.diagnostics().size(), 1u);
}

std::string inClass(const std::string& features) {
  return "class A {\n" + features + "\n};";
}

INSTANTIATE_TEST_SUITE_P(
    Tokens, MofError,
    testing::Values(
        ErrorCase{std::string("class A\0{};", 11), "t.mof:1:8: NUL byte in the text"},
        ErrorCase{std::string("// \0", 4), "t.mof:1:4: NUL byte in the text"},
        ErrorCase{"class A\xFF{};", "t.mof:1:8: byte 0xFF is not valid UTF-8"},
        ErrorCase{"// \xC3(", "t.mof:1:4: byte 0xC3 is not valid UTF-8"},
        ErrorCase{"/* \n \xE2\x82", "t.mof:2:2: byte 0xE2 is not valid UTF-8"},
        ErrorCase{"\xED\xA0\x80", "t.mof:1:1: byte 0xED is not valid UTF-8"},
        ErrorCase{"\xC0\x80", "t.mof:1:1: byte 0xC0 is not valid UTF-8"},
        ErrorCase{"\xFF\xFE"
                  "c",
                  "t.mof:1:1: byte 0xFF is not valid UTF-8"},
        ErrorCase{"class A {};\n /* never", "t.mof:2:2: unterminated comment"},
        ErrorCase{"/*/", "t.mof:1:1: unterminated comment"},
        ErrorCase{inClass("string P = \"abc\n\";"), "t.mof:2:12: unterminated string"},
        ErrorCase{"#pragma a(\"abc\\", "t.mof:1:15: unknown escape sequence"},
        ErrorCase{inClass("string P = \"\\q\";"), "t.mof:2:13: unknown escape sequence"},
        ErrorCase{inClass("string P = \"\\xg\";"),
                  "t.mof:2:13: expected one to four hexadecimal digits after '\\x'"},
        ErrorCase{inClass("char16 P = '';"), "t.mof:2:12: empty character literal"},
        ErrorCase{inClass("char16 P = 'ab';"), "t.mof:2:12: unterminated character literal"},
        ErrorCase{inClass("char16 P = '\xF0\x9F\x98\x80';"),
                  "t.mof:2:12: the character does not fit in 16 bits"},
        ErrorCase{inClass("uint8 P = 08;"), "t.mof:2:11: malformed number '08'"},
        ErrorCase{inClass("uint8 P = 12b;"), "t.mof:2:11: malformed number '12b'"},
        ErrorCase{inClass("uint8 P = 0x;"), "t.mof:2:11: malformed number '0x'"},
        ErrorCase{inClass("uint8 P = - 1;"), "t.mof:2:11: malformed number '-'"},
        ErrorCase{inClass("real32 P = 1.;"), "t.mof:2:12: malformed number '1.'"},
        ErrorCase{inClass("real32 P = 1.2.3;"), "t.mof:2:12: malformed number '1.2.3'"},
        ErrorCase{inClass("uint64 P = 18446744073709551616;"),
                  "t.mof:2:12: number '18446744073709551616' is too large"},
        ErrorCase{inClass("real64 P = 1.0e999;"), "t.mof:2:12: number '1.0e999' is too large"},
        ErrorCase{"class " + std::string(1000000, 'x') + " {};",
                  "t.mof:1:7: name of more than 1024 bytes"},
        ErrorCase{"#pragme x", "t.mof:1:1: expected '#pragma'"},
        ErrorCase{"class A {}; ~", "t.mof:1:13: unexpected '~'"},
        ErrorCase{"\x1B[31m", "t.mof:1:1: unexpected character U+001B"},
        ErrorCase{"%n%s%s%n", "t.mof:1:1: unexpected '%'"},
        ErrorCase{"class A as $", "t.mof:1:12: expected a name after '$'"}));

INSTANTIATE_TEST_SUITE_P(
    Grammar, MofError,
    testing::Values(
        ErrorCase{"A", "t.mof:1:1: expected a declaration, found 'A'"},
        ErrorCase{"class", "t.mof:1:6: expected the name of a class, found the end of the text"},
        ErrorCase{"class A {}\n", "t.mof:2:1: expected ';', found the end of the text"},
        ErrorCase{"class A : {};", "t.mof:1:11: expected the name of the superclass, found '{'"},
        ErrorCase{"class A as B {};", "t.mof:1:12: expected an alias ('$name'), found 'B'"},
        ErrorCase{"[Abstract] uint8", "t.mof:1:12: expected 'class' or 'instance', found 'uint8'"},
        ErrorCase{"[]", "t.mof:1:2: expected the name of a qualifier, found ']'"},
        ErrorCase{"[[[[[[", "t.mof:1:2: expected the name of a qualifier, found '['"},
        ErrorCase{inClass("uint8 P\nuint8 Q;"), "t.mof:3:1: expected ';', found 'uint8'"},
        ErrorCase{inClass("int P;"),
                  "t.mof:2:1: unknown data type 'int' (a reference is written CLASS REF name)"},
        ErrorCase{inClass("void P();"),
                  "t.mof:2:1: unknown data type 'void' (a reference is written CLASS REF name)"},
        ErrorCase{inClass("uint8 1P;"), "t.mof:2:7: malformed number '1P'"},
        ErrorCase{inClass("uint8 P = ;"), "t.mof:2:11: expected a value, found ';'"},
        ErrorCase{inClass("uint8 P[] = {1,};"), "t.mof:2:16: expected a value, found '}'"},
        ErrorCase{inClass("uint8 P[] = {{1}};"), "t.mof:2:14: expected a value, found '{'"},
        ErrorCase{inClass("uint8 P[0];"), "t.mof:2:9: array size outside 1 to 65536"},
        ErrorCase{inClass("uint8 P[4294967295];"), "t.mof:2:9: array size outside 1 to 65536"},
        ErrorCase{inClass("uint8 P[-1];"), "t.mof:2:9: array size outside 1 to 65536"},
        ErrorCase{inClass("uint8 P[x];"), "t.mof:2:9: expected an array size or ']', found 'x'"},
        ErrorCase{inClass("A REF M();"), "t.mof:2:1: a method cannot return a reference"},
        ErrorCase{inClass("uint8 M(uint8 a,);"), "t.mof:2:17: expected a data type, found ')'"},
        ErrorCase{inClass("uint8 M(uint8 a = 1);"), "t.mof:2:17: expected ')', found '='"},
        ErrorCase{inClass("[Key : Sometimes] uint8 P;"),
                  "t.mof:2:8: expected a flavor, found 'Sometimes'"},
        ErrorCase{inClass("[Description(\"x\") : ToSubclass Restricted] uint8 P;"),
                  "t.mof:2:32: flavor 'Restricted' contradicts an earlier one"},
        ErrorCase{"Qualifier Q : foo, scope(any);",
                  "t.mof:1:15: expected a data type, found 'foo'"},
        ErrorCase{"Qualifier Q : uint8;", "t.mof:1:20: expected ', scope(...)', found ';'"},
        ErrorCase{"Qualifier Q : uint8, scope(all);",
                  "t.mof:1:28: expected a kind of element, found 'all'"},
        ErrorCase{"instance A {};", "t.mof:1:10: expected 'of', found 'A'"},
        ErrorCase{"instance of A { P = 1 };", "t.mof:1:23: expected ';', found '}'"},
        ErrorCase{"instance of A { P; };", "t.mof:1:18: expected '=', found ';'"},
        ErrorCase{"#pragma include", "t.mof:1:9: #pragma include needs a string in parentheses"},
        ErrorCase{"#pragma foo (\"a\"", "t.mof:1:17: expected ')', found the end of the text"},
        ErrorCase{"#pragma namespace(\"root/1\")", "t.mof:1:19: 'root/1' is not a namespace"},
        ErrorCase{"#pragma include(\"nowhere/no.mof\")",
                  "t.mof:1:17: cannot read 'nowhere/no.mof': No such file or directory"}));

INSTANTIATE_TEST_SUITE_P(
    Values, MofError,
    testing::Values(
        ErrorCase{inClass("uint8 P = 256;"), "t.mof:2:11: the value is out of range for uint8"},
        ErrorCase{inClass("uint8 P = -1;"), "t.mof:2:11: the value is out of range for uint8"},
        ErrorCase{inClass("sint8 P = 128;"), "t.mof:2:11: the value is out of range for sint8"},
        ErrorCase{inClass("sint64 P = 9223372036854775808;"),
                  "t.mof:2:12: the value is out of range for sint64"},
        ErrorCase{inClass("sint64 P = -9223372036854775809;"),
                  "t.mof:2:12: the value is out of range for sint64"},
        ErrorCase{inClass("real32 P = 1.0e39;"),
                  "t.mof:2:12: the value is out of range for real32"},
        ErrorCase{inClass("uint8 P = 1.5;"), "t.mof:2:11: expected a uint8 value, found a real"},
        ErrorCase{inClass("uint8 P = true;"),
                  "t.mof:2:11: expected a uint8 value, found a boolean"},
        ErrorCase{inClass("boolean P = 1;"),
                  "t.mof:2:13: expected a boolean value, found an integer"},
        ErrorCase{inClass("string P = 'a';"),
                  "t.mof:2:12: expected a string value, found a character"},
        ErrorCase{inClass("char16 P = \"a\";"),
                  "t.mof:2:12: expected a char16 value, found a string"},
        ErrorCase{inClass("datetime P = \"20261301000000.000000+000\";"),
                  "t.mof:2:14: \"20261301000000.000000+000\" is not a datetime"},
        ErrorCase{inClass("datetime P = \"\\x1B[31m\\x0\\xD800\";"),
                  "t.mof:2:14: \" [31m ???\" is not a datetime"},
        ErrorCase{inClass("A REF P = \"not a path!\";"),
                  "t.mof:2:11: \"not a path!\" is not an object path"},
        ErrorCase{inClass("A REF P = $a;"),
                  "t.mof:2:11: expected a reference value, found an alias"},
        ErrorCase{inClass("uint8 P[] = 1;"), "t.mof:2:13: expected a list of values in braces"},
        ErrorCase{inClass("uint8 P = {1};"), "t.mof:2:11: expected one value, found a list"},
        ErrorCase{inClass("uint8 P[] = {1, null};"),
                  "t.mof:2:17: expected a uint8 value, found null"},
        ErrorCase{inClass("uint8 P[3] = {1, 2};"), "t.mof:2:14: expected 3 values, found 2"},
        ErrorCase{inClass("A REF P[];"), "t.mof:2:7: a property cannot be an array of references"},
        ErrorCase{"Qualifier Q : uint8 = 300, scope(any);",
                  "t.mof:1:23: the value is out of range for uint8"}));

const std::string kBase =
    "class B { [Key] uint8 K; [MaxLen(5)] string S; uint8 M([In] uint8 a); };\n";

INSTANTIATE_TEST_SUITE_P(
    Meaning, MofError,
    testing::Values(
        ErrorCase{"class A {}; class\na {};", "t.mof:2:1: class 'a' is declared already"},
        ErrorCase{"class A : Nope {};", "t.mof:1:11: unknown superclass 'Nope'"},
        ErrorCase{"class A : A {};", "t.mof:1:11: unknown superclass 'A'"},
        ErrorCase{inClass("uint8 P; string p;"), "t.mof:2:17: 'p' is declared twice"},
        ErrorCase{inClass("uint8 M(); string m();"), "t.mof:2:19: 'm' is declared twice"},
        ErrorCase{inClass("uint8 M(uint8 a, uint8 A);"), "t.mof:2:24: 'A' is declared twice"},
        ErrorCase{inClass("[Kye] uint8 P;"), "t.mof:2:2: unknown qualifier 'Kye'"},
        ErrorCase{inClass("[Key, KEY] uint8 P;"), "t.mof:2:7: qualifier 'KEY' is given twice"},
        ErrorCase{inClass("[Key(1)] uint8 P;"),
                  "t.mof:2:6: expected a boolean value, found an integer"},
        ErrorCase{inClass("[MaxLen(-1)] string P;"),
                  "t.mof:2:9: the value is out of range for uint32"},
        ErrorCase{inClass("[ValueMap(\"1\")] string P;"),
                  "t.mof:2:11: expected a list of values in braces"},
        ErrorCase{"[Key] class A {};", "t.mof:1:2: qualifier 'Key' is not allowed here"},
        ErrorCase{"[Aggregation] class A {};",
                  "t.mof:1:2: qualifier 'Aggregation' is not allowed here"},
        ErrorCase{inClass("[Max(1)] uint8 P;"), "t.mof:2:2: qualifier 'Max' is not allowed here"},
        ErrorCase{inClass("uint8 M([Key] uint8 a);"),
                  "t.mof:2:10: qualifier 'Key' is not allowed here"},
        ErrorCase{kBase + "class A : B { uint16 K; };",
                  "t.mof:2:22: the overridden property has another type"},
        ErrorCase{kBase + "class A : B { uint8 K[]; };",
                  "t.mof:2:21: the overridden property has another type"},
        ErrorCase{kBase + "class A : B { string M(); };",
                  "t.mof:2:22: the overridden method has another return type"},
        ErrorCase{kBase + "class A : B { uint8 M(string a); };",
                  "t.mof:2:30: the overridden method's parameter has another type"},
        ErrorCase{kBase + "class A : B { [Key(false)] uint8 K; };",
                  "t.mof:2:16: qualifier 'Key' cannot be overridden: the superclass fixes its "
                  "value"},
        ErrorCase{kBase + "class A : B { uint8 M([In(false)] uint8 a); };",
                  "t.mof:2:24: qualifier 'In' cannot be overridden: the superclass fixes its "
                  "value"},
        ErrorCase{"[Association] class C {}; [Association(false)] class D : C {};",
                  "t.mof:1:28: qualifier 'Association' cannot be overridden: the superclass fixes "
                  "its value"},
        ErrorCase{"class A { [MaxLen(1) : DisableOverride] string S; };\n"
                  "class B : A { [MaxLen(1) : EnableOverride] string S; };\n"
                  "class C : B { [MaxLen(2)] string S; };",
                  "t.mof:3:16: qualifier 'MaxLen' cannot be overridden: the superclass fixes its "
                  "value"},
        ErrorCase{kBase + "class A : B { [Override(\"S\")] string T; };",
                  "t.mof:2:16: qualifier 'Override' must give the same name"},
        ErrorCase{kBase + "class A : B { [Override(\"T\")] string T; };",
                  "t.mof:2:16: there is nothing to override in the superclass"}));

std::string manyProperties(int count) {
  std::string mof = "class A {";
  for (int i = 0; i < count; ++i) mof += "uint8 P" + std::to_string(i) + ";";
  return mof + "};";
}

// What is too large is refused in a short time, not stored.
INSTANTIATE_TEST_SUITE_P(
    Limits, MofError,
    testing::Values(
        ErrorCase{manyProperties(1001),
                  "t.mof:1:10906: More than 1000 elements in a container are not supported."},
        ErrorCase{"[Description(" + std::string(3000000, '"') + ")] class A {",
                  "t.mof:1:3000026: expected a data type, found the end of the text"},
        ErrorCase{"[" +
                      [] {
                        std::string list;
                        for (int i = 0; i < 1000001; ++i) list += "a,";
                        return list;
                      }(),
                  "t.mof:1:2000002: the declaration is too large"},
        ErrorCase{
            inClass("uint8 P = 1" + std::string(1000000, '0') + ";"),
            "t.mof:2:11: number '1000000000000000000000000000000000000000...' is too large"}));

TEST(MofDiagnostic, ShowsTheLineWithACaretUnderThePlace) {
  Mof mof;
  EXPECT_FALSE(mof.read("class A {\n\t/* \xC3\xA9 */ uint8 P = 256;\r\n};"));
  EXPECT_EQ(mof.diagnostics(),
            "t.mof:2:21: error: the value is out of range for uint8\n"
            " /* \xC3\xA9 */ uint8 P = 256;\n"
            "                   ^\n");
}

TEST(MofDiagnostic, CutsLongLinesAroundThePlace) {
  Mof mof;
  const std::string blanks(1000, ' ');
  EXPECT_FALSE(mof.read("class A {" + blanks + "uint8 P = 256;" + blanks + "};"));
  const cimhost::MofDiagnostic& diagnostic = mof.reader.diagnostics()[0];
  EXPECT_EQ(diagnostic.column, 1020);
  EXPECT_LT(diagnostic.source.size(), 200u);
  EXPECT_EQ(diagnostic.source.substr(static_cast<std::size_t>(diagnostic.caret) - 1, 4), "256;");
}

TEST(MofDiagnostic, ReplacesWhatATerminalWouldObey) {
  Mof mof;
  EXPECT_FALSE(mof.read("~ \x1B[2J \x9B \x7F \xC2\x9B"));
  EXPECT_EQ(mof.diagnostics(), "t.mof:1:1: error: unexpected '~'\n~  [2J ?    \n^\n");
}

}  // namespace
}  // namespace cimhost_test
