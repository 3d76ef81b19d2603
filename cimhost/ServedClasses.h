#pragma once

#include <Pegasus/Common/CIMName.h>

#include <cstddef>
#include <string>
#include <unordered_map>
#include <vector>

#include "cimhost/repository/NameHash.h"

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
/// Look-ups cost no walk of the list. Filled while the host starts, read-only afterwards and then
/// safe for several threads.
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
  template <class Accept>
  bool anyOf(const Pegasus::CIMName& className, Accept accept) const;

  std::vector<ServedClass> classes_;
  // The positions in classes_ of each class name.
  std::unordered_map<Pegasus::CIMName, std::vector<std::size_t>, NameHash, NameEqual> byName_;
};

}  // namespace cimhost
