#pragma once

#include "cimhost/mof/MofLexer.h"

#include <string_view>

namespace cimhost {

enum class MofNumberResult { ok, malformed, tooLarge };

/// Sets kind and value of `token` from a whole number literal of DSP0004: decimal, octal (0 first),
/// hexadecimal (0x), binary (b last), or real (with a point). `tooLarge`: above 64 bits, or above
/// the largest real64.
MofNumberResult parseMofNumber(std::string_view literal, MofToken& token);

}  // namespace cimhost
