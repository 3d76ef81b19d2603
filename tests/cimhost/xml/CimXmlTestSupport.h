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

  std::optional<std::string> header(std::string_view name) const override;
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

  void begin(int httpStatus, const HttpHeaders& given) override;
  bool write(std::string_view bytes) override;
  void abort() override { aborted = true; }

  /// What stands in the response element, results or ERROR, without line ends and with ' for ":
  /// so expectations need no escapes. A whole reply is compared once, as it is.
  std::string result() const;
};

/// The elements around a call.
std::string inMessage(const std::string& call);

/// An operation on root/test with the headers that belong to it.
Request intrinsic(const std::string& operation, const std::string& parameters);

/// A method of the object with the string key Name="a" of a class.
Request extrinsic(const std::string& method, const std::string& parameters,
                  const std::string& className = "Test_Disk");

/// <INSTANCENAME> with the string key Name.
std::string instanceElement(const std::string& className, const std::string& key);

/// <IPARAMVALUE> with any element, a VALUE, a CLASSNAME, or an INSTANCENAME as above.
std::string parameter(const std::string& name, const std::string& element);
std::string value(const std::string& name, const std::string& text);
std::string className(const std::string& name, const std::string& text);
std::string instanceName(const std::string& name, const std::string& className,
                         const std::string& key);

/// The test provider's classes behind the service.
class CimXmlTest : public testing::Test {
 protected:
  Reply answer(const Request& request, std::size_t readsPieces = 1000);
  /// The result of an operation.
  std::string ask(const std::string& operation, const std::string& parameters);

  TestHost host;
  CimXmlService service{host.operations, host.repository};
};

}  // namespace cimhost::test
