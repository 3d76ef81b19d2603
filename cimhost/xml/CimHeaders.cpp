#include "cimhost/xml/CimHeaders.h"

#include "cimhost/Text.h"
#include "cimhost/xml/HttpError.h"
#include "cimhost/xml/RequestValues.h"

#include <strings.h>
#include <map>

namespace cimhost {

using namespace Pegasus;

namespace {

[[noreturn]] void mismatch(const std::string& reason) {
  throw HttpError(400, "header-mismatch", reason);
}

bool equalNoCase(const std::string& a, const std::string& b) {
  return a.size() == b.size() && strcasecmp(a.c_str(), b.c_str()) == 0;
}

std::optional<std::string> percentDecoded(const std::string& text) {
  std::string result;
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] != '%') {
      result += text[i];
      continue;
    }
    const std::string digits = text.substr(i + 1, 2);
    if (digits.size() < 2 || digits.find_first_not_of("0123456789abcdefABCDEF") != digits.npos) {
      return std::nullopt;
    }
    result += static_cast<char>(std::stoi(digits, nullptr, 16));
    i += 2;
  }
  return result;
}

std::string lowered(std::string text) {
  for (char& each : text) {
    if (each >= 'A' && each <= 'Z') each = static_cast<char>(each - 'A' + 'a');
  }
  return text;
}

using Keys = std::map<std::string, std::string>;

// The keys of `name=value,...` by name, values without their quotes; nullopt when it is not that.
std::optional<Keys> scanKeys(const std::string& text) {
  Keys keys;
  for (std::size_t at = 0; at < text.size();) {
    const std::size_t equals = text.find('=', at);
    if (equals == std::string::npos) return std::nullopt;
    std::string& value = keys[lowered(text.substr(at, equals - at))];
    at = equals + 1;
    if (at < text.size() && text[at] == '"') {
      for (++at; at < text.size() && text[at] != '"'; ++at) {
        if (text[at] == '\\' && at + 1 < text.size()) ++at;
        value += text[at];
      }
      if (at++ >= text.size()) return std::nullopt;
    }
    for (; at < text.size() && text[at] != ','; ++at) value += text[at];
    ++at;
  }
  return keys;
}

bool sameKey(const std::string& written, const CIMKeyBinding& key) {
  if (key.getType() == CIMKeyBinding::BOOLEAN) return equalNoCase(written, toUtf8(key.getValue()));
  if (key.getType() != CIMKeyBinding::REFERENCE) return written == toUtf8(key.getValue());
  // Hosts and types may be written in other ways; the message is what counts.
  return true;
}

// The object of a method, as in root/cimv2:Class.key="value".
bool namesObject(const std::string& text, const std::string& nameSpace, const CIMObjectPath& path) {
  const std::size_t colon = text.find(':');
  if (colon == std::string::npos || !equalNoCase(text.substr(0, colon), nameSpace)) return false;
  const std::size_t dot = std::min(text.find('.', colon), text.size());
  const std::string className = text.substr(colon + 1, dot - colon - 1);
  if (!equalNoCase(className, toUtf8(path.getClassName().getString()))) return false;
  const std::optional<Keys> keys = scanKeys(text.substr(std::min(dot + 1, text.size())));
  const Array<CIMKeyBinding>& bindings = path.getKeyBindings();
  if (!keys || keys->size() != bindings.size()) return false;
  for (Uint32 i = 0; i < bindings.size(); ++i) {
    const auto found = keys->find(lowered(toUtf8(bindings[i].getName().getString())));
    if (found == keys->end() || !sameKey(found->second, bindings[i])) return false;
  }
  return true;
}

// A header in either form.
template <class Matches>
void compareHeader(const CimXmlRequest& request, const char* name, Matches matches) {
  const std::optional<std::string> text = request.header(name);
  if (!text || text->empty()) mismatch(std::string(name) + " is missing");
  if (matches(*text)) return;
  const std::optional<std::string> decoded = percentDecoded(*text);
  if (decoded && matches(*decoded)) return;
  mismatch(std::string(name) + " is not what the message says");
}

}  // namespace

void checkHeaders(const CimXmlRequest& request) {
  if (request.header("CIMBatch")) {
    throw HttpError(501, "multiple-requests-unsupported", "one request in a message, please");
  }
  if (!equalNoCase(request.header("CIMOperation").value_or(""), "MethodCall")) {
    throw HttpError(400, "unsupported-operation", "CIMOperation is not MethodCall");
  }
  if (const auto version = request.header("CIMProtocolVersion")) requireProtocolVersion(*version);
}

void compareHeaders(const CimXmlRequest& request, const CimMessage& message) {
  const auto version = request.header("CIMProtocolVersion");
  if (version && *version != message.protocolVersion()) {
    mismatch("CIMProtocolVersion is not what the message says");
  }
  compareHeader(request, "CIMMethod",
                [&](const std::string& text) { return equalNoCase(text, message.method()); });
  const std::string nameSpace = namespaceText(message.namespacePath());
  if (message.isIntrinsic()) {
    compareHeader(request, "CIMObject",
                  [&](const std::string& text) { return equalNoCase(text, nameSpace); });
    return;
  }
  try {
    const CIMObjectPath path = readObjectPath(message.objectName());
    compareHeader(request, "CIMObject",
                  [&](const std::string& text) { return namesObject(text, nameSpace, path); });
  } catch (const Exception&) {
    // The message names no object at all, which the method call answers.
  } catch (const ValueArgumentError&) {
  }
}

}  // namespace cimhost
