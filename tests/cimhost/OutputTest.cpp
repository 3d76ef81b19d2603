#include "cimhost/output/MofText.h"
#include "cimhost/output/ResultWriter.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <limits>
#include <sstream>

namespace {

using namespace cimhost;
using namespace Pegasus;
using testing::HasSubstr;
using Json = nlohmann::json;

CIMProperty property(const char* name, const CIMValue& value) {
  return CIMProperty(CIMName(name), value);
}

CIMInstance disk(const String& name, const std::vector<CIMProperty>& more = {}) {
  CIMInstance instance(CIMName("Demo_Disk"));
  instance.addProperty(property("Name", CIMValue(name)));
  for (const CIMProperty& each : more) instance.addProperty(each);
  Array<CIMKeyBinding> keys;
  keys.append(CIMKeyBinding(CIMName("Name"), CIMValue(name)));
  instance.setPath(
      CIMObjectPath(String(), CIMNamespaceName("root/demo"), CIMName("Demo_Disk"), keys));
  return instance;
}

CIMValue uint32Array(std::initializer_list<Uint32> numbers) {
  Array<Uint32> array;
  for (const Uint32 number : numbers) array.append(number);
  return CIMValue(array);
}

std::string print(OutputFormat format, ResultForm form, const std::vector<CIMInstance>& instances) {
  std::ostringstream out;
  const auto writer = makeResultWriter(format, out, form);
  for (const CIMInstance& instance : instances) EXPECT_TRUE(writer->deliverInstance(instance));
  writer->finish();
  return out.str();
}

std::string table(const std::vector<CIMInstance>& instances) {
  return print(OutputFormat::table, ResultForm::list, instances);
}

Json jsonOf(const CIMValue& value) {
  const CIMInstance instance = disk("x", {property("V", value)});
  return Json::parse(print(OutputFormat::json, ResultForm::single, {instance}))["properties"]["V"];
}

TEST(Table, ColumnsAreAlignedAndCollected) {
  EXPECT_EQ(table({disk("/", {property("Size", CIMValue(Uint64(18446744073709551615ULL)))}),
                   disk("/home", {property("Free", CIMValue(CIMTYPE_UINT32, false)),
                                  property("Flags", uint32Array({1, 2}))})}),
            "Name   Size                  Free  Flags\n"
            "-----  --------------------  ----  ------\n"
            "/      18446744073709551615\n"
            "/home                              {1, 2}\n");
  EXPECT_EQ(table({}), "");
}

TEST(Table, WideCharactersAndControlCharacters) {
  EXPECT_EQ(table({disk("\u65e5\u672c\x1b[2J\n", {property("B", CIMValue(true))}),
                   disk("x", {property("B", CIMValue(false))})}),
            "Name           B\n"
            "-------------  -----\n"
            "\u65e5\u672c\\x1b[2J\\n  TRUE\n"
            "x              FALSE\n");
}

TEST(Table, LongCellsAreCutButNotTheLast) {
  const std::string longText(100, 'x');
  const std::string printed =
      table({disk(longText.c_str(), {property("B", CIMValue(String(longText.c_str())))})});
  EXPECT_THAT(printed, HasSubstr("\n" + std::string(59, 'x') + "\u2026  " + longText + "\n"));
}

TEST(Table, DifferentClassesGetAColumnAndLargeResultsSeveralTables) {
  CIMInstance other(CIMName("Demo_Other"));
  EXPECT_THAT(table({disk("a"), other}), testing::StartsWith("(class)     Name\n"));
  const std::string many = table(std::vector<CIMInstance>(1001, disk("a")));
  EXPECT_EQ(std::count(many.begin(), many.end(), '\n'), 1001 + 2 * 2 + 1);
}

TEST(Table, OneInstanceIsAListOfItsProperties) {
  EXPECT_EQ(print(OutputFormat::table, ResultForm::single,
                  {disk("/", {property("Size", CIMValue(Uint64(5)))})}),
            "root/demo:Demo_Disk.Name=\"/\"\n"
            "Property  Value\n"
            "--------  -----\n"
            "Name      /\n"
            "Size      5\n");
}

TEST(Mof, Values) {
  const double inf = std::numeric_limits<double>::infinity();
  const Char16 quote[] = {Char16('\'')};
  Array<String> strings;
  strings.append("a\"b");
  strings.append("");
  const struct {
    CIMValue value;
    const char* text;
  } cases[] = {
      {CIMValue(true), "TRUE"},
      {CIMValue(Sint8(-128)), "-128"},
      {CIMValue(Uint64(18446744073709551615ULL)), "18446744073709551615"},
      {CIMValue(Real64(2.9)), "2.9"},
      {CIMValue(Real32(0.1f)), "0.1"},
      {CIMValue(Real64(5)), "5.0"},
      {CIMValue(Real64(1e300)), "1.0e+300"},
      {CIMValue(Real64(inf)), "NULL"},
      {CIMValue(quote[0]), "'\\''"},
      {CIMValue(String("a\\b\x01\n")), "\"a\\\\b\\x0001\\n\""},
      {CIMValue(strings), "{\"a\\\"b\", \"\"}"},
      {CIMValue(Array<Uint8>()), "{}"},
      {CIMValue(CIMTYPE_STRING, true), "NULL"},
      {CIMValue(CIMObjectPath("root:A.k=\"v\"")), "\"root:A.k=\\\"v\\\"\""},
      {CIMValue(CIMDateTime("20260101120000.000000+060")), "\"20260101120000.000000+060\""}};
  for (const auto& row : cases) EXPECT_EQ(mofValue(row.value), row.text);
}

TEST(Mof, InstancesAreSeparated) {
  EXPECT_EQ(print(OutputFormat::mof, ResultForm::list, {disk("/"), disk("%s")}),
            "instance of Demo_Disk {\n  Name = \"/\";\n};\n"
            "\n"
            "instance of Demo_Disk {\n  Name = \"%s\";\n};\n");
}

CIMClass demoClass() {
  CIMClass declaration(CIMName("Demo_Disk"), CIMName("Demo_Base"));
  declaration.addQualifier(CIMQualifier(CIMName("Description"), CIMValue(String("A \"disk\""))));
  CIMProperty key(CIMName("Name"), CIMValue(CIMTYPE_STRING, false));
  key.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(true), CIMFlavor::DISABLEOVERRIDE));
  declaration.addProperty(key);
  CIMProperty status(CIMName("Status"), CIMValue(Uint16(2)), 0, CIMName(), CIMName("Demo_Base"),
                     true);
  status.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(false)));
  Array<String> map;
  map.append("0");
  map.append("2");
  status.addQualifier(CIMQualifier(CIMName("ValueMap"), CIMValue(map)));
  declaration.addProperty(status);
  declaration.addProperty(CIMProperty(CIMName("Bytes"), CIMValue(CIMTYPE_UINT8, true, 3), 3));
  declaration.addProperty(
      CIMProperty(CIMName("Other"), CIMValue(CIMTYPE_REFERENCE, false), 0, CIMName("Demo_Disk")));
  CIMMethod reset(CIMName("Reset"), CIMTYPE_UINT32);
  reset.addQualifier(CIMQualifier(CIMName("Static"), CIMValue(true)));
  CIMParameter delay(CIMName("Delay"), CIMTYPE_SINT64);
  delay.addQualifier(CIMQualifier(CIMName("In"), CIMValue(true)));
  reset.addParameter(delay);
  reset.addParameter(CIMParameter(CIMName("Texts"), CIMTYPE_STRING, true));
  declaration.addMethod(reset);
  return declaration;
}

