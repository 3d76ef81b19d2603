// Values of all types in requests and replies.

#include "cimhost/output/XmlBuffer.h"
#include "tests/cimhost/xml/CimXmlTestSupport.h"

#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>

namespace cimhost::test {
namespace {

struct ValueCase {
  const char* name;
  std::string sent;
  std::string returned;  ///< Empty: the same.
};

// The provider keeps the instance and gives it back.
class KeptProperty : public CimXmlTest, public testing::WithParamInterface<ValueCase> {
 protected:
  std::string modify(const std::string& property) {
    return ask("ModifyInstance",
               "<IPARAMVALUE NAME=\"ModifiedInstance\"><VALUE.NAMEDINSTANCE><INSTANCENAME "
               "CLASSNAME=\"Test_Memory\"><KEYBINDING NAME=\"Name\"><KEYVALUE>m</KEYVALUE>"
               "</KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"Test_Memory\">" +
                   property + "</INSTANCE></VALUE.NAMEDINSTANCE></IPARAMVALUE>");
  }
  std::string get() {
    const std::string before = "<IRETURNVALUE><INSTANCE CLASSNAME=\"Test_Memory\">";
    const std::string after = "</INSTANCE></IRETURNVALUE>";
    const std::string text =
        ask("GetInstance", instanceName("InstanceName", "Test_Memory", "m") +
                               value("LocalOnly", "FALSE") + value("IncludeQualifiers", "TRUE") +
                               value("IncludeClassOrigin", "TRUE"));
    EXPECT_EQ(text.substr(0, before.size()), before);
    return text.substr(before.size(), text.size() - before.size() - after.size());
  }
};

TEST_P(KeptProperty, ComesBack) {
  EXPECT_EQ(modify(GetParam().sent), "");
  EXPECT_EQ(get(), GetParam().returned.empty() ? GetParam().sent : GetParam().returned);
}

ValueCase scalar(const char* name, const std::string& type, const std::string& sent,
                 const std::string& returned = {}) {
  const auto element = [&](const std::string& text) {
    return "<PROPERTY NAME=\"P\" TYPE=\"" + type + "\"><VALUE>" + text + "</VALUE></PROPERTY>";
  };
  return {name, element(sent), returned.empty() ? std::string() : element(returned)};
}

std::string nameOf(const testing::TestParamInfo<ValueCase>& info) {
  return info.param.name;
}

INSTANTIATE_TEST_SUITE_P(
    Numbers, KeptProperty,
    testing::Values(scalar("True", "boolean", "true", "TRUE"), scalar("False", "boolean", "FALSE"),
                    scalar("Uint8", "uint8", "255"), scalar("Sint8", "sint8", "-128"),
                    scalar("Uint16", "uint16", "65535"), scalar("Sint16", "sint16", "-32768"),
                    scalar("Uint32", "uint32", "4294967295"),
                    scalar("Sint32", "sint32", "-2147483648"),
                    scalar("Uint64", "uint64", "18446744073709551615"),
                    scalar("Sint64", "sint64", "-9223372036854775808"),
                    scalar("Hexadecimal", "uint8", "0xff", "255"),
                    scalar("Plus", "sint8", "+5", "5"), scalar("Real32", "real32", "0.1"),
                    scalar("Real32Whole", "real32", "16777216.0"),
                    scalar("Real64", "real64", "0.30000000000000004"),
                    scalar("Real64Whole", "real64", "3", "3.0"),
                    scalar("Real64Large", "real64", "1.7976931348623157e+308"),
                    scalar("Real64Small", "real64", "5e-324", "5.0e-324"),
                    scalar("Real64Exponent", "real64", "1.0E20", "1.0e+20"),
                    scalar("MinusZero", "real64", "-0.0"), scalar("Infinite", "real64", "-INF"),
                    scalar("NotANumber", "real32", "NaN")),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    Texts, KeptProperty,
    testing::Values(
        scalar("Plain", "string", "a b"), scalar("Spaces", "string", "  a\tb  "),
        scalar("Markup", "string", "&lt;a href=&quot;&amp;amp;&quot;&gt;"),
        scalar("Apostrophe", "string", "it&apos;s", "it's"),
        scalar("CData", "string", "<![CDATA[<&]]>", "&lt;&amp;"),
        scalar("References", "string", "&#65;&#x20AC;", "A\xE2\x82\xAC"),
        scalar("NonAscii", "string", "\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"),
        scalar("Delete", "string", "\x7F"), scalar("Char16", "char16", "\xE2\x82\xAC"),
        scalar("Char16Markup", "char16", "&lt;"),
        scalar("TimeStamp", "datetime", "20260131235959.123456-060"),
        scalar("Interval", "datetime", "00000001******.******:000"),
        ValueCase{"EmptyText", "<PROPERTY NAME=\"P\" TYPE=\"string\"><VALUE/></PROPERTY>",
                  "<PROPERTY NAME=\"P\" TYPE=\"string\"><VALUE></VALUE></PROPERTY>"},
        ValueCase{"Null", "<PROPERTY NAME=\"P\" TYPE=\"uint8\"/>",
                  "<PROPERTY NAME=\"P\" TYPE=\"uint8\"></PROPERTY>"},
        ValueCase{"NullArray", "<PROPERTY.ARRAY NAME=\"P\" TYPE=\"uint8\" ARRAYSIZE=\"3\"/>",
                  "<PROPERTY.ARRAY NAME=\"P\" TYPE=\"uint8\" ARRAYSIZE=\"3\"></PROPERTY.ARRAY>"},
        ValueCase{"EmptyArray",
                  "<PROPERTY.ARRAY NAME=\"P\" TYPE=\"real64\"><VALUE.ARRAY></VALUE.ARRAY>"
                  "</PROPERTY.ARRAY>",
                  ""},
        ValueCase{"Array",
                  "<PROPERTY.ARRAY NAME=\"P\" TYPE=\"string\"><VALUE.ARRAY><VALUE>a,b</VALUE>"
                  "<VALUE></VALUE><VALUE>[]</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>",
                  ""},
        ValueCase{"Attributes",
                  "<PROPERTY NAME=\"P\" TYPE=\"string\" CLASSORIGIN=\"Test_Base\" "
                  "PROPAGATED=\"true\"><QUALIFIER NAME=\"Q\" TYPE=\"string\" "
                  "TRANSLATABLE=\"true\"><VALUE.ARRAY><VALUE>x</VALUE></VALUE.ARRAY></QUALIFIER>"
                  "<VALUE>a</VALUE></PROPERTY>",
                  ""}),
    nameOf);

const std::string kPlace =
    "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"x\"/></LOCALNAMESPACEPATH>";
const std::string kKeys =
    "<INSTANCENAME CLASSNAME=\"B\"><KEYBINDING NAME=\"b\"><KEYVALUE VALUETYPE=\"boolean\">TRUE"
    "</KEYVALUE></KEYBINDING><KEYBINDING NAME=\"n\"><KEYVALUE VALUETYPE=\"numeric\">0x1F</KEYVALUE>"
    "</KEYBINDING><KEYBINDING NAME=\"r\"><KEYVALUE VALUETYPE=\"numeric\">2.5e0</KEYVALUE>"
    "</KEYBINDING><KEYBINDING NAME=\"s\"><KEYVALUE VALUETYPE=\"string\">q&quot;\\&lt;</KEYVALUE>"
    "</KEYBINDING></INSTANCENAME>";
const std::string kTypedKey =
    "<INSTANCENAME CLASSNAME=\"B\"><KEYBINDING NAME=\"n\"><KEYVALUE VALUETYPE=\"numeric\" "
    "TYPE=\"uint8\">5</KEYVALUE></KEYBINDING></INSTANCENAME>";

ValueCase reference(const char* name, const std::string& path, const std::string& returned = {}) {
  const auto element = [](const std::string& text) {
    return "<PROPERTY.REFERENCE NAME=\"P\" REFERENCECLASS=\"B\"><VALUE.REFERENCE>" + text +
           "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
  };
  return {name, element(path), returned.empty() ? std::string() : element(returned)};
}

INSTANTIATE_TEST_SUITE_P(
    References, KeptProperty,
    testing::Values(
        reference("InstanceName", kKeys), reference("ClassName", "<CLASSNAME NAME=\"B\"/>"),
        reference("LocalInstance", "<LOCALINSTANCEPATH>" + kPlace + kKeys + "</LOCALINSTANCEPATH>"),
        reference("LocalClass",
                  "<LOCALCLASSPATH>" + kPlace + "<CLASSNAME NAME=\"B\"/></LOCALCLASSPATH>"),
        reference("Instance", "<INSTANCEPATH><NAMESPACEPATH><HOST>h:5988</HOST>" + kPlace +
                                  "</NAMESPACEPATH>" + kKeys + "</INSTANCEPATH>"),
        reference("TypedKey", kTypedKey,
                  "<INSTANCENAME CLASSNAME=\"B\"><KEYBINDING NAME=\"n\"><KEYVALUE "
                  "VALUETYPE=\"numeric\">5</KEYVALUE></KEYBINDING></INSTANCENAME>"),
        reference("KeyOfReference",
                  "<INSTANCENAME CLASSNAME=\"A\"><KEYBINDING NAME=\"k\"><VALUE.REFERENCE>"
                  "<LOCALINSTANCEPATH>" +
                      kPlace +
                      "<INSTANCENAME CLASSNAME=\"B\"><KEYBINDING NAME=\"s\"><KEYVALUE "
                      "VALUETYPE=\"string\">&quot;</KEYVALUE></KEYBINDING></INSTANCENAME>"
                      "</LOCALINSTANCEPATH></VALUE.REFERENCE></KEYBINDING></INSTANCENAME>"),
        ValueCase{"NullReference", "<PROPERTY.REFERENCE NAME=\"P\"/>",
                  "<PROPERTY.REFERENCE NAME=\"P\"></PROPERTY.REFERENCE>"}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    Embedded, KeptProperty,
    testing::Values(
        ValueCase{"Instance",
                  "<PROPERTY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>"
                  "&lt;INSTANCE CLASSNAME=&quot;A&quot;&gt;&lt;PROPERTY NAME=&quot;Q&quot; "
                  "TYPE=&quot;uint8&quot;&gt;&lt;VALUE&gt;5&lt;/VALUE&gt;&lt;/PROPERTY&gt;"
                  "&lt;/INSTANCE&gt;</VALUE></PROPERTY>",
                  ""},
        ValueCase{"Objects",
                  "<PROPERTY.ARRAY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"object\">"
                  "<VALUE.ARRAY><VALUE>&lt;INSTANCE CLASSNAME=&quot;A&quot;&gt;&lt;/INSTANCE&gt;"
                  "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>",
                  ""}),
    nameOf);

// Instances within instances, `depth` of them.
std::string nestedInstances(int depth) {
  std::string text = "<INSTANCE CLASSNAME=\"A\"></INSTANCE>";
  for (int i = 0; i < depth; ++i) {
    XmlBuffer escaped;
    escaped.appendText(text);
    text = "<PROPERTY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>" +
           std::string(escaped.view()) + "</VALUE></PROPERTY>";
    if (i + 1 < depth) text = "<INSTANCE CLASSNAME=\"A\">" + text + "</INSTANCE>";
  }
  return text;
}

using WrongProperty = KeptProperty;

TEST_F(KeptProperty, DepthOfEmbeddedInstances) {
  EXPECT_EQ(modify(nestedInstances(8)), "");
  EXPECT_EQ(get(), nestedInstances(8));
  EXPECT_NE(modify(nestedInstances(9)).find("<ERROR CODE=\"4\""), std::string::npos);
}

TEST_F(KeptProperty, WrongValuesAreRefused) {
  const auto property = [](const std::string& type, const std::string& text) {
    return "<PROPERTY NAME=\"P\" TYPE=\"" + type + "\"><VALUE>" + text + "</VALUE></PROPERTY>";
  };
  for (const std::string& wrong :
       {property("uint8", "256"), property("uint8", "-1"),
        property("sint64", "9223372036854775808"), property("uint32", ""),
        property("uint32", "1.5"), property("boolean", "1"), property("real64", "1e999"),
        property("real64", "x"), property("char16", "ab"), property("char16", "\xF0\x9F\x98\x80"),
        property("datetime", "today"),
        std::string("<PROPERTY.ARRAY NAME=\"P\" TYPE=\"uint8\"><VALUE.ARRAY><VALUE.NULL/>"
                    "</VALUE.ARRAY></PROPERTY.ARRAY>"),
        std::string("<PROPERTY.ARRAY NAME=\"P\" TYPE=\"uint8\" ARRAYSIZE=\"2\"><VALUE.ARRAY>"
                    "<VALUE>1</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"),
        std::string("<PROPERTY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"instance\">"
                    "<VALUE>no xml</VALUE></PROPERTY>"),
        std::string("<PROPERTY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"object\">"
                    "<VALUE>&lt;CLASS NAME=\"A\"/&gt;</VALUE></PROPERTY>"),
        std::string("<PROPERTY NAME=\"1\" TYPE=\"string\"/>"),
        std::string("<PROPERTY NAME=\"P\" TYPE=\"string\"/><PROPERTY NAME=\"p\" TYPE=\"uint8\"/>"),
        std::string("<PROPERTY.REFERENCE NAME=\"P\"><VALUE.REFERENCE><INSTANCENAME "
                    "CLASSNAME=\"A\"><KEYBINDING NAME=\"k\"><KEYVALUE VALUETYPE=\"numeric\">x"
                    "</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE>"
                    "</PROPERTY.REFERENCE>")}) {
    EXPECT_EQ(modify(wrong).find("<ERROR CODE=\"4\" DESCRIPTION=\"parameter ModifiedInstance: "),
              0u)
        << wrong << "\n"
        << modify(wrong);
  }
  EXPECT_EQ(answer(intrinsic("CreateInstance",
                             "<IPARAMVALUE NAME=\"NewInstance\"><INSTANCE CLASSNAME=\"A\">"
                             "<PROPERTY NAME=\"P\" TYPE=\"uint128\"/></INSTANCE></IPARAMVALUE>"))
                .headers["CIMError"],
            "request-not-valid");
}

// The provider gives back what it was called with, and 7.
class Parameters : public CimXmlTest {
 protected:
  void SetUp() override {
    using namespace Pegasus;
    CIMClass declaration = makeClass("Test_Typed", "", {"Name"});
    CIMMethod method(CIMName("Take"), CIMTYPE_UINT32);
    method.addParameter(CIMParameter(CIMName("Count"), CIMTYPE_UINT8));
    method.addParameter(CIMParameter(CIMName("Names"), CIMTYPE_STRING, true));
    method.addParameter(
        CIMParameter(CIMName("Ref"), CIMTYPE_REFERENCE, false, 0, CIMName("Test_Disk")));
    declaration.addMethod(method);
    host.repository.addClass(kNamespace, declaration);
    host.served.add({kNamespace, CIMName("Test_Typed"), false, true, "test.xml", {}});
  }

  // Without the return value and the object's path, which the provider adds.
  std::string take(const std::string& parameters) {
    Request request = extrinsic("Take", parameters);
    for (const std::string text : {"CLASSNAME=\"Test_Disk\"><KEYBINDING"}) {
      request.text.replace(request.text.find(text), text.size(),
                           "CLASSNAME=\"Test_Typed\"><KEYBINDING");
    }
    request.headers["CIMObject"] = "root/test:Test_Typed.Name=\"a\"";
    const std::string result = answer(request).result();
    const std::string before = "<RETURNVALUE PARAMTYPE=\"sint32\"><VALUE>7</VALUE></RETURNVALUE>";
    if (result.compare(0, before.size(), before) != 0) return result;
    return result.substr(before.size(), result.find("<PARAMVALUE NAME=\"Target\" "
                                                    "PARAMTYPE=\"reference\"><VALUE.REFERENCE>"
                                                    "<INSTANCEPATH>") -
                                            before.size());
  }
};

std::string parameter(const std::string& name, const std::string& attributes,
                      const std::string& element) {
  return "<PARAMVALUE NAME=\"" + name + "\"" + attributes + ">" + element + "</PARAMVALUE>";
}

TEST_F(Parameters, TypesComeFromTheMessageOrTheDeclaration) {
  const std::string names = "<VALUE.ARRAY><VALUE>a</VALUE><VALUE>b</VALUE></VALUE.ARRAY>";
  const std::string path = "<VALUE.REFERENCE>" + kKeys + "</VALUE.REFERENCE>";
  EXPECT_EQ(take(parameter("count", "", "<VALUE>5</VALUE>") + parameter("Names", "", names) +
                 parameter("Ref", "", path) + parameter("Other", "", "<VALUE>5</VALUE>")),
            parameter("count", " PARAMTYPE=\"uint8\"", "<VALUE>5</VALUE>") +
                parameter("Names", " PARAMTYPE=\"string\"", names) +
                parameter("Ref", " PARAMTYPE=\"reference\"", path) +
                parameter("Other", " PARAMTYPE=\"string\"", "<VALUE>5</VALUE>"));
  const std::string typed =
      parameter("Count", " PARAMTYPE=\"string\"", "<VALUE>x</VALUE>") +
      parameter("Refs", " PARAMTYPE=\"reference\"",
                "<VALUE.REFARRAY>" + path + path + "</VALUE.REFARRAY>") +
      parameter("Bits", " PARAMTYPE=\"boolean\"", "<VALUE.ARRAY><VALUE>TRUE</VALUE></VALUE.ARRAY>");
  EXPECT_EQ(take(typed), typed);
  EXPECT_EQ(take("<PARAMVALUE NAME=\"Count\"/><PARAMVALUE NAME=\"Ref\"/>"),
            parameter("Count", " PARAMTYPE=\"uint8\"", "") +
                parameter("Ref", " PARAMTYPE=\"reference\"", ""));
  EXPECT_EQ(take(parameter("I", "", "<INSTANCE CLASSNAME=\"A\"/>")),
            parameter("I", " PARAMTYPE=\"string\" EmbeddedObject=\"instance\"",
                      "<VALUE>&lt;INSTANCE CLASSNAME=&quot;A&quot;&gt;&lt;/INSTANCE&gt;</VALUE>"));
}

TEST_F(Parameters, WrongOnesAreRefused) {
  EXPECT_EQ(
      take(parameter("Count", "", "<VALUE>300</VALUE>")),
      "<ERROR CODE=\"4\" DESCRIPTION=\"parameter Count: &quot;300&quot; is out of range, 0 to "
      "255\"/>");
  for (const std::string& wrong :
       {parameter("Names", "", "<VALUE>a</VALUE>"), parameter("", "", "<VALUE>a</VALUE>"),
        parameter("Count", "", "<VALUE.ARRAY/>"), parameter("A", "", "") + parameter("A", "", ""),
        parameter("Ref", "", "<VALUE>no path.</VALUE>")}) {
    EXPECT_EQ(take(wrong).find("<ERROR CODE=\"4\""), 0u) << wrong << "\n" << take(wrong);
  }
}

TEST_F(CimXmlTest, MethodResults) {
  EXPECT_EQ(invoke("Nothing", ""), "") << "a null return value";
  EXPECT_EQ(invoke("ThrowsCim", ""), "<ERROR CODE=\"2\" DESCRIPTION=\"not for you\"/>");
  EXPECT_EQ(invoke("1x", "").find("<ERROR CODE=\"4\""), 0u);
  const Reply reply = answer(extrinsic("Format", ""));
  EXPECT_NE(reply.body.find("<METHODRESPONSE NAME=\"Format\">\n<RETURNVALUE"), std::string::npos);
  EXPECT_EQ(reply.summary.target, "root/test:Test_Disk");
}

}  // namespace
}  // namespace cimhost::test
