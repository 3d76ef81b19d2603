#pragma once

#include <cstddef>
#include <string>

namespace cimhost {

/// Text for a terminal: printable characters stay; control characters, bidirectional and invisible
/// format characters and bytes that are not UTF-8 become \n, \t, \r, \xHH or \uHHHH, so that data
/// can neither move the cursor nor reorder the line.
std::string displayText(const std::string& text);

/// Columns that displayText() output takes on a terminal: 0 for combining marks, 2 for East Asian
/// wide characters and emoji, else 1.
std::size_t displayWidth(const std::string& text);

/// The text cut to at most `width` columns; "…" stands for what is missing.
std::string fitToWidth(const std::string& text, std::size_t width);

}  // namespace cimhost