TEST(Mof, ClassDeclaration) {
  EXPECT_EQ(mofClass(demoClass()),
            "[Description(\"A \\\"disk\\\"\")]\n"
            "class Demo_Disk : Demo_Base {\n"
            "  [Key : DisableOverride]\n"
            "  string Name;\n"
            "  [Key(FALSE), ValueMap{\"0\", \"2\"}]\n"
            "  uint16 Status = 2;\n"
            "  uint8 Bytes[3];\n"
            "  Demo_Disk REF Other;\n"
            "  [Static]\n"
            "  uint32 Reset(\n"
            "    [In] sint64 Delay,\n"
            "    string Texts[]);\n"
            "};\n");
}

TEST(Table, ClassDeclaration) {
  std::ostringstream out;
  const auto writer = makeTableWriter(out, ResultForm::single);
  writer->deliverClass(demoClass());
  writer->finish();
  EXPECT_EQ(out.str(),
            "class Demo_Disk : Demo_Base\n"
            "Property  Type           Key  Origin     Default\n"
            "--------  -------------  ---  ---------  -------\n"
            "Name      string         yes\n"
            "Status    uint16              Demo_Base  2\n"
            "Bytes     uint8[3]\n"
            "Other     Demo_Disk REF\n"
            "\n"
            "Method  Returns  Static  Parameters\n"
            "------  -------  ------  -------------------------------\n"
            "Reset   uint32   yes     in sint64 Delay, string[] Texts\n");
}

