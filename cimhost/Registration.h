#pragma once

#include "cimhost/Diagnostic.h"
#include "cimhost/ServedClasses.h"
#include "cimhost/repository/ClassRepository.h"

#include <Pegasus/Common/String.h>

#include <ostream>
#include <vector>

namespace cimhost {

/// What a server's registration says of the provider module beside its classes.
struct RegistrationOptions {
  Pegasus::String moduleName;
  Pegasus::String vendor;
  Pegasus::String moduleVersion;
  Pegasus::String location;  ///< The library is lib + location + .so.
};

/// One class, in the namespaces in which it is served with the same provider types.
struct ProviderCapability {
  Pegasus::String id;  ///< Unique; the same for the same definitions, in whatever order they come.
  Pegasus::CIMName className;
  std::vector<Pegasus::CIMNamespaceName> nameSpaces;  ///< Sorted.
  bool association = false;
  bool methods = false;
};

/// What OpenPegasus has to be told of the served classes before it sends requests for them.
///
/// A class has one capability; it has several when it serves methods, or is an association, in some
/// namespaces only. A definition without a namespace stands for every namespace that declares its
/// class. Subclasses are registered on their own: a server asks the provider of each registered
/// subclass when it enumerates a class. For one thread.
class Registration {
 public:
  Registration(const ServedClasses& served, const ClassRepository& repository);

  /// Sorted by class name.
  const std::vector<ProviderCapability>& capabilities() const { return capabilities_; }
  /// The definitions that have no namespace to be registered in.
  const std::vector<Diagnostic>& warnings() const { return warnings_; }

  /// Writes the instances of PG_ProviderModule, PG_Provider and PG_ProviderCapabilities as MOF for
  /// the namespace root/PG_InterOp. Module name and location stand in a comment too: they must hold
  /// no line end.
  void write(std::ostream& out, const RegistrationOptions& options) const;

 private:
  std::vector<ProviderCapability> capabilities_;
  std::vector<Diagnostic> warnings_;
};

}  // namespace cimhost
