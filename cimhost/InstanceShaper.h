#pragma once

#include "cimhost/repository/ClassRepository.h"

#include <Pegasus/Common/CIMInstance.h>

#include <utility>
#include <vector>

namespace cimhost {

/// What a client asks to get of each instance (DSP0200, EnumerateInstances and GetInstance).
struct InstanceSelection {
  bool deepInheritance = true;  ///< False: only properties of the requested class.
  bool localOnly = false;       ///< True: none that the requested class inherits unchanged.
  bool includeQualifiers = false;
  bool includeClassOrigin = false;
  Pegasus::CIMPropertyList propertyList;  ///< Null: all. Names of no property are ignored.
};

/// Fills in the namespace and, unless `hostName` is empty, the host where the path has none. True
/// when the path changed.
bool completePath(Pegasus::CIMObjectPath& path, const Pegasus::CIMNamespaceName& nameSpace,
                  const Pegasus::String& hostName);

/// Makes of an instance that a provider delivered the one that a client gets.
///
/// Providers may ignore the selection, so it is applied to what they deliver: class origins that
/// are missing come from the declaration, qualifiers do not. A path without a namespace gets the
/// request's, one without a host the given one, if any. The delivered object is never changed: it
/// is handed on when nothing is to be done, and cloned otherwise. For one request, on one thread.
class InstanceShaper {
 public:
  /// `repository` must outlive the shaper.
  InstanceShaper(const ClassRepository& repository, Pegasus::CIMNamespaceName nameSpace,
                 Pegasus::CIMName requestedClass, InstanceSelection selection,
                 Pegasus::String hostName = Pegasus::String());

  Pegasus::CIMInstance shape(const Pegasus::CIMInstance& delivered);

 private:
  const Pegasus::CIMPropertyList& propertiesOf(const Pegasus::CIMName& className);
  void addOrigins(Pegasus::CIMInstance& instance) const;
  Pegasus::CIMPropertyList selectProperties(const Pegasus::CIMName& className) const;
  bool isFiltered(const Pegasus::CIMInstance& instance,
                  const Pegasus::CIMPropertyList& properties) const;

  const ClassRepository& repository_;
  Pegasus::CIMNamespaceName nameSpace_;
  Pegasus::CIMName requestedClass_;
  InstanceSelection selection_;
  Pegasus::String hostName_;
  std::vector<std::pair<Pegasus::CIMName, Pegasus::CIMPropertyList>> lists_;
};

}  // namespace cimhost