TEST(JsonOutput, ValuesAreTypedAndExact) {
  const double inf = std::numeric_limits<double>::infinity();
  const Char16 lone(0xD800);
  const struct {
    CIMValue value;
    const char* json;
  } cases[] = {{CIMValue(Uint64(18446744073709551615ULL)), "18446744073709551615"},
               {CIMValue(Sint64(std::numeric_limits<Sint64>::min())), "-9223372036854775808"},
               {CIMValue(Uint8(65)), "65"},
               {CIMValue(Sint8(-1)), "-1"},
               {CIMValue(true), "true"},
               {CIMValue(Real64(2.9)), "2.9"},
               {CIMValue(Real64(std::nan(""))), "\"NaN\""},
               {CIMValue(Real64(-inf)), "\"-INF\""},
               {CIMValue(CIMTYPE_STRING, false), "null"},
               {CIMValue(CIMTYPE_UINT8, true), "null"},
               {uint32Array({}), "[]"},
               {uint32Array({1, 4294967295u}), "[1, 4294967295]"},
               {CIMValue(Char16(0x20AC)), "\"\u20ac\""},
               {CIMValue(String(&lone, 1)), "\"\ufffd\""},
               {CIMValue(String("a\0b\x01\"", 5)), "\"a\\u0000b\\u0001\\\"\""},
               {CIMValue(CIMObjectPath("root:A.k=\"v\"")), "\"root:A.k=\\\"v\\\"\""},
               {CIMValue(CIMDateTime()), "\"00000000000000.000000:000\""}};
  for (const auto& row : cases) EXPECT_EQ(jsonOf(row.value), Json::parse(row.json)) << row.json;
}

TEST(JsonOutput, ListsAndSingleObjects) {
  const Json list =
      Json::parse(print(OutputFormat::json, ResultForm::list, {disk("a"), disk("b")}));
  ASSERT_EQ(list.size(), 2u);
  EXPECT_EQ(list[1]["path"], "root/demo:Demo_Disk.Name=\"b\"");
  EXPECT_EQ(list[1]["class"], "Demo_Disk");
  EXPECT_EQ(print(OutputFormat::json, ResultForm::list, {}), "[]\n");
  EXPECT_TRUE(Json::parse(print(OutputFormat::json, ResultForm::single, {disk("a")})).is_object());
}

TEST(JsonOutput, ClassDeclaration) {
  std::ostringstream out;
  const auto writer = makeJsonWriter(out, ResultForm::single);
  writer->deliverClass(demoClass());
  writer->finish();
  const Json json = Json::parse(out.str());
  EXPECT_EQ(json["superclass"], "Demo_Base");
  EXPECT_EQ(json["properties"][0]["qualifiers"]["Key"], true);
  EXPECT_EQ(json["properties"][0]["default"], nullptr);
  EXPECT_EQ(json["properties"][1]["classOrigin"], "Demo_Base");
  EXPECT_EQ(json["properties"][2]["size"], 3);
  EXPECT_EQ(json["properties"][3]["referenceClass"], "Demo_Disk");
  EXPECT_EQ(json["methods"][0]["parameters"][1]["array"], true);
}

