#include "Utf8.h"

#include <cstring>

PEGASUS_NAMESPACE_BEGIN

namespace {

// Copies the leading ASCII bytes, eight at a time; returns how many there were.
std::size_t widenAscii(const char* text, std::size_t size, Char16* out) {
  std::size_t i = 0;
  for (; i + 8 <= size; i += 8) {
    Uint64 chunk;
    std::memcpy(&chunk, text + i, sizeof chunk);
    if (chunk & 0x8080808080808080ULL) break;
    for (std::size_t k = i; k < i + 8; ++k) out[k] = Uint16(static_cast<unsigned char>(text[k]));
  }
  for (; i < size && !(text[i] & 0x80); ++i) out[i] = Uint16(static_cast<unsigned char>(text[i]));
  return i;
}

constexpr Uint32 kMalformed = Uint32(-1);
constexpr Uint32 kReplacement = 0xFFFD;

// How many bytes the sequence starting with this byte has; 1 for a byte that starts none.
std::size_t utf8SequenceSize(unsigned char lead) {
  if (lead >= 0xC0 && lead < 0xE0) return 2;
  if (lead >= 0xE0 && lead < 0xF0) return 3;
  return lead >= 0xF0 && lead < 0xF8 ? 4 : 1;
}

// The code point of the multi-byte sequence at `text`, or kMalformed.
Uint32 decodeSequence(const char* text, std::size_t available) {
  const auto lead = static_cast<unsigned char>(*text);
  const std::size_t size = utf8SequenceSize(lead);
  if (size == 1 || size > available) return kMalformed;
  Uint32 code = lead & (0x7Fu >> size);
  for (std::size_t i = 1; i < size; ++i) {
    const auto byte = static_cast<unsigned char>(text[i]);
    if ((byte & 0xC0) != 0x80) return kMalformed;
    code = code << 6 | (byte & 0x3Fu);
  }
  constexpr Uint32 kSmallest[] = {0, 0, 0x80, 0x800, 0x10000};
  if (code < kSmallest[size] || code > 0x10FFFF) return kMalformed;
  return code < 0xD800 || code > 0xFFFF || isCharacter(Uint16(code)) ? code : kReplacement;
}

// The code point at units[i]; advances i past it.
Uint32 nextCode(const Char16* units, std::size_t size, std::size_t& i) {
  const Uint32 unit = Uint16(units[i++]);
  if (!isHighSurrogate(Uint16(unit)) || i == size || !isLowSurrogate(Uint16(units[i]))) return unit;
  return 0x10000 + ((unit & 0x3FFu) << 10 | (Uint16(units[i++]) & 0x3FFu));
}

std::size_t encodedSize(Uint32 code) {
  return code < 0x80 ? 1 : code < 0x800 ? 2 : code < 0x10000 ? 3 : 4;
}

bool isAscii(const Char16* units, std::size_t size) {
  Uint32 all = 0;
  for (std::size_t i = 0; i < size; ++i) all |= Uint16(units[i]);
  return all < 0x80;
}

}  // namespace

Utf8Decoded decodeUtf8(const char* text, std::size_t size, Char16* out) {
  std::size_t units = 0;
  std::size_t i = 0;
  while (true) {
    const std::size_t ascii = widenAscii(text + i, size - i, out + units);
    i += ascii;
    units += ascii;
    if (i == size) return {units, i};
    const Uint32 code = decodeSequence(text + i, size - i);
    if (code == kMalformed) return {units, i};
    i += utf8SequenceSize(static_cast<unsigned char>(text[i]));
    if (code < 0x10000) {
      out[units++] = Uint16(code);
    } else {
      out[units++] = Uint16(0xD800 + ((code - 0x10000) >> 10));
      out[units++] = Uint16(0xDC00 + (code & 0x3FF));
    }
  }
}

std::size_t utf8Size(const Char16* units, std::size_t size) {
  if (isAscii(units, size)) return size;
  std::size_t bytes = 0;
  for (std::size_t i = 0; i < size;) bytes += encodedSize(nextCode(units, size, i));
  return bytes;
}

void encodeUtf8(const Char16* units, std::size_t size, char* out) {
  constexpr unsigned char kLead[] = {0, 0, 0xC0, 0xE0, 0xF0};
  for (std::size_t i = 0; i < size;) {
    Uint32 code = nextCode(units, size, i);
    const std::size_t bytes = encodedSize(code);
    for (std::size_t k = bytes; k-- > 1; code >>= 6)
      out[k] = static_cast<char>(0x80 | (code & 0x3F));
    *out = static_cast<char>(bytes == 1 ? code : kLead[bytes] | code);
    out += bytes;
  }
}

PEGASUS_NAMESPACE_END
