#pragma once

#include "cimhost/DeliveryBuffer.h"
#include "cimhost/InstanceShaper.h"
#include "cimhost/OperationStatus.h"
#include "cimhost/ProviderLibrary.h"
#include "cimhost/ServedClasses.h"
#include "cimhost/Sinks.h"
#include "cimhost/repository/ClassRepository.h"

#include <Pegasus/Common/OperationContext.h>

#include <functional>
#include <string>
#include <vector>

namespace cimhost {

struct EnumerateInstancesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;
  InstanceSelection selection;
};

struct EnumerateInstanceNamesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;
};

struct GetInstanceRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMObjectPath instanceName;  ///< Its host and namespace are replaced.
  InstanceSelection selection;          ///< deepInheritance is not used.
};

struct GetClassRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;
  bool localOnly = true;
  bool includeQualifiers = true;
  bool includeClassOrigin = false;
  Pegasus::CIMPropertyList propertyList;
};

struct EnumerateClassesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;  ///< Null: from the top of the namespace.
  bool deepInheritance = false;
  bool localOnly = true;
  bool includeQualifiers = true;
  bool includeClassOrigin = false;
};

struct EnumerateClassNamesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;  ///< Null: from the top of the namespace.
  bool deepInheritance = false;
};

/// The CIM operations of DSP0200 over the declared classes and one provider.
///
/// Each takes a request and hands its results to a sink while the provider delivers them (how much
/// is held back: DeliveryBuffer). None throws: the status holds what a client is told, whatever the
/// provider did. Knows nothing of transport and prints nothing. May be called from several threads
/// at once, and again by a provider from inside an operation.
class Operations {
 public:
  /// All three must outlive this object; the provider may be loaded later.
  Operations(const ClassRepository& repository, const ServedClasses& served,
             const ProviderLibrary& provider);

  OperationStatus enumerateInstances(const Pegasus::OperationContext& context,
                                     const EnumerateInstancesRequest& request,
                                     InstanceSink& sink) const;
  OperationStatus enumerateInstanceNames(const Pegasus::OperationContext& context,
                                         const EnumerateInstanceNamesRequest& request,
                                         ObjectPathSink& sink) const;
  OperationStatus getInstance(const Pegasus::OperationContext& context,
                              const GetInstanceRequest& request, InstanceSink& sink) const;
  OperationStatus getClass(const GetClassRequest& request, ClassSink& sink) const;
  OperationStatus enumerateClasses(const EnumerateClassesRequest& request, ClassSink& sink) const;
  OperationStatus enumerateClassNames(const EnumerateClassNamesRequest& request,
                                      ClassNameSink& sink) const;

 private:
  using ProviderCall = std::function<void(const Pegasus::CIMObjectPath& classPath)>;

  void requireClass(const Pegasus::CIMNamespaceName& nameSpace,
                    const Pegasus::CIMName& className) const;
  std::vector<Pegasus::CIMName> servedTargets(const Pegasus::CIMNamespaceName& nameSpace,
                                              const Pegasus::CIMName& className) const;
  std::vector<Pegasus::CIMName> subclasses(const Pegasus::CIMNamespaceName& nameSpace,
                                           const Pegasus::CIMName& className, bool deep) const;
  Pegasus::CIMInstanceProvider& instanceProvider() const;
  template <class Object>
  void callForEachTarget(const Pegasus::CIMNamespaceName& nameSpace,
                         const Pegasus::CIMName& className, DeliveryBuffer<Object>& buffer,
                         const ProviderCall& call) const;

  const ClassRepository& repository_;
  const ServedClasses& served_;
  const ProviderLibrary& provider_;
  Pegasus::String hostName_;  // What providers see in the paths of requests.
};

/// A context as a server gives it to providers: the identity of the user who asks.
Pegasus::OperationContext makeContext(const std::string& userName);

}  // namespace cimhost
