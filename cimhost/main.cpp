#include "cimhost/CommandLine.h"
#include "cimhost/Commands.h"
#include "cimhost/Host.h"
#include "cimhost/HostError.h"
#include "cimhost/OperationStatus.h"
#include "cimhost/ResultStream.h"
#include "cimhost/output/DisplayText.h"
#ifdef COMMONPROVIDER_SERVER
#include "cimhost/serve/Serve.h"
#endif

#include <iostream>

using namespace cimhost;

namespace {

#ifndef COMMONPROVIDER_SERVER
int runServe(const CommandLine&, std::ostream&, std::ostream& error) {
  error << "cimhost: built without the server\n";
  return ExitCode::kUsage;
}
#endif

int run(const CommandLine& line) {
  if (line.command == CommandLine::Command::dump) return runDump(line, std::cerr);
  ResultStream results(line.trace);
  if (line.command == CommandLine::Command::serve) {
    return runServe(line, results.stream(), std::cerr);
  }
  const std::string library = findProviderLibrary(line.providerFile);
  Host host(line.home);
  if (needsProvider(line.command)) host.loadProvider(library);
  const int code = runCommand(line, host, results.stream(), std::cerr);
  host.unloadProvider();
  return code;
}

}  // namespace

int main(int argc, char** argv) {
  int code = ExitCode::kOk;
  const auto line = parseCommandLine(argc, argv, std::cout, std::cerr, code);
  if (!line) return code;
  try {
    return run(*line);
  } catch (...) {
    std::cerr << "cimhost: " << displayText(currentExceptionStatus().message) << '\n';
    return ExitCode::kCannotStart;
  }
}