TEST(Output, EmbeddedInstancesAreBoundedInDepth) {
  CIMInstance inner = disk("leaf");
  for (int i = 0; i < 40; ++i) inner = disk("x", {property("V", CIMValue(inner))});
  const std::string text = print(OutputFormat::json, ResultForm::single, {inner});
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
      {OutputFormat::json, "[\n\"root/demo:Demo_Disk.Name=\\\"a\\\"\",\n\"Demo_Disk\"\n]\n"}};
  for (const auto& row : cases) {
    std::ostringstream out;
    const auto writer = makeResultWriter(row.format, out, ResultForm::list);
    writer->deliverPath(disk("a").getPath());
    writer->deliverClassName(CIMName("Demo_Disk"));
    writer->finish();
    EXPECT_EQ(out.str(), row.text);
  }
}

TEST(Output, AFailingStreamAsksForNoMore) {
  std::ostringstream out;
  out.setstate(std::ios::badbit);
  for (const OutputFormat format : {OutputFormat::table, OutputFormat::mof, OutputFormat::json}) {
    EXPECT_FALSE(makeResultWriter(format, out, ResultForm::list)->deliverInstance(disk("a")));
  }
}

TEST(MethodResult, EachFormat) {
  Array<CIMParamValue> parameters;
  parameters.append(CIMParamValue("Flags", uint32Array({1, 2})));
  parameters.append(CIMParamValue("Odd\x1b", CIMValue(String("a\nb"))));
  parameters.append(CIMParamValue("None", CIMValue(CIMTYPE_STRING, false)));
  const auto printed = [&](OutputFormat format, const CIMValue& returned,
                           const Array<CIMParamValue>& values) {
    std::ostringstream out;
    const auto writer = makeResultWriter(format, out, ResultForm::single);
    EXPECT_TRUE(writer->deliverMethodResult(returned, values));
    writer->finish();
    return out.str();
  };
  EXPECT_EQ(printed(OutputFormat::table, CIMValue(Sint32(-1)), parameters),
            "Parameter       Value\n"
            "--------------  ------\n"
            "(return value)  -1\n"
            "Flags           {1, 2}\n"
            "Odd\\x1b         a\\nb\n"
            "None\n");
  EXPECT_EQ(printed(OutputFormat::mof, CIMValue(Sint32(-1)), parameters),
            "ReturnValue = -1;\nFlags = {1, 2};\nOdd\\x1b = \"a\\nb\";\nNone = NULL;\n");
  EXPECT_EQ(Json::parse(printed(OutputFormat::json, CIMValue(Sint32(-1)), parameters)),
            Json::parse(R"({"returnValue": -1,
                            "parameters": {"Flags": [1, 2], "Odd\u001b": "a\nb", "None": null}})"));
  EXPECT_EQ(Json::parse(printed(OutputFormat::json, CIMValue(), {})),
            Json::parse(R"({"returnValue": null, "parameters": {}})"));
  EXPECT_THAT(printed(OutputFormat::table, CIMValue(), {}), testing::EndsWith("(return value)\n"));
}

TEST(Mof, QualifierDeclarations) {
  const auto text = [](const char* name) {
    return mofQualifier(*findStandardQualifier(CIMName(name)));
  };
  EXPECT_EQ(text("In"),
            "Qualifier In : boolean = TRUE, Scope(parameter), Flavor(DisableOverride);\n");
  EXPECT_EQ(text("ValueMap"),
            "Qualifier ValueMap : string[], Scope(property, method, parameter);\n");
  EXPECT_EQ(text("Description"),
            "Qualifier Description : string, Scope(any), Flavor(Translatable);\n");
}

}  // namespace
