#include "cimhost/output/ResultWriter.h"
#include "cimhost/output/XmlText.h"

#include <utility>

namespace cimhost {

using namespace Pegasus;

namespace {

// A document whose root is the element that encloses the results in a reply of CIM-XML.
class XmlWriter final : public ResultWriter {
 public:
  XmlWriter(std::ostream& out, std::string method) : out_(out), method_(std::move(method)) {}

  bool deliverInstance(const CIMInstance& instance) override {
    const bool local = instance.getPath().getHost().size() == 0;
    const char* const element = local ? "VALUE.OBJECTWITHLOCALPATH" : "VALUE.OBJECTWITHPATH";
    return write([&](XmlBuffer& buffer) {
      appendTag(buffer, "<", element);
      appendObjectPath(buffer, instance.getPath());
      appendInstance(buffer, instance);
      appendTag(buffer, "</", element);
    });
  }
  bool deliverPath(const CIMObjectPath& path) override {
    return write([&](XmlBuffer& buffer) { appendValue(buffer, CIMValue(path)); });
  }
  bool deliverClass(const CIMClass& declaration) override {
    return write([&](XmlBuffer& buffer) { appendClass(buffer, declaration); });
  }
  bool deliverClassName(const CIMName& name) override {
    return write([&](XmlBuffer& buffer) { appendClassName(buffer, name); });
  }
  bool deliverMethodResult(const CIMValue& returnValue,
                           const Array<CIMParamValue>& parameters) override {
    return write([&](XmlBuffer& buffer) {
      appendReturnValue(buffer, returnValue);
      for (Uint32 i = 0; i < parameters.size(); ++i) appendParamValue(buffer, parameters[i]);
    });
  }

  void finish() override {
    write([this](XmlBuffer& buffer) { appendTag(buffer, "</", rootName()); });
    out_.flush();
  }

 private:
  static void appendTag(XmlBuffer& buffer, const char* start, const char* name) {
    buffer.append(start);
    buffer.append(name);
    buffer.append(">");
  }

  const char* rootName() const { return method_.empty() ? "IRETURNVALUE" : "METHODRESPONSE"; }

  void appendStart() {
    buffer_.append("<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<");
    buffer_.append(rootName());
    if (!method_.empty()) {
      buffer_.append(" NAME=\"");
      buffer_.appendText(method_);
      buffer_.append("\"");
    }
    buffer_.append(">\n");
  }

  template <class Append>
  bool write(Append append) {
    if (!started_) appendStart();
    started_ = true;
    append(buffer_);
    buffer_.append("\n");
    out_ << buffer_.view();
    buffer_.clear();
    return static_cast<bool>(out_);
  }

  std::ostream& out_;
  std::string method_;
  XmlBuffer buffer_;
  bool started_ = false;
};

}  // namespace

std::unique_ptr<ResultWriter> makeXmlWriter(std::ostream& out, const std::string& method) {
  return std::make_unique<XmlWriter>(out, method);
}

}  // namespace cimhost
