#include "cimhost/Host.h"

#include "cimhost/ConfigurationCheck.h"
#include "cimhost/DefinitionFiles.h"
#include "cimhost/HostError.h"
#include "cimhost/ServedClassCheck.h"
#include "cimhost/Text.h"
#include "cimhost/mof/MofReader.h"

namespace cimhost {

namespace {

constexpr const char* kProviderName = "CommonProvider";
constexpr const char* kDefaultNamespace = "root/cimv2";

// The place of a character (from 1), in bytes.
int bytePlace(const std::string& text, int character) {
  std::size_t position = 0;
  for (int i = 1; i < character && position < text.size(); ++i) nextCodePoint(text, position);
  return static_cast<int>(position) + 1;
}

Diagnostic toDiagnostic(const MofDiagnostic& problem, const Home& home) {
  return {Diagnostic::Severity::error,
          home.relative(problem.file),
          problem.line,
          problem.column,
          problem.message,
          problem.source,
          bytePlace(problem.source, problem.caret)};
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
    diagnostics_.push_back(toDiagnostic(problem, home_));
  }
}

void Host::readDefinitionFiles() {
  const auto problems = readDefinitions("run/", served_);
  diagnostics_.insert(diagnostics_.end(), problems.begin(), problems.end());
  const auto mismatches = checkServedClasses(served_, repository_);
  diagnostics_.insert(diagnostics_.end(), mismatches.begin(), mismatches.end());
}

}  // namespace cimhost
