#pragma once

#include "cimhost/DeliveryBuffer.h"
#include "cimhost/OperationStatus.h"
#include "cimhost/ProviderLibrary.h"
#include "cimhost/Requests.h"
#include "cimhost/ServedClasses.h"
#include "cimhost/Sinks.h"
#include "cimhost/repository/ClassRepository.h"

#include <Pegasus/Common/OperationContext.h>

#include <functional>
#include <string>
#include <vector>

namespace cimhost {

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

  /// Properties and their values are not checked: a provider gets the instance as it was sent, less
  /// what the property list leaves out.
  OperationStatus modifyInstance(const Pegasus::OperationContext& context,
                                 const ModifyInstanceRequest& request) const;
  OperationStatus createInstance(const Pegasus::OperationContext& context,
                                 const CreateInstanceRequest& request, ObjectPathSink& sink) const;
  OperationStatus deleteInstance(const Pegasus::OperationContext& context,
                                 const DeleteInstanceRequest& request) const;
  /// The method's name and parameters are not checked. CIM_ERR_NOT_FOUND for a class that is not
  /// declared. For a class whose methods no definition serves: CIM_ERR_METHOD_NOT_AVAILABLE when it
  /// declares the method, else CIM_ERR_METHOD_NOT_FOUND (DSP0200, InvokeMethod).
  OperationStatus invokeMethod(const Pegasus::OperationContext& context,
                               const InvokeMethodRequest& request, MethodResultSink& sink) const;

  // Each association class in which the object's class takes part is a provider call of its own.
  // Paths that are delivered without host or namespace get this host's and the request's.
  OperationStatus associators(const Pegasus::OperationContext& context,
                              const AssociatorsRequest& request, InstanceSink& sink) const;
  OperationStatus associatorNames(const Pegasus::OperationContext& context,
                                  const AssociatorNamesRequest& request,
                                  ObjectPathSink& sink) const;
  OperationStatus references(const Pegasus::OperationContext& context,
                             const ReferencesRequest& request, InstanceSink& sink) const;
  OperationStatus referenceNames(const Pegasus::OperationContext& context,
                                 const ReferenceNamesRequest& request, ObjectPathSink& sink) const;

  OperationStatus getClass(const GetClassRequest& request, ClassSink& sink) const;
  OperationStatus enumerateClasses(const EnumerateClassesRequest& request, ClassSink& sink) const;
  OperationStatus enumerateClassNames(const EnumerateClassNamesRequest& request,
                                      ClassNameSink& sink) const;

  /// The host that providers see in the paths of requests.
  const Pegasus::String& hostName() const { return hostName_; }

 private:
  using TargetCall = std::function<void(const Pegasus::CIMObjectPath& classPath)>;

  void requireClass(const Pegasus::CIMNamespaceName& nameSpace, const Pegasus::CIMName& className,
                    Pegasus::CIMStatusCode missing = Pegasus::CIM_ERR_INVALID_CLASS) const;
  std::vector<Pegasus::CIMName> servedTargets(const Pegasus::CIMNamespaceName& nameSpace,
                                              const Pegasus::CIMName& className) const;
  std::vector<Pegasus::CIMName> subclasses(const Pegasus::CIMNamespaceName& nameSpace,
                                           const Pegasus::CIMName& className, bool deep) const;
  void requireServed(const Pegasus::CIMNamespaceName& nameSpace,
                     const Pegasus::CIMName& className) const;
  void requireMethod(const InvokeMethodRequest& request) const;
  AssociationPlan planFor(const Pegasus::CIMNamespaceName& nameSpace,
                          const Pegasus::CIMObjectPath& objectName,
                          const AssociationFilter& filter) const;
  /// Calls call(the object's path for the provider, association class, handler) for each step of
  /// the plan; what `wants` says yes to goes to the buffer.
  template <class Handler, class Request, class Object, class Call>
  void follow(const Request& request,
              bool (AssociationPlan::*wants)(const AssociationPlan::Step&, const Pegasus::CIMName&)
                  const,
              DeliveryBuffer<Object> buffer, Call call) const;
  DeliveryBuffer<Pegasus::CIMObjectPath> placedPaths(const Pegasus::CIMNamespaceName& nameSpace,
                                                     ObjectPathSink& sink) const;
  InstanceShaper associatedShaper(const Pegasus::CIMNamespaceName& nameSpace,
                                  const InstanceSelection& selection) const;
  Pegasus::CIMObjectPath providerPath(const Pegasus::CIMNamespaceName& nameSpace,
                                      const Pegasus::CIMObjectPath& objectName) const;
  template <class Interface>
  Interface& provider(Interface* (ProviderLibrary::*interface)() const) const;
  Pegasus::CIMInstanceProvider& instanceProvider() const;
  Pegasus::CIMAssociationProvider& associationProvider() const;
  Pegasus::CIMMethodProvider& methodProvider() const;
  template <class Object>
  void callForEachTarget(const Pegasus::CIMNamespaceName& nameSpace,
                         const Pegasus::CIMName& className, DeliveryBuffer<Object>& buffer,
                         const TargetCall& call) const;

  const ClassRepository& repository_;
  const ServedClasses& served_;
  const ProviderLibrary& provider_;
  Pegasus::String hostName_;
};

/// A context as a server gives it to providers: the identity of the user who asks.
Pegasus::OperationContext makeContext(const std::string& userName);

}  // namespace cimhost
