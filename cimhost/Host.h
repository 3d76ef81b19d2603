#pragma once

#include "cimhost/Diagnostic.h"
#include "cimhost/EmbeddedCimom.h"
#include "cimhost/Home.h"
#include "cimhost/Operations.h"
#include "cimhost/ProviderLibrary.h"
#include "cimhost/ServedClasses.h"
#include "cimhost/repository/ClassRepository.h"

#include <memory>
#include <string>
#include <vector>

namespace cimhost {

/// The embedded CIM host of one home directory: its class declarations, its definitions and, once
/// loaded, the provider. It changes the working directory of the process, and at most one of a
/// process has its provider loaded.
class Host {
 public:
  /// Enters home/run and reads declarations, definitions and configuration; malformed files become
  /// diagnostics, and the rest serves. Throws HostError for an unusable home directory.
  explicit Host(const std::string& homeDirectory);
  /// Unloads the provider.
  ~Host();
  Host(const Host&) = delete;
  Host& operator=(const Host&) = delete;

  /// Loads the provider library `file` and becomes the host that every new CIMOMHandle reaches.
  /// Throws HostError. Not while operations run.
  void loadProvider(const std::string& file);
  /// Terminates the provider and is reached by handles no longer; throws HostError when that fails.
  /// Not while operations run.
  void unloadProvider();

  const ClassRepository& repository() const { return repository_; }
  const Operations& operations() const { return operations_; }
  const ServedClasses& served() const { return served_; }
  const std::vector<Diagnostic>& diagnostics() const { return diagnostics_; }

 private:
  void readDeclarations();
  void readDefinitionFiles();

  Home home_;
  std::vector<Diagnostic> diagnostics_;
  ClassRepository repository_;
  ServedClasses served_;
  ProviderLibrary provider_;
  Operations operations_;
  EmbeddedCimom cimom_;
  // The provider keeps its address: it lives until provider_ is unloaded.
  std::unique_ptr<Pegasus::CIMOMHandle> handle_;
};

}  // namespace cimhost
