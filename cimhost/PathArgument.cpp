#include "cimhost/PathArgument.h"

#include "cimhost/Diagnostic.h"
#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

namespace cimhost {

using namespace Pegasus;

namespace {

// Empty when `text` is a well-formed object path, else why not.
std::string malformedReason(const std::string& text) {
  try {
    CIMObjectPath path{fromUtf8(text)};
    return {};
  } catch (const Exception& error) {
    const std::string message = toUtf8(error.getMessage());
    const std::string marker = "reason:\"";
    const std::size_t start = message.rfind(marker);
    if (start == std::string::npos) return message;
    const std::string reason = message.substr(start + marker.size());
    return reason.substr(0, reason.rfind('"'));
  }
}

std::size_t pairEnd(const std::string& text, std::size_t start) {
  bool quoted = false;
  for (std::size_t i = start; i < text.size(); ++i) {
    if (text[i] == '\\' && quoted) {
      ++i;
    } else if (text[i] == '"') {
      quoted = !quoted;
    } else if (text[i] == ',' && !quoted) {
      return i;
    }
  }
  return text.size();
}

// Each key=value must be well formed on its own: the first that is not is where the path goes
// wrong.
std::size_t findMalformedPair(const std::string& text, std::size_t start) {
  while (start < text.size()) {
    const std::size_t end = pairEnd(text, start);
    if (!malformedReason("A." + text.substr(start, end - start)).empty()) return start;
    start = end + 1;
  }
  return text.size();
}

std::size_t findProblem(const std::string& text) {
  const std::size_t dot = text.find('.');
  const std::size_t colon = text.find(':');
  const bool hasNamespace = colon != std::string::npos && colon < dot;
  const std::size_t classStart = hasNamespace ? colon + 1 : 0;
  if (hasNamespace && !malformedReason(text.substr(0, colon) + ":A").empty()) return 0;
  const std::string className =
      text.substr(classStart, dot == std::string::npos ? dot : dot - classStart);
  if (!malformedReason(className).empty()) return classStart;
  return dot == std::string::npos ? text.size() : findMalformedPair(text, dot + 1);
}

CIMObjectPath parsePath(const std::string& text) {
  if (text.compare(0, 2, "//") == 0) {
    throw PathArgumentError(text, 0, "a host cannot be named here");
  }
  const std::size_t colon = text.find(':');
  if (colon == std::string::npos || colon > text.find('.')) {
    throw PathArgumentError(text, 0, "no namespace before the class, as in root/cimv2:CLASS");
  }
  const std::string reason = malformedReason(text);
  if (!reason.empty()) throw PathArgumentError(text, findProblem(text), reason);
  return CIMObjectPath{fromUtf8(text)};
}

std::size_t keysPosition(const std::string& text) {
  return text.find('.', text.find(':'));
}

}  // namespace

PathArgumentError::PathArgumentError(const std::string& argument, std::size_t position,
                                     const std::string& reason)
    : std::runtime_error("object path, column " + std::to_string(position + 1) + ": " +
                         displayText(reason) +
                         caretLines(argument, static_cast<int>(position) + 1)),
      column_(static_cast<int>(position) + 1) {}

CIMObjectPath parseClassPath(const std::string& text) {
  const CIMObjectPath path = parsePath(text);
  const std::size_t dot = keysPosition(text);
  if (dot != std::string::npos) throw PathArgumentError(text, dot, "a class has no keys");
  return path;
}

CIMObjectPath parseInstancePath(const std::string& text) {
  const CIMObjectPath path = parsePath(text);
  if (keysPosition(text) == std::string::npos) {
    throw PathArgumentError(text, text.size(), "no keys, as in CLASS.KEY=\"VALUE\"");
  }
  return path;
}

CIMObjectPath parseObjectPath(const std::string& text) {
  return parsePath(text);
}

CIMObjectPath parseNamespaceOrClass(const std::string& text) {
  if (text.find(':') != std::string::npos) return parseClassPath(text);
  const std::string probe = malformedReason(text + ":A");
  if (!probe.empty()) throw PathArgumentError(text, 0, probe);
  CIMObjectPath path;
  path.setNameSpace(CIMNamespaceName(fromUtf8(text)));
  return path;
}

}  // namespace cimhost
