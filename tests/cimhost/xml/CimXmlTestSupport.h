#pragma once

#include "cimhost/xml/CimXmlService.h"
#include "tests/cimhost/TestModel.h"

#include <gtest/gtest.h>

#include <map>
#include <string>

namespace cimhost::test {

/// A request as a transport would hand it over.
struct Request : CimXmlRequest {
  std::map<std::string, std::string> headers;
  std::string text;
  std::string who;

  std::optional<std::string> header(std::string_view name) const override {
    const auto found = headers.find(std::string(name));
    return found == headers.end() ? std::nullopt : std::optional<std::string>(found->second);
  }
  std::string_view body() const override { return text; }
  std::string_view user() const override { return who; }
};

/// What came back.
struct Reply : ReplyStream {
  int status = 0;
  std::map<std::string, std::string> headers;
  std::string body;
  std::size_t pieces = 0;
  bool aborted = false;
  std::size_t readsPieces = 1000;  ///< The client goes away after so many.
  RequestSummary summary;

  void begin(int httpStatus, const HttpHeaders& given) override {
    EXPECT_EQ(status, 0) << "begun twice";
    status = httpStatus;
    headers.insert(given.begin(), given.end());
  }
  bool write(std::string_view bytes) override {
    EXPECT_NE(status, 0) << "written before it was begun";
    body += bytes;
    return ++pieces < readsPieces;
  }
  void abort() override { aborted = true; }

  /// What stands in the response element, results or ERROR, without line ends and with ' for ":
  /// so expectations need no escapes. A whole reply is compared once, as it is.
  std::string result() const {
    const std::size_t start = body.find("RESPONSE NAME=");
    const std::size_t end = body.rfind("</", body.rfind("RESPONSE>"));
    if (start == std::string::npos) return body;
    std::string text;
    for (const char each : body.substr(start, end - start)) {
      if (each != '\n') text += each == '"' ? '\'' : each;
    }
    return text.substr(text.find('>') + 1);
  }
};

/// The elements around a call.
inline std::string inMessage(const std::string& call) {
  return "<?xml version='1.0' encoding='utf-8' ?>\n"
         "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='42' PROTOCOLVERSION='1.0'>"
         "<SIMPLEREQ>" +
         call + "</SIMPLEREQ></MESSAGE></CIM>\n";
}

inline Request makeRequest(const std::string& method, const std::string& object,
                           const std::string& call) {
  Request request;
  request.headers = {{"CIMOperation", "MethodCall"},
                     {"CIMProtocolVersion", "1.0"},
                     {"CIMMethod", method},
                     {"CIMObject", object}};
  request.text = inMessage(call);
  return request;
}

inline const std::string kNamespacePath =
    "<LOCALNAMESPACEPATH><NAMESPACE NAME='root'/><NAMESPACE NAME='test'/></LOCALNAMESPACEPATH>";

/// <INSTANCENAME> with the string key Name.
inline std::string instanceElement(const std::string& className, const std::string& key) {
  return "<INSTANCENAME CLASSNAME='" + className +
         "'><KEYBINDING NAME='Name'><KEYVALUE VALUETYPE='string'>" + key +
         "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

/// An operation on root/test with the headers that belong to it.
inline Request intrinsic(const std::string& operation, const std::string& parameters) {
  return makeRequest(
      operation, "root%2Ftest",
      "<IMETHODCALL NAME='" + operation + "'>" + kNamespacePath + parameters + "</IMETHODCALL>");
}

/// A method of the object with the string key Name="a" of a class.
inline Request extrinsic(const std::string& method, const std::string& parameters,
                         const std::string& className = "Test_Disk") {
  return makeRequest(method, "root%2Ftest%3A" + className + ".Name=\"a\"",
                     "<METHODCALL NAME='" + method + "'><LOCALINSTANCEPATH>" + kNamespacePath +
                         instanceElement(className, "a") + "</LOCALINSTANCEPATH>" + parameters +
                         "</METHODCALL>");
}

/// <IPARAMVALUE> with any element, a VALUE, a CLASSNAME, or an INSTANCENAME as above.
inline std::string parameter(const std::string& name, const std::string& element) {
  return "<IPARAMVALUE NAME='" + name + "'>" + element + "</IPARAMVALUE>";
}
inline std::string value(const std::string& name, const std::string& text) {
  return parameter(name, "<VALUE>" + text + "</VALUE>");
}
inline std::string className(const std::string& name, const std::string& text) {
  return parameter(name, "<CLASSNAME NAME='" + text + "'/>");
}
inline std::string instanceName(const std::string& name, const std::string& className,
                                const std::string& key) {
  return parameter(name, instanceElement(className, key));
}

/// The test provider's classes behind the service.
class CimXmlTest : public testing::Test {
 protected:
  Reply answer(const Request& request, std::size_t readsPieces = 1000) {
    Reply reply;
    reply.readsPieces = readsPieces;
    reply.summary = service.answer(request, reply);
    EXPECT_EQ(reply.summary.httpStatus, reply.status);
    return reply;
  }
  /// The result of an operation.
  std::string ask(const std::string& operation, const std::string& parameters) {
    return answer(intrinsic(operation, parameters)).result();
  }

  TestHost host;
  CimXmlService service{host.operations, host.repository};
};

}  // namespace cimhost::test
