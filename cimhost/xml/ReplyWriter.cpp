#include "cimhost/xml/ReplyWriter.h"

#include "cimhost/Text.h"

#include <utility>

namespace cimhost {

ReplyWriter::ReplyWriter(ReplyStream& stream, const CimMessage& message)
    : stream_(stream), message_(message) {}

XmlBuffer& ReplyWriter::next() {
  if (objects_ == 0 && buffer_.size() == 0) {
    appendHead();
    if (wrapped_) buffer_.append("<IRETURNVALUE>\n");
  }
  return buffer_;
}

bool ReplyWriter::written() {
  ++objects_;
  buffer_.append("\n");
  if (buffer_.size() >= kPiece) send();
  return reading_;
}

void ReplyWriter::finish(const OperationStatus& status) {
  if (!status.ok() && begun_) return stream_.abort();
  if (status.ok()) {
    next();
    if (wrapped_) buffer_.append("</IRETURNVALUE>\n");
  } else {
    objects_ = 0;
    buffer_.clear();
    appendHead();
    buffer_.append("<ERROR CODE=\"" + std::to_string(static_cast<int>(status.code)) +
                   "\" DESCRIPTION=\"");
    buffer_.appendText(status.message);
    buffer_.append("\"/>\n");
  }
  appendTail();
  send();
}

void ReplyWriter::appendHead() {
  buffer_.append(
      "<?xml version=\"1.0\" encoding=\"utf-8\" ?>\n"
      "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">\n<MESSAGE ID=\"");
  buffer_.appendText(message_.id());
  buffer_.append("\" PROTOCOLVERSION=\"1.0\">\n<SIMPLERSP>\n");
  buffer_.append(message_.isIntrinsic() ? "<IMETHODRESPONSE NAME=\"" : "<METHODRESPONSE NAME=\"");
  buffer_.appendText(message_.method());
  buffer_.append("\">\n");
}

void ReplyWriter::appendTail() {
  buffer_.append(message_.isIntrinsic() ? "</IMETHODRESPONSE>" : "</METHODRESPONSE>");
  buffer_.append("\n</SIMPLERSP>\n</MESSAGE>\n</CIM>\n");
}

void ReplyWriter::send() {
  static const HttpHeaders kHeaders = {{"Content-Type", "application/xml; charset=\"utf-8\""},
                                       {"CIMOperation", "MethodResponse"}};
  if (!std::exchange(begun_, true)) stream_.begin(200, kHeaders);
  if (reading_) reading_ = stream_.write(buffer_.view());
  buffer_.clear();
}

void refuse(ReplyStream& stream, const HttpError& error) {
  HttpHeaders headers = {{"Content-Type", "text/plain; charset=\"utf-8\""}};
  if (error.cimError() != nullptr) headers.emplace_back("CIMError", error.cimError());
  stream.begin(error.status(), headers);
  stream.write(toValidUtf8(error.what()) + "\n");
}

}  // namespace cimhost
