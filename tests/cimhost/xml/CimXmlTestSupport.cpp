#include "tests/cimhost/xml/CimXmlTestSupport.h"

namespace cimhost::test {

std::optional<std::string> Request::header(std::string_view name) const {
  const auto found = headers.find(std::string(name));
  if (found == headers.end()) return std::nullopt;
  return found->second;
}

void Reply::begin(int httpStatus, const HttpHeaders& given) {
  EXPECT_EQ(status, 0) << "begun twice";
  status = httpStatus;
  headers.insert(given.begin(), given.end());
}

bool Reply::write(std::string_view bytes) {
  EXPECT_NE(status, 0) << "written before it was begun";
  body += bytes;
  return ++pieces < readsPieces;
}

std::string Reply::result() const {
  const std::size_t start = body.find("RESPONSE NAME=");
  const std::size_t end = body.rfind("</", body.rfind("RESPONSE>"));
  if (start == std::string::npos) return body;
  std::string text;
  for (const char each : body.substr(start, end - start)) {
    if (each != '\n') text += each == '"' ? '\'' : each;
  }
  return text.substr(text.find('>') + 1);
}

std::string inMessage(const std::string& call) {
  return "<?xml version='1.0' encoding='utf-8' ?>\n"
         "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='42' PROTOCOLVERSION='1.0'>"
         "<SIMPLEREQ>" +
         call + "</SIMPLEREQ></MESSAGE></CIM>\n";
}

namespace {

constexpr const char* kNamespacePath =
    "<LOCALNAMESPACEPATH><NAMESPACE NAME='root'/><NAMESPACE NAME='test'/></LOCALNAMESPACEPATH>";

Request makeRequest(const std::string& method, const std::string& object, const std::string& call) {
  Request request;
  request.headers = {{"CIMOperation", "MethodCall"},
                     {"CIMProtocolVersion", "1.0"},
                     {"CIMMethod", method},
                     {"CIMObject", object}};
  request.text = inMessage(call);
  return request;
}

}  // namespace

Request intrinsic(const std::string& operation, const std::string& parameters) {
  return makeRequest(
      operation, "root%2Ftest",
      "<IMETHODCALL NAME='" + operation + "'>" + kNamespacePath + parameters + "</IMETHODCALL>");
}

Request extrinsic(const std::string& method, const std::string& parameters,
                  const std::string& className) {
  return makeRequest(method, "root%2Ftest%3A" + className + ".Name=\"a\"",
                     "<METHODCALL NAME='" + method + "'><LOCALINSTANCEPATH>" + kNamespacePath +
                         instanceElement(className, "a") + "</LOCALINSTANCEPATH>" + parameters +
                         "</METHODCALL>");
}

std::string instanceElement(const std::string& className, const std::string& key) {
  return "<INSTANCENAME CLASSNAME='" + className +
         "'><KEYBINDING NAME='Name'><KEYVALUE VALUETYPE='string'>" + key +
         "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

std::string parameter(const std::string& name, const std::string& element) {
  return "<IPARAMVALUE NAME='" + name + "'>" + element + "</IPARAMVALUE>";
}

std::string value(const std::string& name, const std::string& text) {
  return parameter(name, "<VALUE>" + text + "</VALUE>");
}

std::string className(const std::string& name, const std::string& text) {
  return parameter(name, "<CLASSNAME NAME='" + text + "'/>");
}

std::string instanceName(const std::string& name, const std::string& className,
                         const std::string& key) {
  return parameter(name, instanceElement(className, key));
}

Reply CimXmlTest::answer(const Request& request, std::size_t readsPieces) {
  Reply reply;
  reply.readsPieces = readsPieces;
  reply.summary = service.answer(request, reply);
  EXPECT_EQ(reply.summary.httpStatus, reply.status);
  return reply;
}

std::string CimXmlTest::ask(const std::string& operation, const std::string& parameters) {
  return answer(intrinsic(operation, parameters)).result();
}

}  // namespace cimhost::test
