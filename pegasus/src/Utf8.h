#pragma once

#include <Pegasus/Common/Char16.h>

#include <cstddef>

PEGASUS_NAMESPACE_BEGIN

inline bool isHighSurrogate(Uint16 unit) {
  return (unit & 0xFC00) == 0xD800;
}
inline bool isLowSurrogate(Uint16 unit) {
  return (unit & 0xFC00) == 0xDC00;
}

/// Neither half a character nor U+FFFE or U+FFFF, which are none.
inline bool isCharacter(Uint16 unit) {
  return unit < 0xD800 || (unit > 0xDFFF && unit < 0xFFFE);
}

/// What decodeUtf8() did: units written, and where the first malformed sequence starts (the size of
/// the text when there is none).
struct Utf8Decoded {
  std::size_t units;
  std::size_t end;
};

/// Decodes `size` bytes into `out`, which has room for `size` units. Stops at the first sequence
/// that is truncated, overlong, above U+10FFFF or not begun by a lead byte; a surrogate, U+FFFE and
/// U+FFFF become U+FFFD.
Utf8Decoded decodeUtf8(const char* text, std::size_t size, Char16* out);

/// How many of the units a text is encoded of: a high surrogate at the very end stands for nothing.
inline std::size_t encodableUnits(const Char16* units, std::size_t size) {
  return size > 0 && isHighSurrogate(units[size - 1]) ? size - 1 : size;
}

/// Bytes that encodeUtf8() writes for these units.
std::size_t utf8Size(const Char16* units, std::size_t size);

/// Writes utf8Size() bytes, without a terminator. A surrogate without its partner becomes the three
/// bytes of its own code.
void encodeUtf8(const Char16* units, std::size_t size, char* out);

PEGASUS_NAMESPACE_END
