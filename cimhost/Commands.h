#pragma once

#include "cimhost/CommandLine.h"
#include "cimhost/Host.h"

#include <ostream>

namespace cimhost {

/// True when the command asks the provider for something.
bool needsProvider(CommandLine::Command command);

/// Runs one command; results go to `out`, messages to `error`. Returns the exit code. Does not
/// throw.
int runCommand(const CommandLine& line, const Host& host, std::ostream& out, std::ostream& error);

/// All that is wrong in the home directory's files, and a line that counts it; kOk without errors.
int runCheck(const Host& host, std::ostream& out);

/// Writes the qualifier declarations of a namespace as MOF.
int runQualifiers(const CommandLine& line, const Host& host, std::ostream& out,
                  std::ostream& error);

/// Writes the MOF that registers what the home directory serves. Problems go to `error`; with an
/// error among them, or nothing to register, nothing is written.
int runRegistration(const CommandLine& line, const Host& host, std::ostream& out,
                    std::ostream& error);

/// Dumps the files that are named, or all of the home directory's run/, on standard output, which
/// must still be the program's own; problems go to `error`. Throws HostError for an unusable home
/// directory.
int runDump(const CommandLine& line, std::ostream& error);

}  // namespace cimhost
