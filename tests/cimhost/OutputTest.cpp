#include "cimhost/output/MofText.h"
#include "cimhost/output/ResultWriter.h"
#include "cimhost/output/XmlText.h"
#include "tests/cimhost/TestModel.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <limits>
#include <sstream>

namespace {

using namespace cimhost;
using namespace Pegasus;
using testing::ContainsRegex;
using testing::HasSubstr;
using Json = nlohmann::json;

CIMProperty property(const char* name, const CIMValue& value) {
  return CIMProperty(name, value);
}

CIMInstance disk(const char* name, const std::vector<CIMProperty>& more = {}) {
  CIMInstance instance("Demo_Disk");
  instance.addProperty(property("Name", CIMValue(String(name))));
  for (const CIMProperty& each : more) instance.addProperty(each);
  Array<CIMKeyBinding> keys;
  keys.append(CIMKeyBinding("Name", CIMValue(String(name))));
  instance.setPath(CIMObjectPath(String(), "root/demo", "Demo_Disk", keys));
  return instance;
}

template <class T>
CIMValue arrayOf(std::initializer_list<T> elements) {
  Array<T> array;
  for (const T& each : elements) array.append(each);
  return CIMValue(array);
}

// What a writer makes of that which `deliver` hands to it.
template <class Deliver>
std::string print(OutputFormat format, ResultForm form, Deliver deliver) {
  std::ostringstream out;
  const auto writer = makeResultWriter(format, out, form);
  deliver(*writer);
  writer->finish();
  return out.str();
}

std::string printed(OutputFormat format, ResultForm form,
                    const std::vector<CIMInstance>& instances) {
  return print(format, form, [&](ResultWriter& writer) {
    for (const CIMInstance& instance : instances) EXPECT_TRUE(writer.deliverInstance(instance));
  });
}

std::string table(const std::vector<CIMInstance>& instances) {
  return printed(OutputFormat::table, ResultForm::list, instances);
}

TEST(Output, Tables) {
  EXPECT_EQ(table({}), "");
  EXPECT_EQ(table({disk("/", {property("Size", CIMValue(Uint64(18446744073709551615ULL)))}),
                   disk("/home", {property("Free", CIMValue(CIMTYPE_UINT32, false)),
                                  property("Drive", CIMValue(Char16('C'))),
                                  property("Tags", arrayOf<String>({"a b", "\n"}))})}),
            "Name   Size                  Free  Drive  Tags\n"
            "-----  --------------------  ----  -----  -------------\n"
            "/      18446744073709551615\n"
            "/home                              'C'    {\"a b\", \"\\n\"}\n");
  // Wide characters, and such as would obey a terminal.
  EXPECT_EQ(table({disk("\u65e5\u672c\x1b[2J\n", {property("B", CIMValue(true))}),
                   disk("x", {property("B", CIMValue(false))})}),
            "Name           B\n"
            "-------------  -----\n"
            "\u65e5\u672c\\x1b[2J\\n  TRUE\n"
            "x              FALSE\n");
  // Long cells are cut, but not the last.
  const std::string longText(100, 'x');
  EXPECT_THAT(table({disk(longText.c_str(), {property("B", CIMValue(String(longText.c_str())))})}),
              HasSubstr("\n" + std::string(59, 'x') + "\u2026  " + longText + "\n"));
  // Instances of several classes get a column; many get several tables.
  EXPECT_THAT(table({disk("a"), CIMInstance(CIMName("Demo_Other"))}),
              testing::StartsWith("(class)     Name\n"));
  const std::string many = table(std::vector<CIMInstance>(1001, disk("a")));
  EXPECT_EQ(std::count(many.begin(), many.end(), '\n'), 1001 + 2 * 2 + 1);
  EXPECT_EQ(printed(OutputFormat::table, ResultForm::single,
                    {disk("/", {property("Size", CIMValue(Uint64(5)))})}),
            "root/demo:Demo_Disk.Name=\"/\"\n"
            "Property  Value\n--------  -----\nName      /\nSize      5\n");
}

TEST(Output, ValuesAreExact) {
  const double inf = std::numeric_limits<double>::infinity();
  const Char16 lone(0xD800);
  const struct {
    CIMValue value;
    const char* mof;
    const char* json;
  } cases[] = {
      {CIMValue(true), "TRUE", "true"},
      {CIMValue(Sint8(-128)), "-128", "-128"},
      {CIMValue(Real64(5)), "5.0", "5.0"},
      {CIMValue(Real64(1e300)), "1.0e+300", "1e300"},
      {CIMValue(Real64(-inf)), "NULL", "\"-INF\""},
      {CIMValue(Real64(std::nan(""))), "NULL", "\"NaN\""},
      {CIMValue(Char16('\'')), "'\\''", "\"'\""},
      {CIMValue(Char16(0x20AC)), "'\u20ac'", "\"\u20ac\""},
      {CIMValue(String("a\\b\"\x01\n")), "\"a\\\\b\\\"\\x0001\\n\"", "\"a\\\\b\\\"\\u0001\\n\""},
      {CIMValue(String("a\0b", 3)), "\"a\\x0000b\"", "\"a\\u0000b\""},
      {CIMValue(String(&lone, 1)), "\"\ufffd\"", "\"\ufffd\""},
      {arrayOf({String("a\"b"), String()}), "{\"a\\\"b\", \"\"}", "[\"a\\\"b\", \"\"]"},
      {arrayOf<Uint8>({}), "{}", "[]"},
      {arrayOf({Uint32(1), Uint32(4294967295)}), "{1, 4294967295}", "[1, 4294967295]"},
      {CIMValue(CIMTYPE_STRING, false), "NULL", "null"},
      {CIMValue(CIMTYPE_UINT8, true), "NULL", "null"},
      {CIMValue(CIMObjectPath("root:A.k=\"v\"")), "\"root:A.k=\\\"v\\\"\"",
       "\"root:A.k=\\\"v\\\"\""},
      {CIMValue(CIMDateTime("00000001******.******:000")), "\"00000001******.******:000\"",
       "\"00000001******.******:000\""},
  };
  for (const auto& row : cases) {
    EXPECT_EQ(mofValue(row.value), row.mof);
    const CIMInstance instance = disk("x", {property("V", row.value)});
    const std::string json = printed(OutputFormat::json, ResultForm::single, {instance});
    EXPECT_EQ(Json::parse(json)["properties"]["V"], Json::parse(row.json)) << row.json;
  }
}

TEST(Output, Lists) {
  EXPECT_EQ(printed(OutputFormat::mof, ResultForm::list, {disk("/"), disk("%s")}),
            "instance of Demo_Disk {\n  Name = \"/\";\n};\n\n"
            "instance of Demo_Disk {\n  Name = \"%s\";\n};\n");
  EXPECT_EQ(Json::parse(printed(OutputFormat::json, ResultForm::list, {disk("a"), disk("b")}))[1],
            Json::parse(R"({"path": "root/demo:Demo_Disk.Name=\"b\"", "class": "Demo_Disk",
                            "properties": {"Name": "b"}})"));
  EXPECT_EQ(printed(OutputFormat::json, ResultForm::list, {}), "[]\n");
}

constexpr const char* kDemoClass = R"([Description("A \"disk\"") : Translatable]
class Demo_Disk : Demo_Base {
  [Key : DisableOverride]
  string Name;
  [Key(FALSE) : DisableOverride, ValueMap{"0", "2"}]
  uint16 Status = 2;
  uint8 Bytes[3];
  Demo_Disk REF Other;
  [Static : DisableOverride]
  uint32 Reset(
    [In : DisableOverride] sint64 Delay,
    string Texts[]);
};
)";

