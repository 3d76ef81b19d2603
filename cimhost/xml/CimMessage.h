#pragma once

#include "cimhost/xml/XmlReader.h"

#include <string>
#include <string_view>

namespace cimhost {

/// One request message: an operation on a namespace, or a method of an object.
class CimMessage {
 public:
  /// Throws HttpError for what is no request, or not one that is supported.
  explicit CimMessage(std::string_view body);
  CimMessage(const CimMessage&) = delete;
  CimMessage& operator=(const CimMessage&) = delete;

  const std::string& id() const { return message_->attribute("ID"); }
  const std::string& protocolVersion() const { return message_->attribute("PROTOCOLVERSION"); }
  /// The operation's or the method's name.
  const std::string& method() const { return call_->attribute("NAME"); }
  bool isIntrinsic() const { return call_->is("IMETHODCALL"); }
  /// IMETHODCALL or METHODCALL. Its first child is LOCALNAMESPACEPATH, or LOCALINSTANCEPATH or
  /// LOCALCLASSPATH; no other child is one of these.
  const XmlElement& call() const { return *call_; }
  /// LOCALNAMESPACEPATH, of either kind of call.
  const XmlElement& namespacePath() const;
  /// CLASSNAME or INSTANCENAME of a method's object.
  const XmlElement& objectName() const;

 private:
  XmlDocument document_;
  const XmlElement* message_ = nullptr;
  const XmlElement* call_ = nullptr;
};

/// Throws HttpError with unsupported-protocol-version unless it is 1.x.
void requireProtocolVersion(const std::string& version);

}  // namespace cimhost
