#include "cimhost/DefinitionFiles.h"

#include "cimhost/LibraryCheck.h"
#include "cimhost/OperationStatus.h"
#include "cimhost/Text.h"

#include "definition/DefinitionCheck.h"

#include <dirent.h>

#include <memory>

namespace cimhost {

namespace {

ServedClass toServedClass(const definition::Served& served, const std::string& file) {
  ServedClass result;
  if (!served.nameSpace.empty()) {
    result.nameSpace = Pegasus::CIMNamespaceName(fromUtf8(served.nameSpace));
  }
  result.className = Pegasus::CIMName(fromUtf8(served.className));
  result.association = served.association;
  result.hasMethods = served.hasMethods;
  result.file = file;
  result.properties = served.properties;
  return result;
}

Diagnostic toDiagnostic(const definition::Problem& problem, const std::string& folder) {
  Diagnostic diagnostic;
  diagnostic.file = folder + problem.file;
  diagnostic.line = problem.line;
  diagnostic.column = problem.column;
  diagnostic.message = problem.message;
  diagnostic.source = problem.source;
  diagnostic.caret = problem.caret;
  return diagnostic;
}

Diagnostic warning(const std::string& file, const std::string& message) {
  Diagnostic diagnostic;
  diagnostic.severity = Diagnostic::Severity::warning;
  diagnostic.file = file;
  diagnostic.message = message;
  return diagnostic;
}

// What keeps the plug-ins from being called, as far as it shows without loading them.
void warnOfPlugins(const definition::CheckResult& result, const std::string& folder,
                   std::vector<Diagnostic>& diagnostics) {
  for (const definition::UsedModule& module : result.modules) {
    const std::string problem = libraryProblem(module.path);
    if (problem.empty()) continue;
    diagnostics.push_back(
        warning(folder + module.file, "module " + module.name + " cannot be loaded: " + problem));
  }
  for (const definition::Problem& function : result.uncallable) {
    diagnostics.push_back(warning(folder + function.file, function.message));
  }
}

}  // namespace

std::vector<std::string> findDefinitionFiles(const std::string& directory) {
  std::vector<std::string> files;
  const std::unique_ptr<DIR, int (*)(DIR*)> open(opendir(directory.c_str()), closedir);
  if (open == nullptr) return files;
  while (const dirent* entry = readdir(open.get())) {
    const std::string name = entry->d_name;
    if (name.find(".xml") != std::string::npos) files.push_back(name);
  }
  return files;
}

std::vector<Diagnostic> readDefinitions(const std::string& folder, ServedClasses& served) {
  std::vector<Diagnostic> diagnostics;
  const definition::CheckResult result = definition::checkDefinitionFiles(findDefinitionFiles("."));
  for (const definition::Problem& problem : result.problems) {
    diagnostics.push_back(toDiagnostic(problem, folder));
  }
  for (const definition::Served& entry : result.served) {
    const std::string file = folder + entry.file;
    const OperationStatus status = runOperation([&] { served.add(toServedClass(entry, file)); });
    if (status.ok()) continue;
    diagnostics.push_back({Diagnostic::Severity::error,
                           file,
                           0,
                           0,
                           "class " + entry.className + " is not served: " + status.message,
                           {}});
  }
  warnOfPlugins(result, folder, diagnostics);
  return diagnostics;
}

std::vector<Diagnostic> dumpDefinitions(const std::vector<std::string>& files,
                                        const std::string& folder) {
  std::vector<Diagnostic> diagnostics;
  for (const definition::Problem& problem : definition::dumpDefinitionFiles(files)) {
    diagnostics.push_back(toDiagnostic(problem, folder));
  }
  return diagnostics;
}

}  // namespace cimhost
