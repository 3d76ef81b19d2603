#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace cimhost {

/// One decoded character of a UTF-8 text; `length` 0 when the bytes are not valid UTF-8.
struct Utf8Character {
  std::uint32_t codePoint = 0;
  std::size_t length = 0;  ///< In bytes.
};

/// Decodes the character at `offset` (which lies inside the text). Overlong forms, surrogates and
/// values above U+10FFFF are invalid.
Utf8Character decodeUtf8(std::string_view text, std::size_t offset);

/// Appends the character. A surrogate is written as three bytes, as Pegasus::String takes it.
void appendCodePoint(std::string& text, std::uint32_t codePoint);

/// Appends the character at `offset` as it may stand in a terminal: a blank for a control
/// character,
/// "?" for a byte that is not UTF-8. Always one character; the result is its length in `text`.
std::size_t appendPrintable(std::string& printed, std::string_view text, std::size_t offset);

/// The whole text so.
std::string printable(std::string_view text);

/// At most `limit` bytes of `text`, cut before a character and then ended with "...".
std::string shortened(std::string_view text, std::size_t limit);

}  // namespace cimhost