TEST(Output, ClassDeclarations) {
  const std::string base = "class Demo_Base { uint16 Status; };\n";
  const CIMClass demo = test::readClass(base + kDemoClass, "Demo_Disk");
  const auto printedAs = [&](OutputFormat format) {
    return print(format, ResultForm::single,
                 [&](ResultWriter& writer) { writer.deliverClass(demo); });
  };
  EXPECT_EQ(printedAs(OutputFormat::mof), kDemoClass);
  EXPECT_EQ(printedAs(OutputFormat::table),
            "class Demo_Disk : Demo_Base\n"
            "Property  Type           Key  Origin     Default\n"
            "--------  -------------  ---  ---------  -------\n"
            "Name      string         yes  Demo_Disk\n"
            "Status    uint16              Demo_Base  2\n"
            "Bytes     uint8[3]            Demo_Disk\n"
            "Other     Demo_Disk REF       Demo_Disk\n"
            "\n"
            "Method  Returns  Static  Parameters\n"
            "------  -------  ------  -------------------------------\n"
            "Reset   uint32   yes     in sint64 Delay, string[] Texts\n");
  const Json json = Json::parse(printedAs(OutputFormat::json));
  EXPECT_EQ(json["superclass"], "Demo_Base");
  const Json& properties = json["properties"];
  EXPECT_EQ(properties[0]["qualifiers"]["Key"], true);
  EXPECT_EQ(properties[0]["default"], nullptr);
  EXPECT_EQ(properties[1]["classOrigin"], "Demo_Base");
  EXPECT_EQ(properties[2]["size"], 3);
  EXPECT_EQ(properties[3]["referenceClass"], "Demo_Disk");
  EXPECT_EQ(json["methods"][0]["parameters"][1]["array"], true);
}

