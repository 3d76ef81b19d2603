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

class CimXmlRefusal : public CimXmlTest {
 protected:
  Request request = intrinsic("EnumerateClassNames", value("DeepInheritance", "TRUE"));

  void expectRefused(const Request& wrong, int status, const std::string& cimError) {
    const Reply reply = answer(wrong);
    EXPECT_EQ(reply.status, status) << reply.body;
    const auto found = reply.headers.find("CIMError");
    EXPECT_EQ(found == reply.headers.end() ? "" : found->second, cimError) << reply.body;
    EXPECT_EQ(reply.body.find("<CIM"), std::string::npos);
  }
};

TEST_F(CimXmlRefusal, Headers) {
  const struct {
    const char* header;
    const char* text;  // null: without it
    int status;
    const char* cimError;
  } cases[] = {
      {"CIMOperation", "MethodCalls", 400, "unsupported-operation"},
      {"CIMOperation", nullptr, 400, "unsupported-operation"},
      {"CIMBatch", "", 501, "multiple-requests-unsupported"},
      {"CIMProtocolVersion", "2.0", 501, "unsupported-protocol-version"},
      {"CIMProtocolVersion", "1.x", 501, "unsupported-protocol-version"},
      {"CIMProtocolVersion", "1.4", 400, "header-mismatch"},  // not what the message says
      {"CIMMethod", nullptr, 400, "header-mismatch"},
      {"CIMMethod", "GetClass", 400, "header-mismatch"},
      {"CIMObject", "", 400, "header-mismatch"},
      {"CIMObject", "root/other", 400, "header-mismatch"},
      {"CIMObject", "root%2test", 400, "header-mismatch"},
      {"CIMObject", "root/test%2", 400, "header-mismatch"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(std::string(row.header) + ": " + (row.text != nullptr ? row.text : "none"));
    Request wrong = request;
    wrong.headers.erase(row.header);
    if (row.text != nullptr) wrong.headers[row.header] = row.text;
    expectRefused(wrong, row.status, row.cimError);
  }
}

// What in the text of a right request becomes what; the whole text where `before` is empty.
struct Edit {
  const char* before;
  std::string after;
};

TEST_F(CimXmlRefusal, Texts) {
  std::string attributes;
  for (int i = 0; i < 20; ++i) attributes += " A" + std::to_string(i) + "=''";
  const std::string place = "<LOCALNAMESPACEPATH><NAMESPACE NAME='a'/></LOCALNAMESPACEPATH>";
  const struct {
    int status;
    const char* cimError;
    std::vector<Edit> edits;
  } cases[] = {
      {400,
       "request-not-well-formed",
       {{"", ""},
        {"TRUE", "\xFF"},
        {"utf-8", "x-none"},
        {"</CIM>", ""},
        {"DTDVERSION='2.0'><MESSAGE", "DTDVERSION='1.0'><NEW"}}},  // rather than its version
      {400,
       "request-not-valid",
       {{"<CIM ", "<!DOCTYPE CIM [<!ENTITY a 'b'>]><CIM "},
        {"<CIM ", "<!DOCTYPE CIM SYSTEM 'x.dtd'><CIM "},
        {"", repeated("<CIM>", 100000) + repeated("</CIM>", 100000)},
        {"<VALUE>TRUE</VALUE>", repeated("<VALUE/>", 200001)},
        {"<VALUE>TRUE</VALUE>", repeated("<VALUE a='' b='' c=''/>", 50001)},
        {"<VALUE>", "<VALUE" + attributes + ">"},
        {"", "<HTML/>"},
        {"", "<CIM CIMVERSION='2.0' DTDVERSION='2.0'/>"},
        {" ID='42'", ""},
        {"<SIMPLEREQ>", "<SIMPLEREQ><FOO/>"},
        {"<SIMPLEREQ>", "<SIMPLEREQ><VALUE/>"},
        {"<SIMPLEREQ>", "<SIMPLEREQ>text"},
        {"</VALUE>", "</VALUE><VALUE/>"},
        {"</LOCALNAMESPACEPATH>", "</LOCALNAMESPACEPATH>" + place},
        {"", message("<SIMPLERSP/>")},
        {"", message("<SIMPLEEXPREQ/>")},
        {"", inMessage("")},
        {"", inMessage(repeated("<IMETHODCALL NAME='A'>" + place + "</IMETHODCALL>", 2))},
        {"", inMessage("<IMETHODCALL NAME='EnumerateClassNames'/>")},
        {"", inMessage("<IMETHODCALL NAME='A'><LOCALNAMESPACEPATH/></IMETHODCALL>")},
        {"", inMessage("<METHODCALL NAME='M'><LOCALCLASSPATH><CLASSNAME NAME='A'/></LOCALCLASSPATH>"
                       "</METHODCALL>")}}},
      {501,
       "multiple-requests-unsupported",
       {{"", message("<MULTIREQ><SIMPLEREQ/><SIMPLEREQ/></MULTIREQ>")}}},
      {501, "unsupported-cim-version", {{"CIMVERSION='2.0'", "CIMVERSION='3.0'"}}},
      {501,
       "unsupported-dtd-version",
       {{"", "<CIM CIMVERSION='2.0' DTDVERSION='9.1'><NEW/></CIM>"}}},
      {501, "unsupported-protocol-version", {{"PROTOCOLVERSION='1.0'", "PROTOCOLVERSION='2.0'"}}},
  };
  for (const auto& row : cases) {
    for (const Edit& edit : row.edits) {
      SCOPED_TRACE(edit.before + (" -> " + edit.after.substr(0, 200)));
      Request wrong = request;
      replace(wrong.text, *edit.before == '\0' ? request.text : edit.before, edit.after);
      expectRefused(wrong, row.status, row.cimError);
    }
  }
}

// Forms that other clients send, and that are not refused.
TEST_F(CimXmlTest, HeadersMayBeWrittenInOtherWays) {
  Request plain = intrinsic("EnumerateClassNames", "");
  plain.headers = {{"CIMOperation", "methodcall"},
                   {"CIMMethod", "EnumerateClass%4eames"},
                   {"CIMObject", "root/test"}};
  EXPECT_EQ(answer(plain).status, 200);
  const struct {
    int status;
    std::vector<const char*> objects;
  } cases[] = {
      {200,
       {"root%2Ftest%3ATest_Disk.Name=\"a\"", "root/test:Test_Disk.Name=\"a\"",
        "ROOT/test:test_disk.NAME=\"a\"", "root%2Ftest%3ATest_Disk.Name%3D%22a%22"}},
      {400,
       {"root/test:Test_Disk", "root/test:Test_Disk.Name=\"b\"", "root/test",
        "root/test:Test_Disk.Name=\"a\",Size=1", "root/test:Test_Disk.Name",
        "root/test:Test_Disk.Name=\"a", "root/test:Other.Name=\"a\""}},
  };
  Request method = extrinsic("Format", "");
  for (const auto& row : cases) {
    for (const char* object : row.objects) {
      method.headers["CIMObject"] = object;
      EXPECT_EQ(answer(method).status, row.status) << object;
    }
  }
}

TEST_F(CimXmlTest, OtherEncodings) {
  Request latin = intrinsic("EnumerateInstances", className("ClassName", "M\xFCll"));
  replace(latin.text, "utf-8", "ISO-8859-1");
  EXPECT_EQ(answer(latin).result(), "<ERROR CODE='5' DESCRIPTION='M\xC3\xBCll'/>");
}

}  // namespace
}  // namespace cimhost::test
