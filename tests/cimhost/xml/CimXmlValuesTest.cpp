// Values of all types in requests and replies.

#include "cimhost/output/XmlBuffer.h"
#include "tests/cimhost/xml/CimXmlTestSupport.h"

#include <gmock/gmock.h>

namespace cimhost::test {
namespace {

using testing::StartsWith;

// The provider keeps the instance and gives it back.
class KeptProperty : public CimXmlTest {
 protected:
  std::string modify(const std::string& property) {
    return ask("ModifyInstance",
               parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" +
                                                 instanceElement("Test_Memory", "m") +
                                                 "<INSTANCE CLASSNAME='Test_Memory'>" + property +
                                                 "</INSTANCE></VALUE.NAMEDINSTANCE>"));
  }
  std::string get() {
    return ask("GetInstance", instanceName("InstanceName", "Test_Memory", "m") +
                                  value("LocalOnly", "FALSE") + value("IncludeQualifiers", "TRUE") +
                                  value("IncludeClassOrigin", "TRUE"));
  }
  void expectKept(const std::string& sent, const std::string& returned) {
    EXPECT_EQ(modify(sent), "") << sent;
    EXPECT_EQ(get(), "<IRETURNVALUE><INSTANCE CLASSNAME='Test_Memory'>" + returned +
                         "</INSTANCE></IRETURNVALUE>");
  }
};

std::string scalar(const std::string& type, const std::string& text) {
  return "<PROPERTY NAME='P' TYPE='" + type + "'><VALUE>" + text + "</VALUE></PROPERTY>";
}

TEST_F(KeptProperty, Scalars) {
  const struct {
    const char* type;
    const char* sent;
    const char* returned = sent;
  } cases[] = {
      {"boolean", "true", "TRUE"},
      {"uint64", "18446744073709551615"},
      {"sint64", "-9223372036854775808"},
      {"real32", "0.1"},
      {"real64", "3", "3.0"},
      {"real64", "1.7976931348623157e+308"},
      {"real64", "5e-324", "5.0e-324"},
      {"real64", "-0.0"},
      {"real64", "-INF"},
      {"real32", "NaN"},
      {"string", "  a\tb  "},
      {"string", "&lt;a href=&quot;&amp;amp;&quot;&gt;"},
      {"string", "it&apos;s<![CDATA[<&]]>", "it's&lt;&amp;"},
      {"string", "&#65;&#x20AC;", "A\xE2\x82\xAC"},
      {"string", "\x7F\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"},
      {"char16", "\xE2\x82\xAC"},
      {"datetime", "00000001******.******:000"},
  };
  for (const auto& row : cases) {
    expectKept(scalar(row.type, row.sent), scalar(row.type, row.returned));
  }
}

TEST_F(KeptProperty, Elements) {
  const struct {
    const char* sent;
    const char* returned = sent;
  } cases[] = {
      {"<PROPERTY NAME='P' TYPE='uint8'/>", "<PROPERTY NAME='P' TYPE='uint8'></PROPERTY>"},
      {"<PROPERTY.ARRAY NAME='P' TYPE='uint8' ARRAYSIZE='3'></PROPERTY.ARRAY>"},
      {"<PROPERTY.ARRAY NAME='P' TYPE='string'><VALUE.ARRAY><VALUE>a,b</VALUE><VALUE></VALUE>"
       "<VALUE>[]</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"},
      {"<PROPERTY NAME='P' TYPE='string' CLASSORIGIN='Test_Base' PROPAGATED='true'><QUALIFIER "
       "NAME='Q' TYPE='string' TRANSLATABLE='true'><VALUE.ARRAY><VALUE>x</VALUE></VALUE.ARRAY>"
       "</QUALIFIER><VALUE>a</VALUE></PROPERTY>"},
      {"<PROPERTY.REFERENCE NAME='P'></PROPERTY.REFERENCE>"},
      {"<PROPERTY NAME='P' TYPE='string' EmbeddedObject='instance'><VALUE>&lt;INSTANCE "
       "CLASSNAME=&quot;A&quot;&gt;&lt;PROPERTY NAME=&quot;Q&quot; TYPE=&quot;uint8&quot;&gt;"
       "&lt;VALUE&gt;5&lt;/VALUE&gt;&lt;/PROPERTY&gt;&lt;/INSTANCE&gt;</VALUE></PROPERTY>"},
      {"<PROPERTY.ARRAY NAME='P' TYPE='string' EmbeddedObject='object'><VALUE.ARRAY><VALUE>"
       "&lt;INSTANCE CLASSNAME=&quot;A&quot;&gt;&lt;/INSTANCE&gt;</VALUE></VALUE.ARRAY>"
       "</PROPERTY.ARRAY>"},
  };
  for (const auto& row : cases) expectKept(row.sent, row.returned);
}

const std::string kPlace =
    "<LOCALNAMESPACEPATH><NAMESPACE NAME='root'/><NAMESPACE NAME='x'/></LOCALNAMESPACEPATH>";
const std::string kKeys =
    "<INSTANCENAME CLASSNAME='B'><KEYBINDING NAME='b'><KEYVALUE VALUETYPE='boolean'>TRUE"
    "</KEYVALUE></KEYBINDING><KEYBINDING NAME='n'><KEYVALUE VALUETYPE='numeric'>0x1F</KEYVALUE>"
    "</KEYBINDING><KEYBINDING NAME='r'><KEYVALUE VALUETYPE='numeric'>2.5e0</KEYVALUE>"
    "</KEYBINDING><KEYBINDING NAME='s'><KEYVALUE VALUETYPE='string'>q&quot;\\&lt;</KEYVALUE>"
    "</KEYBINDING></INSTANCENAME>";

std::string reference(const std::string& path) {
  return "<PROPERTY.REFERENCE NAME='P' REFERENCECLASS='B'><VALUE.REFERENCE>" + path +
         "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
}

TEST_F(KeptProperty, References) {
  const std::string local = "<LOCALINSTANCEPATH>" + kPlace + kKeys + "</LOCALINSTANCEPATH>";
  for (const std::string& path :
       {std::string("<CLASSNAME NAME='B'/>"), local,
        "<LOCALCLASSPATH>" + kPlace + "<CLASSNAME NAME='B'/></LOCALCLASSPATH>",
        "<INSTANCEPATH><NAMESPACEPATH><HOST>h:5988</HOST>" + kPlace + "</NAMESPACEPATH>" + kKeys +
            "</INSTANCEPATH>",
        "<INSTANCENAME CLASSNAME='A'><KEYBINDING NAME='k'><VALUE.REFERENCE><LOCALINSTANCEPATH>" +
            kPlace + instanceElement("B", "&quot;") +
            "</LOCALINSTANCEPATH></VALUE.REFERENCE></KEYBINDING></INSTANCENAME>"}) {
    expectKept(reference(path), reference(path));
  }
  const std::string before = "<INSTANCENAME CLASSNAME='B'><KEYBINDING NAME='n'><KEYVALUE ";
  const std::string after = ">5</KEYVALUE></KEYBINDING></INSTANCENAME>";
  expectKept(reference(before + "TYPE='uint8'" + after),
             reference(before + "VALUETYPE='numeric'" + after));
}

// Instances within instances, `depth` of them.
std::string nestedInstances(int depth) {
  std::string text;
  for (int i = 0; i < depth; ++i) {
    text = "<INSTANCE CLASSNAME=\"A\">" + text + "</INSTANCE>";
    XmlBuffer escaped;
    escaped.appendText(text);
    text = "<PROPERTY NAME=\"P\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>" +
           std::string(escaped.view()) + "</VALUE></PROPERTY>";
  }
  return text;
}

// Each level doubles the quotes of the text that the key becomes.
std::string nestedKeys(int depth) {
  std::string key = "<KEYVALUE>\"\"</KEYVALUE>";
  for (int i = 0; i < depth; ++i) {
    key = "<VALUE.REFERENCE><INSTANCENAME CLASSNAME='A'><KEYBINDING NAME='k'>" + key +
          "</KEYBINDING></INSTANCENAME></VALUE.REFERENCE>";
  }
  return "<PROPERTY.REFERENCE NAME='P'>" + key + "</PROPERTY.REFERENCE>";
}

TEST_F(KeptProperty, WrongValuesAreRefused) {
  const std::string array = "<PROPERTY.ARRAY NAME='P' TYPE='uint8'";
  const std::string embedded = "<PROPERTY NAME='P' TYPE='string' EmbeddedObject=";
  const std::string plain = "<PROPERTY NAME='P' TYPE='string'/>";
  const std::string key = "<KEYBINDING NAME='k'><KEYVALUE VALUETYPE='numeric'>x</KEYVALUE>";
  for (const std::string& wrong :
       {scalar("uint8", "256"), scalar("uint32", ""), scalar("boolean", "1"), scalar("real64", "x"),
        scalar("char16", "ab"), scalar("datetime", "today"),
        array + "><VALUE.ARRAY><VALUE.NULL/></VALUE.ARRAY></PROPERTY.ARRAY>",
        array + " ARRAYSIZE='2'><VALUE.ARRAY><VALUE>1</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>",
        embedded + "'instance'><VALUE>no xml</VALUE></PROPERTY>",
        embedded + "'object'><VALUE>&lt;CLASS NAME='A'/&gt;</VALUE></PROPERTY>",
        std::string("<PROPERTY NAME='1' TYPE='string'/>"), plain + plain,
        reference("<INSTANCENAME CLASSNAME='A'>" + key + "</KEYBINDING></INSTANCENAME>"),
        nestedKeys(17), nestedInstances(9)}) {
    EXPECT_THAT(modify(wrong),
                StartsWith("<ERROR CODE='4' DESCRIPTION='parameter ModifiedInstance: "))
        << wrong;
  }
  EXPECT_EQ(modify(nestedInstances(8)), "");
  const std::string unknown =
      "<INSTANCE CLASSNAME='A'><PROPERTY NAME='P' TYPE='uint128'/></INSTANCE>";
  EXPECT_EQ(
      answer(intrinsic("CreateInstance", parameter("NewInstance", unknown))).headers["CIMError"],
      "request-not-valid");
}

// The provider gives back what it was called with, and 7.
class Parameters : public CimXmlTest {
 protected:
  // Without the return value and the object's path, which the provider adds.
  std::string take(const std::string& parameters) {
    const std::string result = answer(extrinsic("Take", parameters, "Test_Typed")).result();
    const std::string before = "<RETURNVALUE PARAMTYPE='sint32'><VALUE>7</VALUE></RETURNVALUE>";
    if (result.compare(0, before.size(), before) != 0) return result;
    return result.substr(before.size(), result.find("<PARAMVALUE NAME='Target'") - before.size());
  }
};

std::string given(const std::string& name, const std::string& attributes,
                  const std::string& element) {
  return "<PARAMVALUE NAME='" + name + "'" + attributes + ">" + element + "</PARAMVALUE>";
}

TEST_F(Parameters, TypesComeFromTheMessageOrTheDeclaration) {
  const std::string names = "<VALUE.ARRAY><VALUE>a</VALUE><VALUE>b</VALUE></VALUE.ARRAY>";
  const std::string path = "<VALUE.REFERENCE>" + kKeys + "</VALUE.REFERENCE>";
  EXPECT_EQ(take(given("count", "", "<VALUE>5</VALUE>") + given("Names", "", names) +
                 given("Ref", "", path) + given("Other", "", "<VALUE>5</VALUE>")),
            given("count", " PARAMTYPE='uint8'", "<VALUE>5</VALUE>") +
                given("Names", " PARAMTYPE='string'", names) +
                given("Ref", " PARAMTYPE='reference'", path) +
                given("Other", " PARAMTYPE='string'", "<VALUE>5</VALUE>"));
  const std::string typed =
      given("Count", " PARAMTYPE='string'", "<VALUE>x</VALUE>") +
      given("Refs", " PARAMTYPE='reference'",
            "<VALUE.REFARRAY>" + path + path + "</VALUE.REFARRAY>") +
      given("Bits", " PARAMTYPE='boolean'", "<VALUE.ARRAY><VALUE>TRUE</VALUE></VALUE.ARRAY>");
  EXPECT_EQ(take(typed), typed);
  EXPECT_EQ(take(given("Count", "", "") + given("Ref", "", "")),
            given("Count", " PARAMTYPE='uint8'", "") + given("Ref", " PARAMTYPE='reference'", ""));
  EXPECT_EQ(take(given("I", "", "<INSTANCE CLASSNAME='A'/>")),
            given("I", " PARAMTYPE='string' EmbeddedObject='instance'",
                  "<VALUE>&lt;INSTANCE CLASSNAME=&quot;A&quot;&gt;&lt;/INSTANCE&gt;</VALUE>"));
}

TEST_F(Parameters, WrongOnesAreRefused) {
  EXPECT_EQ(take(given("Count", "", "<VALUE>300</VALUE>")),
            "<ERROR CODE='4' DESCRIPTION='parameter Count: &quot;300&quot; is out of range, 0 to "
            "255'/>");
  for (const std::string& wrong :
       {given("Names", "", "<VALUE>a</VALUE>"), given("", "", "<VALUE>a</VALUE>"),
        given("Count", "", "<VALUE.ARRAY/>"), given("A", "", "") + given("A", "", ""),
        given("Ref", "", "<VALUE>no path.</VALUE>")}) {
    EXPECT_THAT(take(wrong), StartsWith("<ERROR CODE='4'")) << wrong;
  }
}

TEST_F(CimXmlTest, MethodResults) {
  const auto invoke = [this](const char* method) { return answer(extrinsic(method, "")).result(); };
  EXPECT_THAT(invoke("1x"), StartsWith("<ERROR CODE='4'"));
  const Reply reply = answer(extrinsic("Format", ""));
  EXPECT_THAT(reply.body, testing::HasSubstr("<METHODRESPONSE NAME=\"Format\">\n<RETURNVALUE"));
  EXPECT_EQ(reply.summary.target, "root/test:Test_Disk");
  EXPECT_EQ(reply.summary.objects, 2u) << "the return value and a parameter";
}

}  // namespace
}  // namespace cimhost::test
