#pragma once

#include "cimhost/CommandLine.h"

#include <ostream>

namespace cimhost {

/// Serves the home directory until SIGTERM or SIGINT, and reloads it on SIGHUP. `out` gets one line
/// once it listens; before that `error` gets what is wrong with the files. Returns the exit code.
/// Throws HostError when it cannot start, or the provider's termination fails.
int runServe(const CommandLine& line, std::ostream& out, std::ostream& error);

}  // namespace cimhost
