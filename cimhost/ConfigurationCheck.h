#pragma once

#include "cimhost/Diagnostic.h"

#include <istream>
#include <string>
#include <vector>

namespace cimhost {

/// What is wrong in the text of logs/CommonProvider.ini: lines that are no `key = value`, keys that
/// nothing reads, a LogLevel that is no number. `file` names the text in the diagnostics.
std::vector<Diagnostic> checkConfiguration(std::istream& text, const std::string& file);

/// The same for a file. A missing file is no problem (the log level is 0 then); one that cannot be
/// read, or is larger than 1 MiB, is.
std::vector<Diagnostic> checkConfigurationFile(const std::string& path, const std::string& name);

}  // namespace cimhost
