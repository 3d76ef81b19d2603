#pragma once

#include "cimhost/Registration.h"
#include "cimhost/Requests.h"
#include "cimhost/ServeOptions.h"
#include "cimhost/output/ResultWriter.h"

#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMPropertyList.h>

#include <optional>
#include <ostream>
#include <string>
#include <vector>

namespace cimhost {

/// Exit codes of the program. An operation that fails with CIM status c gives kOperation + c.
struct ExitCode {
  static constexpr int kOk = 0;
  static constexpr int kProblems = 1;     ///< check, registration or dump found errors
  static constexpr int kUsage = 2;        ///< command line, malformed path, value that does not fit
  static constexpr int kCannotStart = 3;  ///< home directory, provider library, server's files
  static constexpr int kOutput = 4;       ///< results could not be written
  static constexpr int kHung = 5;         ///< serve: requests did not end in time
  static constexpr int kOperation = 10;
};

/// What the program is asked to do, checked as far as possible without a home directory.
struct CommandLine {
  enum class Command {
    enumerate,
    names,
    get,
    modify,
    invoke,
    associators,
    associatorNames,
    references,
    referenceNames,
    declaration,
    classes,
    check,
    qualifiers,
    registration,
    dump,
    serve
  };

  Command command = Command::check;
  std::string home;
  std::string providerFile;  ///< Empty: search for it.
  OutputFormat format = OutputFormat::table;
  bool trace = false;
  Pegasus::CIMObjectPath
      target;  ///< Host empty; class null for `classes NS`. None for commands on the home.
  bool deep = true;
  bool localOnly = false;
  bool includeQualifiers = false;
  bool includeClassOrigin = false;
  Pegasus::CIMPropertyList properties;  ///< Null unless given.
  AssociationFilter filter;
  std::string method;
  std::vector<std::string> values;  ///< NAME=VALUE of `modify` and `invoke`.
  std::vector<std::string> files;   ///< Of `dump`.
  RegistrationOptions registration;
  ServeOptions serve;
};

/// Reads the command line. No value: help or the version was asked for and went to `out` (exitCode
/// kOk), or the arguments are wrong and `error` got one message (kUsage).
std::optional<CommandLine> parseCommandLine(int argc, const char* const* argv, std::ostream& out,
                                            std::ostream& error, int& exitCode);

}  // namespace cimhost
