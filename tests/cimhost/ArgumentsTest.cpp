#include "cimhost/PathArgument.h"
#include "cimhost/RequestArguments.h"
#include "cimhost/Text.h"
#include "cimhost/ValueArgument.h"
#include "cimhost/output/MofText.h"
#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>

namespace {

using namespace cimhost;
using namespace Pegasus;

std::string resultOf(const DeclaredType& type,
                     const std::vector<std::optional<std::string>>& texts) {
  try {
    const CIMValue value = parseValue(type, texts);
    EXPECT_EQ(value.getType(), type.type);
    EXPECT_EQ(value.isArray(), type.isArray);
    return mofValue(value);
  } catch (const ValueArgumentError& error) {
    return std::string("!") + error.what();
  }
}

// How the largest and smallest numbers of each type come back is tested with CIM-XML.
TEST(ValueArgument, TextsBecomeWhatIsDeclared) {
  using Texts = std::vector<std::optional<std::string>>;
  const DeclaredType strings{CIMTYPE_STRING, true, 0};
  const DeclaredType numbers{CIMTYPE_UINT8, true, 0};
  const struct {
    DeclaredType type;
    Texts texts;
    const char* expected;  // MOF; with "!" in front: the message
  } cases[] = {
      {{CIMTYPE_BOOLEAN}, {"True"}, "TRUE"},
      {{CIMTYPE_UINT8}, {"0xfF"}, "255"},
      {{CIMTYPE_UINT8}, {"010"}, "10"},  // not octal
      {{CIMTYPE_UINT8}, {"-0"}, "0"},
      {{CIMTYPE_UINT8}, {"-1"}, "!\"-1\" is out of range, 0 to 255"},
      {{CIMTYPE_UINT8}, {"0x"}, "!\"0x\" is not an integer"},
      {{CIMTYPE_UINT8}, {"+-1"}, "!\"+-1\" is not an integer"},
      {{CIMTYPE_UINT8}, {"1 "}, "!\"1 \" is not an integer"},
      {{CIMTYPE_SINT8}, {"128"}, "!\"128\" is out of range, -128 to 127"},
      {{CIMTYPE_UINT16}, {"+65535"}, "65535"},
      {{CIMTYPE_SINT16}, {"-0x8000"}, "-32768"},
      {{CIMTYPE_UINT64},
       {"18446744073709551616"},
       "!\"18446744073709551616\" is out of range, 0 to 18446744073709551615"},
      {{CIMTYPE_SINT64},
       {"-9223372036854775809"},
       "!\"-9223372036854775809\" is out of range, -9223372036854775808 to 9223372036854775807"},
      {{CIMTYPE_REAL32}, {"1e39"}, "!\"1e39\" is out of range"},
      {{CIMTYPE_REAL64}, {"+1e39"}, "1.0e+39"},
      {{CIMTYPE_REAL64}, {"+-5"}, "!\"+-5\" is not a number"},
      {{CIMTYPE_CHAR16}, {"\U0001F600"}, "!\"\U0001F600\" is not one character of 16 bits"},
      {{CIMTYPE_STRING}, {""}, "\"\""},
      {{CIMTYPE_STRING}, {"a,\\,b=[]"}, "\"a,\\\\,b=[]\""},  // as it is
      {{CIMTYPE_STRING}, {"\x1b[m\xff"}, "!\"\\x1b[m\\xff\" is not valid UTF-8"},
      {{CIMTYPE_REFERENCE}, {"root/a:B.k=\"x,y\""}, "\"root/a:B.k=\\\"x,y\\\"\""},
      {{CIMTYPE_REFERENCE}, {"no path"}, "!\"no path\" is not an object path"},
      {{CIMTYPE_INSTANCE}, {"x"}, "!values of this type cannot be given here"},
      {{CIMTYPE_UINT8}, {std::nullopt}, "NULL"},
      {{CIMTYPE_STRING}, {"a", "b"}, "!more than one value given"},
      {strings, {std::nullopt}, "NULL"},
      {strings, {"[]"}, "{}"},
      {strings, {""}, "{\"\"}"},
      {strings, {"\\[]"}, "{\"[]\"}"},
      {strings,
       {"[a,b]"},
       "!\"[a,b]\" is not a list: write a,b without brackets, or \\[ for a bracket"},
      {strings, {"a,b]"}, "{\"a\", \"b]\"}"},
      {strings, {","}, "{\"\", \"\"}"},
      {strings, {"a\\,b,c\\\\,d\\e\\"}, "{\"a,b\", \"c\\\\\", \"d\\\\e\\\\\"}"},
      {strings, {"a", "b,c", "[]"}, "{\"a\", \"b\", \"c\"}"},
      {strings, {"a", std::nullopt}, "!null and a value are both given"},
      {numbers, {"1,"}, "!\"\" is not an integer"},
      {{CIMTYPE_UINT8, true, 3}, {"1,2"}, "!3 elements expected, found 2"},
      {{CIMTYPE_UINT8, true, 2}, {"1,2"}, "{1, 2}"},
      {{CIMTYPE_REFERENCE, true, 0}, {"B.k=1\\,l=2,C"}, "{\"B.k=1,l=2\", \"C\"}"},
  };
  for (const auto& row : cases) EXPECT_EQ(resultOf(row.type, row.texts), row.expected);
}

const CIMClass& declaration() {
  static const CIMClass read = test::readClass(
      "class Test_Disk { uint8 Size; uint8 Flags[2]; Test_Disk REF Peer;\n"
      "uint32 Format(string Label, [In(false)] uint8 Result, Test_Disk REF Disks[]); };",
      "Test_Disk");
  return read;
}

std::string modified(const std::vector<std::string>& arguments) {
  try {
    const ModifyInstanceRequest request = makeModifyRequest(
        declaration(), CIMObjectPath("root/test:Test_Disk.Name=\"a\""), arguments);
    return toUtf8(request.instance.getPath().toString()) + " " +
           toUtf8(request.propertyList.toString()) + "\n" + mofInstance(request.instance);
  } catch (const ValueArgumentError& error) {
    return error.what();
  }
}

std::string invoked(const std::string& method, const std::vector<std::string>& arguments) {
  try {
    const InvokeMethodRequest request =
        makeInvokeRequest(declaration(), CIMObjectPath("root/test:Test_Disk"), method, arguments);
    std::string text = toUtf8(request.methodName.getString());
    for (Uint32 i = 0; i < request.parameters.size(); ++i) {
      text += " " + toUtf8(request.parameters[i].getParameterName()) + "=" +
              mofValue(request.parameters[i].getValue());
    }
    return text;
  } catch (const ValueArgumentError& error) {
    return error.what();
  }
}

TEST(RequestArguments, OnlyWhatIsGivenIsSent) {
  EXPECT_EQ(modified({"peer=root/test:Test_Disk.Name=\"b\"", "FLAGS=1", "size", "flags=2"}),
            "root/test:Test_Disk.Name=\"a\" Size, Flags, Peer\n"
            "instance of Test_Disk {\n"
            "  Size = NULL;\n"
            "  Flags = {1, 2};\n"
            "  Peer = \"root/test:Test_Disk.Name=\\\"b\\\"\";\n"
            "};\n");
  EXPECT_EQ(invoked("format", {"Disks=Test_Disk", "label="}),
            "Format Label=\"\" Disks={\"Test_Disk\"}");
  EXPECT_EQ(invoked("FORMAT", {}), "Format");
}

TEST(RequestArguments, WhatDoesNotFitIsNamed) {
  EXPECT_EQ(modified({"Size=big"}), "property Size (uint8): \"big\" is not an integer");
  EXPECT_EQ(modified({"Nope=1"}), "class Test_Disk has no property \"Nope\"");
  EXPECT_EQ(modified({"b\xff\n=1"}), "class Test_Disk has no property \"b\\xff\\n\"");
  EXPECT_EQ(invoked("Nope", {}), "class Test_Disk has no method \"Nope\"");
  EXPECT_EQ(invoked("Format", {"Size=1"}), "method Format has no parameter \"Size\"");
  EXPECT_EQ(invoked("Format", {"Result=1"}),
            "parameter Result of method Format takes no value: it is out only");
}

TEST(PathArgument, WellFormedPaths) {
  EXPECT_EQ(parseInstancePath("root/host:Host_System.").getKeyBindings().size(), 0u);
  EXPECT_EQ(parseInstancePath("root:A.k=\"x.y:z,\\\"\"").getKeyBindings().size(), 1u);
  EXPECT_EQ(toUtf8(parseNamespaceOrClass("root/host").getNameSpace().getString()), "root/host");
}

TEST(PathArgument, MalformedOnesAreReportedWithTheirColumn) {
  const struct {
    Pegasus::CIMObjectPath (*parse)(const std::string&);
    const char* text;
    int column;
    const char* reason;
  } cases[] = {
      {parseInstancePath, "root:A.a=1,b=\"x", 12,
       "object path, column 12: invalid key-value pair, missing quote in key value\n"
       "  root:A.a=1,b=\"x\n"
       "             ^"},
      {parseInstancePath, "root:A.a=\"x\\\",y\",b", 18, "equal sign"},
      {parseInstancePath, "root:1A.a=1", 6, "class name 1A"},
      {parseInstancePath, "root:A", 7, "no keys"},
      {parseInstancePath, "A.k=\"x:y\"", 1, "no namespace"},  // the colon is the value's
      {parseClassPath, "ro ot:A", 1, "namespace"},
      {parseClassPath, "A", 1, "no namespace"},
      {parseClassPath, "//h/root:A", 1, "host"},
      {parseClassPath, "root:A.a=1", 7, "no keys"},
      {parseClassPath, "root:", 6, "class name"},
      {parseClassPath, "root:\x1b[2J", 6, "class name \\x1b[2J"},
      {parseClassPath, "root:\xff", 6, "UTF-8"},
      {parseNamespaceOrClass, "", 1, "namespace"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.text);
    try {
      row.parse(row.text);
      ADD_FAILURE() << "accepted";
    } catch (const PathArgumentError& error) {
      EXPECT_EQ(error.column(), row.column);
      EXPECT_THAT(error.what(), testing::HasSubstr(row.reason));
    }
  }
}

}  // namespace
