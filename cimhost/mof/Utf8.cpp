#include "cimhost/mof/Utf8.h"

namespace cimhost {
namespace {

constexpr std::uint32_t kSmallestOfLength[] = {0, 0, 0x80, 0x800, 0x10000};

std::size_t lengthFromLead(unsigned char lead) {
  if (lead < 0x80) return 1;
  if (lead >= 0xC2 && lead < 0xE0) return 2;
  if (lead >= 0xE0 && lead < 0xF0) return 3;
  return lead >= 0xF0 && lead < 0xF5 ? 4 : 0;
}

bool isContinuation(char byte) {
  return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

}  // namespace

Utf8Character decodeUtf8(std::string_view text, std::size_t offset) {
  const auto lead = static_cast<unsigned char>(text[offset]);
  const std::size_t length = lengthFromLead(lead);
  if (length < 2) return {lead, length};
  if (text.size() - offset < length) return {};
  std::uint32_t codePoint = lead & (0x7Fu >> length);
  for (std::size_t i = 1; i < length; ++i) {
    if (!isContinuation(text[offset + i])) return {};
    codePoint = codePoint << 6 | (static_cast<unsigned char>(text[offset + i]) & 0x3Fu);
  }
  const bool surrogate = codePoint >= 0xD800 && codePoint <= 0xDFFF;
  if (codePoint < kSmallestOfLength[length] || codePoint > 0x10FFFF || surrogate) return {};
  return {codePoint, length};
}

void appendCodePoint(std::string& text, std::uint32_t codePoint) {
  const auto put = [&text](std::uint32_t byte) { text += static_cast<char>(byte); };
  if (codePoint < 0x80) return put(codePoint);
  if (codePoint < 0x800) {
    put(0xC0 | codePoint >> 6);
  } else if (codePoint < 0x10000) {
    put(0xE0 | codePoint >> 12);
    put(0x80 | (codePoint >> 6 & 0x3F));
  } else {
    put(0xF0 | codePoint >> 18);
    put(0x80 | (codePoint >> 12 & 0x3F));
    put(0x80 | (codePoint >> 6 & 0x3F));
  }
  put(0x80 | (codePoint & 0x3F));
}

std::size_t appendPrintable(std::string& printed, std::string_view text, std::size_t offset) {
  const Utf8Character character = decodeUtf8(text, offset);
  if (character.length == 0) {
    printed += '?';
    return 1;
  }
  const bool control =
      character.codePoint < 0x20 || (character.codePoint >= 0x7F && character.codePoint < 0xA0);
  printed += control ? std::string_view(" ") : text.substr(offset, character.length);
  return character.length;
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
