#include "HostName.h"

#include <arpa/inet.h>
#include <net/if.h>

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

// Four numbers up to 255, of three digits at most.
bool isAddress4(const std::string& text) {
  std::size_t start = 0;
  for (int part = 0; part < 4; ++part) {
    const std::size_t end = part < 3 ? text.find('.', start) : text.size();
    if (end == std::string::npos || end == start || end - start > 3) return false;
    const auto first = text.begin() + std::ptrdiff_t(start);
    const auto last = text.begin() + std::ptrdiff_t(end);
    if (!std::all_of(first, last, isDigit) || std::stoi(std::string(first, last)) > 255) {
      return false;
    }
    start = end + 1;
  }
  return true;
}

// An address of fe80::/16 names its interface behind a percent sign, and no other one does.
bool isAddress6(const std::string& text) {
  const std::size_t percent = text.find('%');
  in6_addr address;
  if (inet_pton(AF_INET6, text.substr(0, percent).c_str(), &address) != 1) return false;
  const bool isLinkLocal = address.s6_addr[0] == 0xFE && address.s6_addr[1] == 0x80;
  if (percent == std::string::npos) return !isLinkLocal;
  return isLinkLocal && if_nametoindex(text.c_str() + percent + 1) != 0;
}

}  // namespace

bool isLegalHost(const String& host) {
  std::string text;
  for (Uint32 i = 0; i < host.size(); ++i) {
    const Uint16 unit = host.getChar16Data()[i];
    if (unit == 0) break;
    if (unit >= 0x80) return false;
    text += static_cast<char>(unit);
  }
  if (!text.empty() && text[0] == '[') {
    const std::size_t close = text.find(']');
    return close != std::string::npos && isAddress6(text.substr(1, close - 1)) &&
           isPortSuffix(text.substr(close + 1));
  }
  const std::size_t colon = std::min(text.find(':'), text.size());
  const std::string name = text.substr(0, colon);
  return (isDottedName(name) || isAddress4(name)) && isPortSuffix(text.substr(colon));
}

PEGASUS_NAMESPACE_END
