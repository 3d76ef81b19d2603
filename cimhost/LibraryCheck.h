#pragma once

#include <string>

namespace cimhost {

/// Why the loader will not open a plug-in library, as far as the file itself shows: it is not
/// there, no shared library, or one of another word size than this program. Empty when nothing is
/// wrong, and for a name without a slash, which the loader searches for. Runs no code of the
/// library.
///
/// The message names a library in ../lib as lib/..., as the user of a home directory knows it.
std::string libraryProblem(const std::string& library);

}  // namespace cimhost
