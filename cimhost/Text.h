#pragma once

#include <Pegasus/Common/String.h>

#include <cstdint>
#include <string>
#include <string_view>

namespace cimhost {

/// Always valid UTF-8, unlike getCString(): embedded NULs stay, a lone surrogate becomes U+FFFD.
std::string toUtf8(const Pegasus::String& text);

/// Throws Pegasus::Exception for bytes that are not UTF-8. Embedded NULs stay.
Pegasus::String fromUtf8(const std::string& text);

/// The text with every byte that is not UTF-8 replaced by U+FFFD.
std::string toValidUtf8(const std::string& text);

/// Appends the UTF-8 form of one code point up to U+10FFFF. A surrogate is written as three bytes,
/// as Pegasus::String takes it.
void appendUtf8(std::string& text, std::uint32_t codePoint);

/// Reads the code point at `position`, which lies inside the text, and moves it behind; a malformed
/// byte moves one and gives -1. Overlong forms, surrogates and values above U+10FFFF are malformed.
std::int32_t nextCodePoint(std::string_view text, std::size_t& position);

/// Whether a byte goes on with a character that an earlier one began.
bool isContinuation(char byte);

}  // namespace cimhost
