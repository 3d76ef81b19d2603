#include "cimhost/xml/CimMessage.h"

#include "cimhost/xml/HttpError.h"

#include <cctype>

namespace cimhost {

namespace {

// "2.4" is supported where `major` is '2'.
void requireVersion(const std::string& version, char major, const char* cimError) {
  bool digits = version.size() > 2;
  for (std::size_t i = 2; i < version.size(); ++i) {
    digits = digits && std::isdigit(static_cast<unsigned char>(version[i])) != 0;
  }
  if (digits && version[0] == major && version[1] == '.') return;
  throw HttpError(501, cimError, "version " + version + " is not supported");
}

void requireVersions(const XmlElement& root) {
  if (root.rule == nullptr || !root.is("CIM")) return;
  if (const std::string* version = root.findAttribute("CIMVERSION")) {
    requireVersion(*version, '2', "unsupported-cim-version");
  }
  if (const std::string* version = root.findAttribute("DTDVERSION")) {
    requireVersion(*version, '2', "unsupported-dtd-version");
  }
}

const XmlElement& findCall(const XmlElement& message) {
  const XmlElement& request = message.onlyChild();
  if (request.is("MULTIREQ")) {
    throw HttpError(501, "multiple-requests-unsupported", "one request in a message, please");
  }
  if (!request.is("SIMPLEREQ")) throwNotValid("exported indications are not taken");
  const XmlElement* call = nullptr;
  for (const XmlElement& child : request.children) {
    if (child.is("CORRELATOR")) continue;
    if (call != nullptr) throwNotValid("SIMPLEREQ with two calls");
    call = &child;
  }
  if (call == nullptr) throwNotValid("SIMPLEREQ without a call");
  return *call;
}

// What follows the first child of a call is its parameters.
void checkCall(const XmlElement& call) {
  const bool intrinsic = call.is("IMETHODCALL");
  const std::string_view parameter = intrinsic ? "IPARAMVALUE" : "PARAMVALUE";
  if (call.children.empty() || call.children[0].is(parameter)) {
    throwNotValid(std::string(call.name()) + " without a target");
  }
  for (std::size_t i = 1; i < call.children.size(); ++i) {
    if (!call.children[i].is(parameter)) throwNotValid("two targets of one call");
  }
  const XmlElement& target = call.children[0];
  if (!intrinsic && (target.children.size() != 2 || !target.children[0].is("LOCALNAMESPACEPATH") ||
                     target.children[1].is("LOCALNAMESPACEPATH"))) {
    throwNotValid(std::string(target.name()) + " is incomplete");
  }
  const XmlElement& place = intrinsic ? target : target.children[0];
  if (place.children.empty()) throwNotValid("LOCALNAMESPACEPATH without NAMESPACE");
}

}  // namespace

void requireProtocolVersion(const std::string& version) {
  requireVersion(version, '1', "unsupported-protocol-version");
}

CimMessage::CimMessage(std::string_view body) : document_(readXml(body, "CIM")) {
  requireVersions(document_.root);
  if (!document_.problem.empty()) throwNotValid(document_.problem);
  message_ = &document_.root.onlyChild();
  requireProtocolVersion(protocolVersion());
  call_ = &findCall(*message_);
  checkCall(*call_);
}

const XmlElement& CimMessage::namespacePath() const {
  const XmlElement& target = call_->children[0];
  return isIntrinsic() ? target : target.children[0];
}

const XmlElement& CimMessage::objectName() const {
  return call_->children[0].children[1];
}

}  // namespace cimhost
