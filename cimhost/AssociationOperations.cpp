// Operations that follow associations from one object.

#include "cimhost/AssociationPlan.h"
#include "cimhost/Operations.h"
#include "cimhost/ProviderCall.h"
#include "cimhost/ResponseHandlers.h"

namespace cimhost {

using namespace Pegasus;

namespace {

using Step = AssociationPlan::Step;
using Wants = bool (AssociationPlan::*)(const Step&, const CIMName&) const;

// A class, which a provider may deliver as well as an instance, fails the request.
DeliveryBuffer<CIMObject> instanceBuffer(InstanceShaper& shaper, InstanceSink& sink) {
  return DeliveryBuffer<CIMObject>([&](const CIMObject& object) {
    return sink.deliverInstance(shaper.shape(CIMInstance(object)));
  });
}

// Calls call(association class, handler) for each step of the plan.
template <class Handler, class Object, class Call>
void follow(const AssociationPlan& plan, Wants wants, DeliveryBuffer<Object>& buffer, Call call) {
  for (const Step& step : plan.steps()) {
    Handler handler(
        buffer, [&](const Object& object) { return (plan.*wants)(step, object.getClassName()); });
    callProvider(buffer, [&] { call(step.associationClass, handler); });
  }
  buffer.finish();
}

}  // namespace

OperationStatus Operations::associators(const OperationContext& context,
                                        const AssociatorsRequest& request,
                                        InstanceSink& sink) const {
  return runOperation([&] {
    const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
    const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
    const InstanceSelection& selection = request.selection;
    InstanceShaper shaper = associatedShaper(request.nameSpace, selection);
    DeliveryBuffer<CIMObject> buffer = instanceBuffer(shaper, sink);
    const auto call = [&](const CIMName& association, ObjectResponseHandler& handler) {
      associationProvider().associators(context, path, association, request.filter.resultClass,
                                        request.filter.role, request.filter.resultRole,
                                        selection.includeQualifiers, selection.includeClassOrigin,
                                        selection.propertyList, handler);
    };
    follow<AssociatedObjects>(plan, &AssociationPlan::wantsResult, buffer, call);
  });
}

OperationStatus Operations::associatorNames(const OperationContext& context,
                                            const AssociatorNamesRequest& request,
                                            ObjectPathSink& sink) const {
  return runOperation([&] {
    const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
    const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
    DeliveryBuffer<CIMObjectPath> buffer = placedPaths(request.nameSpace, sink);
    const auto call = [&](const CIMName& association, ObjectPathResponseHandler& handler) {
      associationProvider().associatorNames(context, path, association, request.filter.resultClass,
                                            request.filter.role, request.filter.resultRole,
                                            handler);
    };
    follow<EnumeratedPaths>(plan, &AssociationPlan::wantsResult, buffer, call);
  });
}

// A provider is asked for the references of the association class at hand, not for all that the
// client wants: two classes would bring every reference twice.
OperationStatus Operations::references(const OperationContext& context,
                                       const ReferencesRequest& request, InstanceSink& sink) const {
  return runOperation([&] {
    const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
    const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
    const InstanceSelection& selection = request.selection;
    InstanceShaper shaper = associatedShaper(request.nameSpace, selection);
    DeliveryBuffer<CIMObject> buffer = instanceBuffer(shaper, sink);
    const auto call = [&](const CIMName& association, ObjectResponseHandler& handler) {
      associationProvider().references(context, path, association, request.filter.role,
                                       selection.includeQualifiers, selection.includeClassOrigin,
                                       selection.propertyList, handler);
    };
    follow<AssociatedObjects>(plan, &AssociationPlan::wantsReference, buffer, call);
  });
}

OperationStatus Operations::referenceNames(const OperationContext& context,
                                           const ReferenceNamesRequest& request,
                                           ObjectPathSink& sink) const {
  return runOperation([&] {
    const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
    const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
    DeliveryBuffer<CIMObjectPath> buffer = placedPaths(request.nameSpace, sink);
    const auto call = [&](const CIMName& association, ObjectPathResponseHandler& handler) {
      associationProvider().referenceNames(context, path, association, request.filter.role,
                                           handler);
    };
    follow<EnumeratedPaths>(plan, &AssociationPlan::wantsReference, buffer, call);
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
