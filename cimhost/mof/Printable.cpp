#include "cimhost/mof/Printable.h"

#include "cimhost/Text.h"

namespace cimhost {

std::size_t appendPrintable(std::string& printed, std::string_view text, std::size_t offset) {
  std::size_t end = offset;
  const std::int32_t codePoint = nextCodePoint(text, end);
  if (codePoint < 0) {
    printed += '?';
  } else if (codePoint < 0x20 || (codePoint >= 0x7F && codePoint < 0xA0)) {
    printed += ' ';
  } else {
    printed += text.substr(offset, end - offset);
  }
  return end - offset;
}

std::string printable(std::string_view text) {
  std::string printed;
  for (std::size_t offset = 0; offset < text.size();) {
    offset += appendPrintable(printed, text, offset);
  }
  return printed;
}

std::string shortened(std::string_view text, std::size_t limit) {
  if (text.size() <= limit) return std::string(text);
  while (limit > 0 && isContinuation(text[limit])) --limit;
  return std::string(text.substr(0, limit)) + "...";
}

}  // namespace cimhost
