// Requests that are refused before any operation runs: the answer is an HTTP status and CIMError.

#include "tests/cimhost/xml/CimXmlTestSupport.h"

namespace cimhost::test {
namespace {

void replace(std::string& text, const std::string& before, const std::string& after) {
  const std::size_t at = text.find(before);
  ASSERT_NE(at, std::string::npos) << before;
  text.replace(at, before.size(), after);
}

std::string repeated(const std::string& text, int count) {
  std::string result;
  for (int i = 0; i < count; ++i) result += text;
  return result;
}

std::string message(const std::string& content) {
  return "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='1' PROTOCOLVERSION='1.0'>" + content +
         "</MESSAGE></CIM>";
}

TEST_F(CimXmlTest, RefusedHeadersAndTexts) {
  const Request request = intrinsic("EnumerateClassNames", value("DeepInheritance", "TRUE"));
  std::string attributes;
  for (int i = 0; i < 20; ++i) attributes += " A" + std::to_string(i) + "=''";
  const std::string place = "<LOCALNAMESPACEPATH><NAMESPACE NAME='a'/></LOCALNAMESPACEPATH>";
  const std::string path = "<LOCALCLASSPATH><CLASSNAME NAME='A'/></LOCALCLASSPATH>";
  const std::string call = "<IMETHODCALL NAME='A'>" + place + "</IMETHODCALL>";
  const char* const notWellFormed = "request-not-well-formed";
  const char* const notValid = "request-not-valid";
  const char* const mismatch = "header-mismatch";
  const char* const multiple = "multiple-requests-unsupported";
  const char* const protocol = "unsupported-protocol-version";
  const struct {
    int status;
    const char* cimError;
    const char* before;  // Of a right request what becomes `after`: a header, or in the text.
    std::string after;
  } cases[] = {
      {400, "unsupported-operation", "CIMOperation:", "MethodCalls"},
      {400, "unsupported-operation", "CIMOperation:", "none"},
      {501, multiple, "CIMBatch:", ""},
      {501, protocol, "CIMProtocolVersion:", "2.0"},
      {400, mismatch, "CIMProtocolVersion:", "1.4"},  // not what the message says
      {400, mismatch, "CIMMethod:", "none"},
      {400, mismatch, "CIMMethod:", "GetClass"},
      {400, mismatch, "CIMObject:", ""},
      {400, mismatch, "CIMObject:", "root/other"},
      {400, mismatch, "CIMObject:", "root/test%2"},
      {400, notWellFormed, "", ""},
      {400, notWellFormed, "TRUE", "\xFF"},
      {400, notWellFormed, "utf-8", "x-none"},
      {400, notWellFormed, "</CIM>", ""},
      // Rather than its version:
      {400, notWellFormed, "DTDVERSION='2.0'><MESSAGE", "DTDVERSION='1.0'><NEW"},
      {400, notValid, "<CIM ", "<!DOCTYPE CIM [<!ENTITY a 'b'>]><CIM "},
      {400, notValid, "<CIM ", "<!DOCTYPE CIM SYSTEM 'x.dtd'><CIM "},
      {400, notValid, "", repeated("<CIM>", 100000) + repeated("</CIM>", 100000)},
      {400, notValid, "<VALUE>TRUE</VALUE>", repeated("<VALUE/>", 200001)},
      {400, notValid, "<VALUE>TRUE</VALUE>", repeated("<VALUE a='' b='' c=''/>", 50001)},
      {400, notValid, "<VALUE>", "<VALUE" + attributes + ">"},
      {400, notValid, "", "<HTML/>"},
      {400, notValid, "", "<CIM CIMVERSION='2.0' DTDVERSION='2.0'/>"},
      {400, notValid, " ID='42'", ""},
      {400, notValid, "<SIMPLEREQ>", "<SIMPLEREQ><FOO/>"},
      {400, notValid, "<SIMPLEREQ>", "<SIMPLEREQ>text"},
      {400, notValid, "</VALUE>", "</VALUE><VALUE/>"},
      {400, notValid, "</LOCALNAMESPACEPATH>", "</LOCALNAMESPACEPATH>" + place},
      {400, notValid, "", message("<SIMPLERSP/>")},
      {400, notValid, "", inMessage("")},
      {400, notValid, "", inMessage(call + call)},
      {400, notValid, "", inMessage("<IMETHODCALL NAME='EnumerateClassNames'/>")},
      {400, notValid, "", inMessage("<IMETHODCALL NAME='A'><LOCALNAMESPACEPATH/></IMETHODCALL>")},
      {400, notValid, "", inMessage("<METHODCALL NAME='M'>" + path + "</METHODCALL>")},
      {501, multiple, "", message("<MULTIREQ><SIMPLEREQ/></MULTIREQ>")},
      {501, "unsupported-cim-version", "CIMVERSION='2.0'", "CIMVERSION='3.0'"},
      {501, "unsupported-dtd-version", "", "<CIM CIMVERSION='2.0' DTDVERSION='9.1'><NEW/></CIM>"},
      {501, protocol, "PROTOCOLVERSION='1.0'", "PROTOCOLVERSION='2.0'"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.before + (" -> " + row.after.substr(0, 200)));
    Request wrong = request;
    std::string header = row.before;
    if (!header.empty() && header.back() == ':') {
      header.pop_back();
      wrong.headers.erase(header);
      if (row.after != "none") wrong.headers[header] = row.after;
    } else {
      replace(wrong.text, header.empty() ? request.text : header, row.after);
    }
    const Reply reply = answer(wrong);
    EXPECT_EQ(reply.status, row.status) << reply.body;
    ASSERT_EQ(reply.headers.count("CIMError"), 1u) << reply.body;
    EXPECT_EQ(reply.headers.at("CIMError"), row.cimError) << reply.body;
    EXPECT_EQ(reply.body.find("<CIM"), std::string::npos);
  }
}

// Forms that other clients send, and that are not refused.
TEST_F(CimXmlTest, HeadersMayBeWrittenInOtherWays) {
  Request plain = intrinsic("EnumerateClassNames", "");
  plain.headers = {{"CIMOperation", "methodcall"},
                   {"CIMMethod", "EnumerateClass%4eames"},
                   {"CIMObject", "root/test"}};
  EXPECT_EQ(answer(plain).status, 200);
  Request method = extrinsic("Format", "");
  const auto statusOf = [&](const char* object) {
    method.headers["CIMObject"] = object;
    return answer(method).status;
  };
  for (const char* object :
       {"root%2Ftest%3ATest_Disk.Name=\"a\"", "root/test:Test_Disk.Name=\"a\"",
        "ROOT/test:test_disk.NAME=\"a\"", "root%2Ftest%3ATest_Disk.Name%3D%22a%22"}) {
    EXPECT_EQ(statusOf(object), 200) << object;
  }
  for (const char* object : {"root/test:Test_Disk", "root/test:Test_Disk.Name=\"b\"", "root/test",
                             "root/test:Test_Disk.Name=\"a\",Size=1", "root/test:Test_Disk.Name",
                             "root/test:Test_Disk.Name=\"a", "root/test:Other.Name=\"a\""}) {
    EXPECT_EQ(statusOf(object), 400) << object;
  }
}

TEST_F(CimXmlTest, ElementsAndAttributesAreLimited) {
  const auto statusOf = [&](std::size_t count, const std::string& value) {
    std::string list = "<IPARAMVALUE NAME='PropertyList'><VALUE.ARRAY>";
    for (std::size_t i = 0; i < count; ++i) list += value;
    const std::string all =
        className("ClassName", "Test_Disk") + list + "</VALUE.ARRAY></IPARAMVALUE>";
    return answer(intrinsic("EnumerateInstances", all)).status;
  };
  EXPECT_EQ(statusOf(199900, "<VALUE/>"), 200);
  EXPECT_EQ(statusOf(200000, "<VALUE/>"), 400);
  EXPECT_EQ(statusOf(99900, "<VALUE a='1'/>"), 200);
  EXPECT_EQ(statusOf(100000, "<VALUE a='1'/>"), 400);
  std::string attributes;
  for (int i = 0; i < 16; ++i) attributes += " a" + std::to_string(i) + "='1'";
  EXPECT_EQ(statusOf(1, "<VALUE" + attributes + "/>"), 200);
  EXPECT_EQ(statusOf(1, "<VALUE" + attributes + " b='1'/>"), 400);
}

TEST_F(CimXmlTest, OtherEncodingsAndTheUserReachTheOperations) {
  Request latin = intrinsic("EnumerateInstances", className("ClassName", "M\xFCll"));
  replace(latin.text, "utf-8", "ISO-8859-1");
  EXPECT_EQ(answer(latin).result(), "<ERROR CODE='5' DESCRIPTION='M\xC3\xBCll'/>");
  Request request = intrinsic("EnumerateInstances", className("ClassName", "Test_User"));
  request.who = "j\xC3\xBCrg";
  EXPECT_NE(answer(request).body.find("<VALUE>j\xC3\xBCrg</VALUE>"), std::string::npos);
}

}  // namespace
}  // namespace cimhost::test
