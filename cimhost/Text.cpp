#include "cimhost/Text.h"

namespace cimhost {

namespace {

constexpr std::uint32_t kReplacement = 0xFFFD;

bool isHighSurrogate(std::uint32_t unit) {
  return unit >= 0xD800 && unit <= 0xDBFF;
}
bool isLowSurrogate(std::uint32_t unit) {
  return unit >= 0xDC00 && unit <= 0xDFFF;
}

struct Lead {
  int followers;          // -1: no lead byte
  std::uint32_t bits;     // of the lead byte
  std::uint32_t minimum;  // below it the form is overlong
};

Lead leadOf(unsigned char byte) {
  if (byte < 0x80) return {0, byte, 0};
  if (byte >= 0xC2 && byte <= 0xDF) return {1, byte & 0x1Fu, 0x80};
  if (byte >= 0xE0 && byte <= 0xEF) return {2, byte & 0x0Fu, 0x800};
  if (byte >= 0xF0 && byte <= 0xF4) return {3, byte & 0x07u, 0x10000};
  return {-1, 0, 0};
}

}  // namespace

bool isContinuation(char byte) {
  return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

void appendUtf8(std::string& text, std::uint32_t codePoint) {
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

std::string toUtf8(const Pegasus::String& text) {
  const Pegasus::Uint32 size = text.size();
  const Pegasus::Char16* units = text.getChar16Data();
  std::string result;
  result.reserve(size);
  for (Pegasus::Uint32 i = 0; i < size; ++i) {
    std::uint32_t unit = static_cast<Pegasus::Uint16>(units[i]);
    if (isHighSurrogate(unit) && i + 1 < size &&
        isLowSurrogate(static_cast<Pegasus::Uint16>(units[i + 1]))) {
      const std::uint32_t low = static_cast<Pegasus::Uint16>(units[++i]);
      unit = 0x10000 + ((unit - 0xD800) << 10) + (low - 0xDC00);
    } else if (isHighSurrogate(unit) || isLowSurrogate(unit)) {
      unit = kReplacement;
    }
    appendUtf8(result, unit);
  }
  return result;
}

Pegasus::String fromUtf8(const std::string& text) {
  return Pegasus::String(text.data(), static_cast<Pegasus::Uint32>(text.size()));
}

std::string toValidUtf8(const std::string& text) {
  std::string result;
  for (std::size_t position = 0; position < text.size();) {
    const std::int32_t codePoint = nextCodePoint(text, position);
    appendUtf8(result, codePoint < 0 ? kReplacement : static_cast<std::uint32_t>(codePoint));
  }
  return result;
}

std::int32_t nextCodePoint(std::string_view text, std::size_t& position) {
  const Lead lead = leadOf(static_cast<unsigned char>(text[position++]));
  if (lead.followers < 0) return -1;
  std::uint32_t value = lead.bits;
  std::size_t at = position;
  for (int i = 0; i < lead.followers; ++i, ++at) {
    if (at >= text.size() || !isContinuation(text[at])) return -1;
    value = (value << 6) | (static_cast<unsigned char>(text[at]) & 0x3Fu);
  }
  const bool surrogate = value >= 0xD800 && value <= 0xDFFF;
  if (value < lead.minimum || value > 0x10FFFF || surrogate) return -1;
  position = at;
  return static_cast<std::int32_t>(value);
}

}  // namespace cimhost