TEST(Output, EmbeddedInstancesAreBoundedInDepth) {
  CIMInstance inner = disk("leaf");
  for (int i = 0; i < 40; ++i) inner = disk("x", {property("V", CIMValue(inner))});
  const std::string text = printed(OutputFormat::json, ResultForm::single, {inner});
  EXPECT_THAT(text, testing::Not(HasSubstr("leaf")));
  EXPECT_TRUE(Json::accept(text));
}

TEST(Output, PathsAndNames) {
  const struct {
    OutputFormat format;
    const char* text;
  } cases[] = {
      {OutputFormat::table, "root/demo:Demo_Disk.Name=\"a\"\nDemo_Disk\n"},
      {OutputFormat::mof, "\"root/demo:Demo_Disk.Name=\\\"a\\\"\"\nDemo_Disk\n"},
      {OutputFormat::json, "[\n\"root/demo:Demo_Disk.Name=\\\"a\\\"\",\n\"Demo_Disk\"\n]\n"},
      {OutputFormat::xml,
       "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<IRETURNVALUE>\n<VALUE.REFERENCE>"
       "<LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"demo\"/>"
       "</LOCALNAMESPACEPATH><INSTANCENAME CLASSNAME=\"Demo_Disk\"><KEYBINDING NAME=\"Name\">"
       "<KEYVALUE VALUETYPE=\"string\">a</KEYVALUE></KEYBINDING></INSTANCENAME>"
       "</LOCALINSTANCEPATH></VALUE.REFERENCE>\n<CLASSNAME "
       "NAME=\"Demo_Disk\"/>\n</IRETURNVALUE>\n"}};
  for (const auto& row : cases) {
    EXPECT_EQ(print(row.format, ResultForm::list,
                    [](ResultWriter& writer) {
                      writer.deliverPath(disk("a").getPath());
                      writer.deliverClassName(CIMName("Demo_Disk"));
                    }),
              row.text);
    std::ostringstream broken;
    broken.setstate(std::ios::badbit);
    EXPECT_FALSE(
        makeResultWriter(row.format, broken, ResultForm::list)->deliverInstance(disk("a")));
  }
}

TEST(Output, InstancesAsXml) {
  CIMInstance remote = disk("b");
  CIMObjectPath path = remote.getPath();
  path.setHost("h");
  remote.setPath(path);
  const std::string both = printed(OutputFormat::xml, ResultForm::list, {disk("a"), remote});
  EXPECT_THAT(both, ContainsRegex("\n<VALUE.OBJECTWITHLOCALPATH><LOCALINSTANCEPATH>.*</INSTANCE>"
                                  "</VALUE.OBJECTWITHLOCALPATH>\n<VALUE.OBJECTWITHPATH>"
                                  "<INSTANCEPATH>.*</VALUE.OBJECTWITHPATH>\n</IRETURNVALUE>\n$"));
}

