// Requests that are refused before any operation runs: the answer is an HTTP status and CIMError.

#include "tests/cimhost/xml/CimXmlTestSupport.h"

#include <functional>

namespace cimhost::test {
namespace {

struct Refusal {
  const char* name;
  std::function<void(Request&)> change;
  int status;
  const char* cimError;
};

class CimXmlRefusal : public CimXmlTest, public testing::WithParamInterface<Refusal> {};

void replace(std::string& text, const std::string& before, const std::string& after) {
  const std::size_t at = text.find(before);
  ASSERT_NE(at, std::string::npos) << before;
  text.replace(at, before.size(), after);
}

auto header(const char* name, const char* text) {
  return [=](Request& request) { request.headers[name] = text; };
}
auto without(const char* name) {
  return [=](Request& request) { request.headers.erase(name); };
}
auto body(std::string text) {
  return [=](Request& request) { request.text = text; };
}
auto edit(const char* before, std::string after) {
  return [=](Request& request) { replace(request.text, before, after); };
}

// `count` elements, each within the one before.
std::string nested(const std::string& element, int count) {
  std::string text;
  for (int i = 0; i < count; ++i) text += "<" + element + ">";
  for (int i = 0; i < count; ++i) text += "</" + element + ">";
  return text;
}

std::string repeated(const std::string& text, int count) {
  std::string result;
  for (int i = 0; i < count; ++i) result += text;
  return result;
}

TEST_P(CimXmlRefusal, IsAnHttpAnswer) {
  Request request = intrinsic("EnumerateClassNames", value("DeepInheritance", "TRUE"));
  GetParam().change(request);
  const Reply reply = answer(request);
  EXPECT_EQ(reply.status, GetParam().status) << reply.body;
  const auto found = reply.headers.find("CIMError");
  EXPECT_EQ(found == reply.headers.end() ? "" : found->second, GetParam().cimError) << reply.body;
  EXPECT_EQ(reply.body.find("<CIM"), std::string::npos);
}

std::string nameOf(const testing::TestParamInfo<Refusal>& info) {
  return info.param.name;
}

INSTANTIATE_TEST_SUITE_P(
    Headers, CimXmlRefusal,
    testing::Values(
        Refusal{"OtherOperation", header("CIMOperation", "MethodCalls"), 400,
                "unsupported-operation"},
        Refusal{"NoOperation", without("CIMOperation"), 400, "unsupported-operation"},
        Refusal{"Batch", header("CIMBatch", ""), 501, "multiple-requests-unsupported"},
        Refusal{"Protocol2", header("CIMProtocolVersion", "2.0"), 501,
                "unsupported-protocol-version"},
        Refusal{"ProtocolText", header("CIMProtocolVersion", "1.x"), 501,
                "unsupported-protocol-version"},
        Refusal{"ProtocolDiffers", header("CIMProtocolVersion", "1.4"), 400, "header-mismatch"},
        Refusal{"NoMethod", without("CIMMethod"), 400, "header-mismatch"},
        Refusal{"OtherMethod", header("CIMMethod", "GetClass"), 400, "header-mismatch"},
        Refusal{"EmptyObject", header("CIMObject", ""), 400, "header-mismatch"},
        Refusal{"OtherObject", header("CIMObject", "root/other"), 400, "header-mismatch"},
        Refusal{"BadEscape", header("CIMObject", "root%2test"), 400, "header-mismatch"},
        Refusal{"CutEscape", header("CIMObject", "root/test%2"), 400, "header-mismatch"}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    Text, CimXmlRefusal,
    testing::Values(
        Refusal{"Empty", body(""), 400, "request-not-well-formed"},
        Refusal{"NoXml", body("hello"), 400, "request-not-well-formed"},
        Refusal{"Unescaped", edit("TRUE", "a<b"), 400, "request-not-well-formed"},
        Refusal{"Control", edit("TRUE", "\x01"), 400, "request-not-well-formed"},
        Refusal{"ControlReference", edit("TRUE", "&#1;"), 400, "request-not-well-formed"},
        Refusal{"NotUtf8", edit("TRUE", "\xFF"), 400, "request-not-well-formed"},
        Refusal{"OtherEncoding", edit("utf-8", "x-none"), 400, "request-not-well-formed"},
        Refusal{"TwoRoots", edit("</CIM>", "</CIM><CIM/>"), 400, "request-not-well-formed"},
        Refusal{"Cut", edit("</CIM>", ""), 400, "request-not-well-formed"},
        Refusal{"Entity", edit("TRUE", "&nope;"), 400, "request-not-well-formed"},
        Refusal{"Doctype", edit("<CIM ", "<!DOCTYPE CIM [<!ENTITY a \"b\">]><CIM "), 400,
                "request-not-valid"},
        Refusal{"ExternalDoctype", edit("<CIM ", "<!DOCTYPE CIM SYSTEM \"x.dtd\"><CIM "), 400,
                "request-not-valid"},
        Refusal{"Deep", body(nested("CIM", 100000)), 400, "request-not-valid"},
        Refusal{"ManyElements", edit("<VALUE>TRUE</VALUE>", repeated("<VALUE/>", 200001)), 400,
                "request-not-valid"},
        Refusal{"ManyAttributes",
                [](Request& request) {
                  std::string attributes;
                  for (int i = 0; i < 20; ++i) attributes += " A" + std::to_string(i) + "=\"\"";
                  replace(request.text, "<VALUE>", "<VALUE" + attributes + ">");
                },
                400, "request-not-valid"}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    Structure, CimXmlRefusal,
    testing::Values(
        Refusal{"OtherRoot", body("<HTML/>"), 400, "request-not-valid"},
        Refusal{"Response",
                body("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" "
                     "PROTOCOLVERSION=\"1.0\"><SIMPLERSP/></MESSAGE></CIM>"),
                400, "request-not-valid"},
        Refusal{"NoMessage", body("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"/>"), 400,
                "request-not-valid"},
        Refusal{"NoId", edit(" ID=\"42\"", ""), 400, "request-not-valid"},
        Refusal{"UnknownElement", edit("<SIMPLEREQ>", "<SIMPLEREQ><FOO/>"), 400,
                "request-not-valid"},
        Refusal{"MisplacedElement", edit("<SIMPLEREQ>", "<SIMPLEREQ><VALUE/>"), 400,
                "request-not-valid"},
        Refusal{"StrayText", edit("<SIMPLEREQ>", "<SIMPLEREQ>text"), 400, "request-not-valid"},
        Refusal{"NoCall", body(inMessage("")), 400, "request-not-valid"},
        Refusal{"TwoCalls", body(inMessage(repeated("<IMETHODCALL NAME=\"A\"/>", 2))), 400,
                "request-not-valid"},
        Refusal{"NoNamespace", body(inMessage("<IMETHODCALL NAME=\"EnumerateClassNames\"/>")), 400,
                "request-not-valid"},
        Refusal{"EmptyNamespace",
                body(inMessage("<IMETHODCALL NAME=\"EnumerateClassNames\">"
                               "<LOCALNAMESPACEPATH/></IMETHODCALL>")),
                400, "request-not-valid"},
        Refusal{"TwoNamespaces",
                edit("</LOCALNAMESPACEPATH>",
                     "</LOCALNAMESPACEPATH><LOCALNAMESPACEPATH><NAMESPACE "
                     "NAME=\"a\"/></LOCALNAMESPACEPATH>"),
                400, "request-not-valid"},
        Refusal{"TwoValues", edit("</VALUE>", "</VALUE><VALUE/>"), 400, "request-not-valid"},
        Refusal{"HalfObject",
                body(inMessage("<METHODCALL NAME=\"M\"><LOCALCLASSPATH><CLASSNAME "
                               "NAME=\"A\"/></LOCALCLASSPATH></METHODCALL>")),
                400, "request-not-valid"},
        Refusal{"MultiReq", edit("<SIMPLEREQ>", "<MULTIREQ><SIMPLEREQ/></MULTIREQ><SIMPLEREQ>"),
                400, "request-not-valid"},
        Refusal{"Export",
                body("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" "
                     "PROTOCOLVERSION=\"1.0\"><SIMPLEEXPREQ/></MESSAGE></CIM>"),
                400, "request-not-valid"},
        Refusal{"Multi",
                body("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" "
                     "PROTOCOLVERSION=\"1.0\"><MULTIREQ><SIMPLEREQ/><SIMPLEREQ/>"
                     "</MULTIREQ></MESSAGE></CIM>"),
                501, "multiple-requests-unsupported"},
        Refusal{"CimVersion", edit("CIMVERSION=\"2.0\"", "CIMVERSION=\"3.0\""), 501,
                "unsupported-cim-version"},
        Refusal{"DtdVersion", edit("DTDVERSION=\"2.0\"><MESSAGE", "DTDVERSION=\"1.0\"><NEW"), 400,
                "request-not-well-formed"},
        Refusal{"DtdVersionOfUnknownElements",
                body("<CIM CIMVERSION=\"2.0\" DTDVERSION=\"9.1\"><NEW/></CIM>"), 501,
                "unsupported-dtd-version"},
        Refusal{"ProtocolVersion", edit("PROTOCOLVERSION=\"1.0\"", "PROTOCOLVERSION=\"2.0\""), 501,
                "unsupported-protocol-version"}),
    nameOf);

// Forms that other clients send, and that are not refused.
TEST_F(CimXmlTest, HeadersMayBeWrittenInOtherWays) {
  Request plain = intrinsic("EnumerateClassNames", "");
  plain.headers = {{"CIMOperation", "methodcall"},
                   {"CIMMethod", "EnumerateClass%4eames"},
                   {"CIMObject", "root/test"}};
  EXPECT_EQ(answer(plain).status, 200);
  for (const char* object :
       {"root%2Ftest%3ATest_Disk.Name=\"a\"", "root/test:Test_Disk.Name=\"a\"",
        "ROOT/test:test_disk.NAME=\"a\"", "root%2Ftest%3ATest_Disk.Name%3D%22a%22"}) {
    Request method = extrinsic("Format", "");
    method.headers["CIMObject"] = object;
    EXPECT_EQ(answer(method).status, 200) << object;
  }
  for (const char* object : {"root/test:Test_Disk", "root/test:Test_Disk.Name=\"b\"", "root/test",
                             "root/test:Test_Disk.Name=\"a\",Size=1", "root/test:Test_Disk.Name",
                             "root/test:Test_Disk.Name=\"a", "root/test:Other.Name=\"a\""}) {
    Request method = extrinsic("Format", "");
    method.headers["CIMObject"] = object;
    EXPECT_EQ(answer(method).status, 400) << object;
  }
}

TEST_F(CimXmlTest, OtherEncodings) {
  Request latin = intrinsic("EnumerateInstances", className("ClassName", "M\xFCll"));
  replace(latin.text, "utf-8", "ISO-8859-1");
  EXPECT_NE(answer(latin).body.find("<ERROR CODE=\"5\" DESCRIPTION=\"M\xC3\xBCll\"/>"),
            std::string::npos);
}

}  // namespace
}  // namespace cimhost::test
