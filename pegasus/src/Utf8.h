#pragma once

#include <Pegasus/Common/Char16.h>

#include <cstddef>

PEGASUS_NAMESPACE_BEGIN

/// What decodeUtf8() did: units written, and where the first malformed sequence starts (the size of
/// the text when there is none).
struct Utf8Decoded {
  std::size_t units;
  std::size_t end;
};

/// Decodes `size` bytes into `out`, which has room for `size` units. Stops at the first sequence
/// that is truncated, overlong, above U+10FFFF or not begun by a lead byte; the three bytes of a
/// surrogate's code are accepted as that surrogate.
Utf8Decoded decodeUtf8(const char* text, std::size_t size, Char16* out);

/// How many bytes the sequence starting with this byte has; 1 for a byte that starts none.
std::size_t utf8SequenceSize(unsigned char lead);

/// Bytes that encodeUtf8() writes for these units.
std::size_t utf8Size(const Char16* units, std::size_t size);

/// Writes utf8Size() bytes, without a terminator. A surrogate without its partner becomes the three
/// bytes of its own code, which decodeUtf8() reads back.
void encodeUtf8(const Char16* units, std::size_t size, char* out);

PEGASUS_NAMESPACE_END
