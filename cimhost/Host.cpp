#include "cimhost/Host.h"

#include "cimhost/ConfigurationCheck.h"
#include "cimhost/DefinitionFiles.h"
#include "cimhost/HostError.h"
#include "cimhost/Text.h"
#include "cimhost/mof/MofReader.h"

#include <algorithm>

namespace cimhost {

namespace {

constexpr const char* kProviderName = "CommonProvider";
constexpr const char* kDefaultNamespace = "root/cimv2";

bool isDeclared(const ClassRepository& repository, const ServedClass& served) {
  if (!served.nameSpace.isNull()) return repository.hasClass(served.nameSpace, served.className);
  const auto spaces = repository.namespaces();
  return std::any_of(spaces.begin(), spaces.end(), [&](const Pegasus::CIMNamespaceName& space) {
    return repository.hasClass(space, served.className);
  });
}

std::string undeclaredMessage(const ServedClass& served) {
  std::string text =
      "class " + toUtf8(served.className.getString()) + " is defined, but not declared";
  if (!served.nameSpace.isNull()) text += " in namespace " + toUtf8(served.nameSpace.getString());
  return text + "; no client can reach it";
}

}  // namespace

Host::Host(const std::string& homeDirectory)
    : home_(homeDirectory),
      operations_(repository_, served_, provider_),
      cimom_(repository_, operations_) {
  home_.enterRun();
  readDeclarations();
  readDefinitionFiles();
  const auto problems =
      checkConfigurationFile(home_.configuration(), home_.relative(home_.configuration()));
  diagnostics_.insert(diagnostics_.end(), problems.begin(), problems.end());
  Pegasus::setEmbeddedHost(&cimom_);
  handle_ = std::make_unique<Pegasus::CIMOMHandle>();
}

Host::~Host() {
  try {
    provider_.unload();
  } catch (const HostError&) {
    // Whoever wants to know calls unloadProvider().
  }
  handle_.reset();
  Pegasus::setEmbeddedHost(nullptr);
}

void Host::loadProvider(const std::string& file) {
  provider_.load(file, kProviderName, *handle_);
}

void Host::readDeclarations() {
  MofReader reader(repository_);
  reader.readDirectory(home_.mof(), Pegasus::CIMNamespaceName(kDefaultNamespace));
  for (const MofDiagnostic& problem : reader.diagnostics()) {
    diagnostics_.push_back({Diagnostic::Severity::error, home_.relative(problem.file), problem.line,
                            problem.column, problem.message, problem.source});
  }
}

void Host::readDefinitionFiles() {
  const auto problems = readDefinitions("run/", served_);
  diagnostics_.insert(diagnostics_.end(), problems.begin(), problems.end());
  for (const ServedClass& served : served_.all()) {
    if (isDeclared(repository_, served)) continue;
    diagnostics_.push_back(
        {Diagnostic::Severity::warning, served.file, 0, 0, undeclaredMessage(served), {}});
  }
}

}  // namespace cimhost
