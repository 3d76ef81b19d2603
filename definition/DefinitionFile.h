#pragma once

#include <string>

/// Reads one definition file of the working directory and registers what it declares.
///
/// Malformed text ends the reading: one line "XML syntax error: ..." at level 1, and what stood
/// before the error stays registered. A file that cannot be read, is empty, no regular file, or
/// larger than 64 MiB gives one line at level 1. ProviderDefError passes through. Always gives 0.
int readProviderDefXML(const std::string& name);

namespace definition {

/// The text of a definition file in one piece. On failure `error` says why and the text is empty.
std::string loadFile(const std::string& name, std::string& error);

/// Registers what `text` declares; ProviderDefXMLError at the first error. Gives the position of
/// the unit that ended the reading: the end tag of `plugin`, in a well-formed file.
int readText(const std::string& text);

}  // namespace definition
