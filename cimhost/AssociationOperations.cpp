// Operations that follow associations from one object.

#include "cimhost/AssociationPlan.h"
#include "cimhost/Operations.h"
#include "cimhost/ProviderCall.h"
#include "cimhost/ResponseHandlers.h"

namespace cimhost {

using namespace Pegasus;

using Step = AssociationPlan::Step;

namespace {

// What a provider may deliver as a class, which no request for an instance's links wants, throws.
DeliveryBuffer<CIMObject> instanceBuffer(InstanceShaper& shaper, InstanceSink& sink) {
  return DeliveryBuffer<CIMObject>([&](const CIMObject& object) {
    return sink.deliverInstance(shaper.shape(CIMInstance(object)));
  });
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
    for (const Step& step : plan.steps()) {
      AssociatedObjects handler(buffer, [&](const CIMObject& object) {
        return plan.wantsResult(step, object.getClassName());
      });
      callProvider(buffer, [&] {
        associationProvider().associators(
            context, path, step.associationClass, request.filter.resultClass, request.filter.role,
            request.filter.resultRole, selection.includeQualifiers, selection.includeClassOrigin,
            selection.propertyList, handler);
      });
    }
    buffer.finish();
  });
}

OperationStatus Operations::associatorNames(const OperationContext& context,
                                            const AssociatorNamesRequest& request,
                                            ObjectPathSink& sink) const {
  return runOperation([&] {
    const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
    const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
    DeliveryBuffer<CIMObjectPath> buffer = placedPaths(request.nameSpace, sink);
    for (const Step& step : plan.steps()) {
      EnumeratedPaths handler(buffer, [&](const CIMObjectPath& result) {
        return plan.wantsResult(step, result.getClassName());
      });
      callProvider(buffer, [&] {
        associationProvider().associatorNames(context, path, step.associationClass,
                                              request.filter.resultClass, request.filter.role,
                                              request.filter.resultRole, handler);
      });
    }
    buffer.finish();
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
    for (const Step& step : plan.steps()) {
      AssociatedObjects handler(buffer, [&](const CIMObject& object) {
        return plan.wantsReference(object.getClassName());
      });
      callProvider(buffer, [&] {
        associationProvider().references(context, path, step.associationClass, request.filter.role,
                                         selection.includeQualifiers, selection.includeClassOrigin,
                                         selection.propertyList, handler);
      });
    }
    buffer.finish();
  });
}

OperationStatus Operations::referenceNames(const OperationContext& context,
                                           const ReferenceNamesRequest& request,
                                           ObjectPathSink& sink) const {
  return runOperation([&] {
    const AssociationPlan plan = planFor(request.nameSpace, request.objectName, request.filter);
    const CIMObjectPath path = providerPath(request.nameSpace, request.objectName);
    DeliveryBuffer<CIMObjectPath> buffer = placedPaths(request.nameSpace, sink);
    for (const Step& step : plan.steps()) {
      EnumeratedPaths handler(buffer, [&](const CIMObjectPath& result) {
        return plan.wantsReference(result.getClassName());
      });
      callProvider(buffer, [&] {
        associationProvider().referenceNames(context, path, step.associationClass,
                                             request.filter.role, handler);
      });
    }
    buffer.finish();
  });
}

AssociationPlan Operations::planFor(const CIMNamespaceName& nameSpace,
                                    const CIMObjectPath& objectName,
                                    const AssociationFilter& filter) const {
  const CIMName className = objectName.getClassName();
  requireClass(nameSpace, className);
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
