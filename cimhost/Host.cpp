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

// Nobody reaches the host of a provider that has been terminated, even when that failed.
struct Detach {
  ~Detach() {
    handle.reset();
    Pegasus::setEmbeddedHost(nullptr);
  }
  std::unique_ptr<Pegasus::CIMOMHandle>& handle;
};

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
}

Host::~Host() {
  try {
    unloadProvider();
  } catch (const HostError&) {
    // Whoever wants to know calls unloadProvider().
  }
}

void Host::loadProvider(const std::string& file) {
  unloadProvider();
  Pegasus::setEmbeddedHost(&cimom_);
  handle_ = std::make_unique<Pegasus::CIMOMHandle>();
  provider_.load(file, kProviderName, *handle_);
}

void Host::unloadProvider() {
  if (handle_ == nullptr) return;
  const Detach detach{handle_};
  provider_.unload();
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