TEST(Output, MethodResults) {
  Array<CIMParamValue> parameters;
  parameters.append(CIMParamValue("Flags", arrayOf({Uint32(1), Uint32(2)})));
  parameters.append(CIMParamValue("Odd\x1b", CIMValue(String("a\nb"))));
  parameters.append(CIMParamValue("None", CIMValue(CIMTYPE_STRING, false)));
  const auto deliver = [&](ResultWriter& writer) {
    EXPECT_TRUE(writer.deliverMethodResult(CIMValue(Sint32(-1)), parameters));
  };
  const auto result = [&](OutputFormat format) {
    return print(format, ResultForm::single, deliver);
  };
  std::ostringstream xml;
  const auto writer = makeResultWriter(OutputFormat::xml, xml, ResultForm::single, "Set");
  deliver(*writer);
  writer->finish();
  EXPECT_THAT(xml.str(), ContainsRegex("\n<METHODRESPONSE NAME=\"Set\">\n<RETURNVALUE .*>-1<.*"
                                       "<PARAMVALUE NAME=\"Odd\ufffd\" .*\n</METHODRESPONSE>\n$"));
  EXPECT_EQ(result(OutputFormat::table),
            "Parameter       Value\n"
            "--------------  ------\n"
            "(return value)  -1\n"
            "Flags           {1, 2}\n"
            "Odd\\x1b         a\\nb\n"
            "None\n");
  EXPECT_EQ(result(OutputFormat::mof),
            "ReturnValue = -1;\nFlags = {1, 2};\nOdd\\x1b = \"a\\nb\";\nNone = NULL;\n");
  EXPECT_EQ(Json::parse(result(OutputFormat::json)), Json::parse(R"({"returnValue": -1,
                            "parameters": {"Flags": [1, 2], "Odd\u001b": "a\nb", "None": null}})"));
  parameters.clear();
  EXPECT_EQ(Json::parse(result(OutputFormat::json)),
            Json::parse(R"({"returnValue": -1, "parameters": {}})"));
}

TEST(Output, QualifierDeclarationsAsMof) {
  EXPECT_EQ(mofQualifier(*findStandardQualifier("In")),
            "Qualifier In : boolean = TRUE, Scope(parameter), Flavor(DisableOverride);\n");
  EXPECT_EQ(mofQualifier(*findStandardQualifier("ValueMap")),
            "Qualifier ValueMap : string[], Scope(property, method, parameter);\n");
}

std::string escaped(const std::vector<int>& units) {
  Array<Char16> text;
  for (const int unit : units) text.append(Char16(static_cast<Uint16>(unit)));
  XmlBuffer out;
  out.appendText(String(text.getData(), text.size()));
  return std::string(out.view());
}

TEST(XmlText, WhatXmlHasNoFormForIsReplaced) {
  for (const int unit :
       {0x0, 0x1, 0x8, 0xB, 0xC, 0xE, 0x1F, 0xD800, 0xDBFF, 0xDC00, 0xDFFF, 0xFFFE, 0xFFFF}) {
    EXPECT_EQ(escaped({'a', unit, 'b'}), "a\uFFFDb") << unit;
  }
  EXPECT_EQ(escaped({0xDC00, 0xD800, 0xD800, 0xDC00}), "\uFFFD\uFFFD\U00010000");
  EXPECT_EQ(escaped({'\t', '\n', '\r', 0x7F, 0x80, 0x7FF, 0x800, 0xFFFD}),
            "\t\n\r\x7F\xC2\x80\u07FF\u0800\uFFFD");
  EXPECT_EQ(escaped({0xD800, 0xDC00, 0xDBFF, 0xDFFF}), "\U00010000\U0010FFFF");
  XmlBuffer out;
  out.appendText(std::string_view("a\xFF\x01<\xC3\xA9", 6));
  EXPECT_EQ(out.view(), "a\uFFFD\uFFFD&lt;\xC3\xA9");
}

// Pairs and entities across the border of a block.
TEST(XmlText, LongTextsAreWhole) {
  std::string text(4095, 'x');
  for (int i = 0; i < 5000; ++i) text += "\U0001F600\"";
  std::string expected = text;
  for (std::size_t at = 0; (at = expected.find('"', at)) != std::string::npos;) {
    expected.replace(at, 1, "&quot;");
  }
  XmlBuffer out;
  out.append("<");
  out.appendText(fromUtf8(text));
  EXPECT_EQ(out.view(), "<" + expected);
}

// A chain of instances that refer to each other does not exhaust the stack.
TEST(XmlText, EmbeddedInstancesAreCutOff) {
  CIMInstance inner(CIMName("A"));
  for (int i = 0; i < 100; ++i) {
    CIMInstance outer(CIMName("A"));
    outer.addProperty(CIMProperty(CIMName("P"), CIMValue(inner)));
    inner = outer;
  }
  XmlBuffer out;
  appendInstance(out, inner);
  int count = 0;
  for (std::size_t at = 0; (at = out.view().find("/INSTANCE", at) + 1) != 0;) ++count;
  EXPECT_EQ(count, 17);
}

}  // namespace
