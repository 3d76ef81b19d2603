#include "HostName.h"

#include <arpa/inet.h>

#include <algorithm>
#include <string>

PEGASUS_NAMESPACE_BEGIN

namespace {

bool isDigit(char c) {
  return c >= '0' && c <= '9';
}

bool startsSegment(char c) {
  return isDigit(c) || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

bool isSegment(const std::string& segment) {
  return !segment.empty() && startsSegment(segment[0]) &&
         std::all_of(segment.begin(), segment.end(),
                     [](char c) { return startsSegment(c) || c == '-'; });
}

bool isDottedName(const std::string& name) {
  std::size_t start = 0;
  for (std::size_t dot; (dot = name.find('.', start)) != std::string::npos; start = dot + 1) {
    if (!isSegment(name.substr(start, dot - start))) return false;
  }
  const std::string last = name.substr(start);
  return isSegment(last) && !std::all_of(last.begin(), last.end(), isDigit);
}

// Nothing, a colon, or a colon and a port number.
bool isPortSuffix(const std::string& text) {
  if (text.empty()) return true;
  if (text[0] != ':' || !std::all_of(text.begin() + 1, text.end(), isDigit)) return false;
  unsigned port = 0;
  for (std::size_t i = 1; i < text.size() && port <= 65535; ++i) {
    port = 10 * port + unsigned(text[i] - '0');
  }
  return port <= 65535;
}

bool isAddress(int family, const std::string& text) {
  unsigned char address[sizeof(in6_addr)];
  return inet_pton(family, text.c_str(), address) == 1;
}

}  // namespace

bool isLegalHost(const String& host) {
  std::string text;
  for (Uint32 i = 0; i < host.size(); ++i) {
    const Uint16 unit = host.getChar16Data()[i];
    if (unit == 0 || unit >= 0x80) return false;
    text += static_cast<char>(unit);
  }
  if (!text.empty() && text[0] == '[') {
    const std::size_t close = text.find(']');
    return close != std::string::npos && isAddress(AF_INET6, text.substr(1, close - 1)) &&
           isPortSuffix(text.substr(close + 1));
  }
  const std::size_t colon = std::min(text.find(':'), text.size());
  const std::string name = text.substr(0, colon);
  return (isDottedName(name) || isAddress(AF_INET, name)) && isPortSuffix(text.substr(colon));
}

PEGASUS_NAMESPACE_END
