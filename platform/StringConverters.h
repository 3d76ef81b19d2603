#pragma once

#include <Pegasus/Common/String.h>

#include <string>

namespace Vaneth {

/// Decodes UTF-8; a text that is not valid UTF-8 is taken as Latin-1, so every text has a result.
std::wstring make_wstring(const std::string& text);

/// Encodes as UTF-8. Code points beyond U+10FFFF become U+FFFD.
std::string make_string(const std::wstring& text);

/// The text as UTF-8.
std::string make_string(const Pegasus::String& text);

/// The text, which must be UTF-8 (else Pegasus::Exception); embedded NULs are kept.
Pegasus::String make_String(const std::string& text);

}  // namespace Vaneth
