// Operations that follow associations from one object.

#include "cimhost/AssociationPlan.h"
#include "cimhost/Operations.h"
#include "cimhost/ProviderCall.h"
#include "cimhost/ResponseHandlers.h"

namespace cimhost {

using namespace Pegasus;

namespace {

// A class, which a provider may deliver as well as an instance, fails the request.
DeliveryBuffer<CIMObject> instanceBuffer(InstanceShaper& shaper, InstanceSink& sink) {
  return DeliveryBuffer<CIMObject>([&](const CIMObject& object) {
    return sink.deliverInstance(shaper.shape(CIMInstance(object)));
  });
}

}  // namespace

template <class Handler, class Request, class Object, class Call>
void Operations::follow(const Request& request,
                        bool (AssociationPlan::*wants)(const AssociationPlan::Step&, const CIMName&)
                            const,
                        DeliveryBuffer<Object> buffer, Call call) const {
  const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
  const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
  for (const AssociationPlan::Step& step : plan.steps()) {
    Handler handler(
        buffer, [&](const Object& object) { return (plan.*wants)(step, object.getClassName()); });
    callProvider(buffer, [&] { call(path, step.associationClass, handler); });
  }
  buffer.finish();
}

OperationStatus Operations::associators(const OperationContext& context,
                                        const AssociatorsRequest& request,
                                        InstanceSink& sink) const {
  return runOperation([&] {
    const AssociationFilter& filter = request.filter;
    const InstanceSelection& selection = request.selection;
    InstanceShaper shaper = associatedShaper(request.nameSpace, selection);
    follow<AssociatedObjects>(
        request, &AssociationPlan::wantsResult, instanceBuffer(shaper, sink),
        [&](const CIMObjectPath& path, const CIMName& association, ObjectResponseHandler& handler) {
          associationProvider().associators(
              context, path, association, filter.resultClass, filter.role, filter.resultRole,
              selection.includeQualifiers, selection.includeClassOrigin, selection.propertyList,
              handler);
        });
  });
}

OperationStatus Operations::associatorNames(const OperationContext& context,
                                            const AssociatorNamesRequest& request,
                                            ObjectPathSink& sink) const {
  return runOperation([&] {
    const AssociationFilter& filter = request.filter;
    follow<EnumeratedPaths>(
        request, &AssociationPlan::wantsResult, placedPaths(request.nameSpace, sink),
        [&](const CIMObjectPath& path, const CIMName& association,
            ObjectPathResponseHandler& handler) {
          associationProvider().associatorNames(context, path, association, filter.resultClass,
                                                filter.role, filter.resultRole, handler);
        });
  });
}

// A provider is asked for the references of the association class at hand, not for all that the
// client wants: two classes would bring every reference twice.
OperationStatus Operations::references(const OperationContext& context,
                                       const ReferencesRequest& request, InstanceSink& sink) const {
  return runOperation([&] {
    const InstanceSelection& selection = request.selection;
    InstanceShaper shaper = associatedShaper(request.nameSpace, selection);
    follow<AssociatedObjects>(
        request, &AssociationPlan::wantsReference, instanceBuffer(shaper, sink),
        [&](const CIMObjectPath& path, const CIMName& association, ObjectResponseHandler& handler) {
          associationProvider().references(
              context, path, association, request.filter.role, selection.includeQualifiers,
              selection.includeClassOrigin, selection.propertyList, handler);
        });
  });
}

OperationStatus Operations::referenceNames(const OperationContext& context,
                                           const ReferenceNamesRequest& request,
                                           ObjectPathSink& sink) const {
  return runOperation([&] {
    follow<EnumeratedPaths>(request, &AssociationPlan::wantsReference,
                            placedPaths(request.nameSpace, sink),
                            [&](const CIMObjectPath& path, const CIMName& association,
                                ObjectPathResponseHandler& handler) {
                              associationProvider().referenceNames(context, path, association,
                                                                   request.filter.role, handler);
                            });
  });
}

AssociationPlan Operations::planFor(const CIMNamespaceName& nameSpace,
                                    const CIMObjectPath& objectName,
                                    const AssociationFilter& filter) const {
  const CIMName className = objectName.getClassName();
  requireClass(nameSpace, className, CIM_ERR_INVALID_PARAMETER);
  const CIMClass declaration =
      repository_.getClass(nameSpace, className, false, true, true, CIMPropertyList());
  if (objectName.getKeyBindings().size() == 0 && declaration.hasKeys()) {
    throw CIMException(CIM_ERR_NOT_SUPPORTED, "Only instances have associated objects here.");
  }
  return AssociationPlan(repository_, served_, nameSpace, className, filter);
}

InstanceShaper Operations::associatedShaper(const CIMNamespaceName& nameSpace,
                                            const InstanceSelection& selection) const {
  InstanceSelection all = selection;
  all.deepInheritance = true;
  all.localOnly = false;
  return InstanceShaper(repository_, nameSpace, CIMName(), all, hostName_);
}

DeliveryBuffer<CIMObjectPath> Operations::placedPaths(const CIMNamespaceName& nameSpace,
                                                      ObjectPathSink& sink) const {
  return DeliveryBuffer<CIMObjectPath>([this, nameSpace, &sink](const CIMObjectPath& delivered) {
    CIMObjectPath path = delivered;
    completePath(path, nameSpace, hostName_);
    return sink.deliverPath(path);
  });
}

}  // namespace cimhost
