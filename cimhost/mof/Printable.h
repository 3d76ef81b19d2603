#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace cimhost {

/// Appends the character at `offset` as it may stand in a terminal: a blank for a control
/// character, "?" for a byte that is not UTF-8. Always one character; the result is its length in
/// `text`, in bytes.
std::size_t appendPrintable(std::string& printed, std::string_view text, std::size_t offset);

/// The whole text so.
std::string printable(std::string_view text);

/// At most `limit` bytes of `text`, cut before a character and then ended with "...".
std::string shortened(std::string_view text, std::size_t limit);

}  // namespace cimhost
