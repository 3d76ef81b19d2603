// Any bytes as the body of a CIM-XML request to the tests' provider. Lines such as "CIMObject: x"
// in front of the document set headers; the others say what the message says, so that a message
// gets as far as it can.

#include "cimhost/Text.h"
#include "cimhost/xml/CimMessage.h"
#include "cimhost/xml/CimXmlService.h"
#include "cimhost/xml/RequestValues.h"
#include "cimhost/xml/XmlReader.h"
#include "fuzz/FuzzCheck.h"
#include "tests/cimhost/TestModel.h"

#include <cstdint>
#include <cstdlib>
#include <map>
#include <sstream>

namespace {

using namespace cimhost;

struct FuzzRequest final : CimXmlRequest {
  explicit FuzzRequest(std::string_view input)
      : text(input.substr(std::min(input.find('<'), input.size()))) {
    headers = {{"CIMOperation", "MethodCall"}};
    addMatchingHeaders();
    std::istringstream lines(std::string(input.substr(0, input.size() - text.size())));
    for (std::string line; std::getline(lines, line);) {
      const std::size_t colon = line.find(": ");
      if (colon != std::string::npos) headers[line.substr(0, colon)] = line.substr(colon + 2);
    }
  }

  void addMatchingHeaders() {
    try {
      const CimMessage message(text);
      headers["CIMMethod"] = message.method();
      headers["CIMObject"] = namespaceText(message.namespacePath());
      if (message.isIntrinsic()) return;
      headers["CIMObject"] += ":" + toUtf8(readObjectPath(message.objectName()).toString());
    } catch (const std::exception&) {
    } catch (const Pegasus::Exception&) {
    }
  }

  std::optional<std::string> header(std::string_view name) const override {
    const auto found = headers.find(std::string(name));
    return found == headers.end() ? std::nullopt : std::optional<std::string>(found->second);
  }
  std::string_view body() const override { return text; }
  std::string_view user() const override { return "fuzz"; }

  std::map<std::string, std::string> headers;
  std::string_view text;
};

struct FuzzReply final : ReplyStream {
  void begin(int httpStatus, const HttpHeaders&) override {
    check(status == 0, "begun twice");
    status = httpStatus;
  }
  bool write(std::string_view bytes) override {
    check(status != 0 && !aborted, "written at the wrong time");
    body += bytes;
    return true;
  }
  void abort() override { aborted = true; }

  int status = 0;
  bool aborted = false;
  std::string body;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static test::TestHost host;
  static const CimXmlService service(host.operations, host.repository);
  // Where the test provider records what it was asked.
  unsetenv("TEST_PROVIDER_EVENTS");
  const FuzzRequest request({reinterpret_cast<const char*>(data), size});
  FuzzReply reply;
  const RequestSummary summary = service.answer(request, reply);
  check(summary.httpStatus == reply.status && reply.status != 0, "no reply, or another in the log");
  if (reply.status == 200 && !reply.aborted) checkWellFormed(reply.body);
  return 0;
}
