#pragma once

#include <Pegasus/Common/CIMName.h>

#include <string>
#include <vector>

namespace cimhost {

/// One class that a provider definition serves.
struct ServedClass {
  Pegasus::CIMNamespaceName nameSpace;  ///< Null: every namespace that declares the class.
  Pegasus::CIMName className;
  bool association = false;
  bool hasMethods = false;
  std::string file;                     ///< The definition file.
  std::vector<std::string> properties;  ///< Of a class: those that have a definition.
};

/// Which classes the provider is registered for, as a CIM server knows them from its registration
/// instances: a class that is not here never reaches the provider.
///
/// Filled while the host starts, read-only afterwards and then safe for several threads.
class ServedClasses {
 public:
  void add(ServedClass served);
  bool serves(const Pegasus::CIMNamespaceName& nameSpace, const Pegasus::CIMName& className) const;
  /// True when a definition of the class has methods.
  bool servesMethods(const Pegasus::CIMNamespaceName& nameSpace,
                     const Pegasus::CIMName& className) const;
  /// The association classes that are served in a namespace, each once, in order.
  std::vector<Pegasus::CIMName> associations(const Pegasus::CIMNamespaceName& nameSpace) const;
  const std::vector<ServedClass>& all() const { return classes_; }

 private:
  std::vector<ServedClass> classes_;
};

}  // namespace cimhost
