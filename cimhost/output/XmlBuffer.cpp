#include "cimhost/output/XmlBuffer.h"

#include "cimhost/Text.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <string>

namespace cimhost {

namespace {

// "&quot;" is the longest form of one unit.
constexpr std::size_t kLongestForm = 6;
constexpr std::size_t kBlock = 4096;
constexpr std::size_t kFirstCapacity = 1024;

// What stands for itself as one byte.
constexpr std::array<bool, 128> makePlain() {
  std::array<bool, 128> plain{};
  for (std::size_t i = 0x20; i < 0x80; ++i) plain[i] = true;
  for (const char each : {'\t', '\n', '\r'}) plain[static_cast<std::size_t>(each)] = true;
  for (const char each : {'<', '>', '&', '"'}) plain[static_cast<std::size_t>(each)] = false;
  return plain;
}
constexpr std::array<bool, 128> kPlain = makePlain();

char* put(char* out, std::string_view bytes) {
  std::memcpy(out, bytes.data(), bytes.size());
  return out + bytes.size();
}

char* putReplacement(char* out) {
  return put(out, "\xEF\xBF\xBD");
}

char* putByte(char* out, std::uint32_t value) {
  *out = static_cast<char>(value);
  return out + 1;
}

char* putAscii(char* out, std::uint32_t c) {
  if (kPlain[c]) return putByte(out, c);
  switch (c) {
    case '<':
      return put(out, "&lt;");
    case '>':
      return put(out, "&gt;");
    case '&':
      return put(out, "&amp;");
    case '"':
      return put(out, "&quot;");
    default:
      return putReplacement(out);
  }
}

// A code point of 0x80 and above that is no surrogate.
char* putWide(char* out, std::uint32_t c) {
  if (c == 0xFFFE || c == 0xFFFF) return putReplacement(out);
  if (c < 0x800) {
    out = putByte(out, 0xC0 | (c >> 6));
    return putByte(out, 0x80 | (c & 0x3F));
  }
  if (c < 0x10000) {
    out = putByte(out, 0xE0 | (c >> 12));
  } else {
    out = putByte(out, 0xF0 | (c >> 18));
    out = putByte(out, 0x80 | ((c >> 12) & 0x3F));
  }
  out = putByte(out, 0x80 | ((c >> 6) & 0x3F));
  return putByte(out, 0x80 | (c & 0x3F));
}

bool isSurrogate(std::uint32_t unit) {
  return (unit & 0xF800) == 0xD800;
}
bool isPair(std::uint32_t high, std::uint32_t low) {
  return (high & 0xFC00) == 0xD800 && (low & 0xFC00) == 0xDC00;
}

}  // namespace

void XmlBuffer::grow(std::size_t bytes) {
  const std::size_t capacity = std::max({size_ + bytes, 2 * capacity_, kFirstCapacity});
  std::unique_ptr<char[]> larger(new char[capacity]);
  if (size_ != 0) std::memcpy(larger.get(), bytes_.get(), size_);
  bytes_ = std::move(larger);
  capacity_ = capacity;
}

void XmlBuffer::appendText(const Pegasus::String& text) {
  const Pegasus::Char16* unit = text.getChar16Data();
  const Pegasus::Char16* const end = unit + text.size();
  while (unit != end) {
    const std::size_t left = static_cast<std::size_t>(end - unit);
    const Pegasus::Char16* const blockEnd = unit + std::min(left, kBlock);
    char* out = room((kBlock < left ? kBlock : left) * kLongestForm);
    while (unit < blockEnd) {
      const std::uint32_t c = static_cast<Pegasus::Uint16>(*unit++);
      if (c < 0x80) {
        out = putAscii(out, c);
      } else if (!isSurrogate(c)) {
        out = putWide(out, c);
      } else if (unit != end && isPair(c, static_cast<Pegasus::Uint16>(*unit))) {
        const std::uint32_t low = static_cast<Pegasus::Uint16>(*unit++);
        out = putWide(out, 0x10000 + ((c - 0xD800) << 10) + (low - 0xDC00));
      } else {
        out = putReplacement(out);
      }
    }
    advance(out);
  }
}

void XmlBuffer::appendText(std::string_view text) {
  for (std::size_t position = 0; position < text.size();) {
    char* const out = room(kLongestForm);
    const std::int32_t c = nextCodePoint(text, position);
    if (c < 0) {
      advance(putReplacement(out));
    } else {
      const std::uint32_t code = static_cast<std::uint32_t>(c);
      advance(code < 0x80 ? putAscii(out, code) : putWide(out, code));
    }
  }
}

}  // namespace cimhost
