#pragma once

#include "cimhost/mof/MofDeclarations.h"

#include <optional>
#include <string_view>

namespace cimhost {

/// True when `name` is the keyword, which is given in lower case. MOF keywords ignore letter case.
bool isMofKeyword(std::string_view name, std::string_view keyword);

/// With A-Z in lower case.
std::string asciiLowered(std::string text);

/// The 14 types that have a keyword; references are written with REF.
std::optional<Pegasus::CIMType> mofTypeFromKeyword(std::string_view name);

std::optional<MofFlavor> mofFlavorFromKeyword(std::string_view name);

/// The QualifierScope bits of a metaElement keyword.
std::optional<unsigned> mofScopeFromKeyword(std::string_view name);

}  // namespace cimhost
