#include "cimhost/Operations.h"

#include "cimhost/ResponseHandlers.h"
#include "cimhost/Text.h"

#include <unistd.h>

#include <array>

namespace cimhost {

using namespace Pegasus;

namespace {

// A name that an object path refuses as a host is of no use to providers.
String findHostName() {
  std::array<char, 256> name{};
  if (gethostname(name.data(), name.size() - 1) != 0) return "localhost";
  try {
    CIMObjectPath().setHost(String(name.data()));
    return name[0] != '\0' ? String(name.data()) : String("localhost");
  } catch (const Exception&) {
    return "localhost";
  }
}

}  // namespace

Operations::Operations(const ClassRepository& repository, const ServedClasses& served,
                       const ProviderLibrary& provider)
    : repository_(repository), served_(served), provider_(provider), hostName_(findHostName()) {}

OperationStatus Operations::enumerateInstances(const OperationContext& context,
                                               const EnumerateInstancesRequest& request,
                                               InstanceSink& sink) const {
  return runOperation([&] {
    requireClass(request.nameSpace, request.className);
    InstanceShaper shaper(repository_, request.nameSpace, request.className, request.selection);
    DeliveryBuffer<CIMInstance> buffer(
        [&](const CIMInstance& instance) { return sink.deliverInstance(shaper.shape(instance)); });
    callForEachTarget(request.nameSpace, request.className, buffer, [&](const CIMObjectPath& path) {
      EnumeratedInstances handler(buffer);
      instanceProvider().enumerateInstances(context, path, request.selection.includeQualifiers,
                                            request.selection.includeClassOrigin,
                                            request.selection.propertyList, handler);
    });
    buffer.finish();
  });
}

OperationStatus Operations::enumerateInstanceNames(const OperationContext& context,
                                                   const EnumerateInstanceNamesRequest& request,
                                                   ObjectPathSink& sink) const {
  return runOperation([&] {
    requireClass(request.nameSpace, request.className);
    DeliveryBuffer<CIMObjectPath> buffer([&](const CIMObjectPath& delivered) {
      CIMObjectPath path = delivered;
      if (path.getNameSpace().isNull()) path.setNameSpace(request.nameSpace);
      return sink.deliverPath(path);
    });
    callForEachTarget(request.nameSpace, request.className, buffer, [&](const CIMObjectPath& path) {
      EnumeratedPaths handler(buffer);
      instanceProvider().enumerateInstanceNames(context, path, handler);
    });
    buffer.finish();
  });
}

OperationStatus Operations::getInstance(const OperationContext& context,
                                        const GetInstanceRequest& request,
                                        InstanceSink& sink) const {
  return runOperation([&] {
    const CIMName className = request.instanceName.getClassName();
    requireClass(request.nameSpace, className);
    if (!served_.serves(request.nameSpace, className)) {
      throw CIMException(CIM_ERR_NOT_FOUND, request.instanceName.toString());
    }
    const CIMObjectPath path(hostName_, request.nameSpace, className,
                             request.instanceName.getKeyBindings());
    SingleInstanceHandler handler;
    instanceProvider().getInstance(context, path, request.selection.includeQualifiers,
                                   request.selection.includeClassOrigin,
                                   request.selection.propertyList, handler);
    InstanceSelection selection = request.selection;
    selection.deepInheritance = true;
    InstanceShaper shaper(repository_, request.nameSpace, className, selection);
    sink.deliverInstance(shaper.shape(handler.result()));
  });
}

OperationStatus Operations::getClass(const GetClassRequest& request, ClassSink& sink) const {
  return runOperation([&] {
    sink.deliverClass(repository_.getClass(request.nameSpace, request.className, request.localOnly,
                                           request.includeQualifiers, request.includeClassOrigin,
                                           request.propertyList));
  });
}

OperationStatus Operations::enumerateClasses(const EnumerateClassesRequest& request,
                                             ClassSink& sink) const {
  return runOperation([&] {
    for (const CIMName& name :
         subclasses(request.nameSpace, request.className, request.deepInheritance)) {
      const CIMClass declaration = repository_.getClass(
          request.nameSpace, name, request.localOnly, request.includeQualifiers,
          request.includeClassOrigin, CIMPropertyList());
      if (!sink.deliverClass(declaration)) return;
    }
  });
}

OperationStatus Operations::enumerateClassNames(const EnumerateClassNamesRequest& request,
                                                ClassNameSink& sink) const {
  return runOperation([&] {
    for (const CIMName& name :
         subclasses(request.nameSpace, request.className, request.deepInheritance)) {
      if (!sink.deliverClassName(name)) return;
    }
  });
}

void Operations::requireClass(const CIMNamespaceName& nameSpace, const CIMName& className) const {
  if (!repository_.hasNamespace(nameSpace)) {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, nameSpace.getString());
  }
  if (!repository_.hasClass(nameSpace, className)) {
    throw CIMException(CIM_ERR_INVALID_CLASS, className.getString());
  }
}

// The requested class keeps the client's spelling, which is what providers get to see.
std::vector<CIMName> Operations::servedTargets(const CIMNamespaceName& nameSpace,
                                               const CIMName& className) const {
  std::vector<CIMName> targets;
  if (served_.serves(nameSpace, className)) targets.push_back(className);
  for (const CIMName& name : repository_.subclassNames(nameSpace, className, true)) {
    if (served_.serves(nameSpace, name)) targets.push_back(name);
  }
  return targets;
}

std::vector<CIMName> Operations::subclasses(const CIMNamespaceName& nameSpace,
                                            const CIMName& className, bool deep) const {
  if (!className.isNull()) {
    requireClass(nameSpace, className);
  } else if (!repository_.hasNamespace(nameSpace)) {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, nameSpace.getString());
  }
  return repository_.subclassNames(nameSpace, className, deep);
}

CIMInstanceProvider& Operations::instanceProvider() const {
  if (!provider_.isLoaded()) throw CIMException(CIM_ERR_FAILED, "No provider is loaded.");
  if (provider_.instances() == nullptr) {
    throw CIMException(CIM_ERR_NOT_SUPPORTED, "The provider serves no instances.");
  }
  return *provider_.instances();
}

// One class that fails fails the request. Not-supported alone counts as an empty answer: the
// server's own empty answer stands beside each provider's.
template <class Object>
void Operations::callForEachTarget(const CIMNamespaceName& nameSpace, const CIMName& className,
                                   DeliveryBuffer<Object>& buffer, const ProviderCall& call) const {
  for (const CIMName& target : servedTargets(nameSpace, className)) {
    const CIMObjectPath path(hostName_, nameSpace, target);
    const OperationStatus status = runOperation([&] { call(path); });
    if (status.code == CIM_ERR_NOT_SUPPORTED) {
      buffer.abandonCall();
      continue;
    }
    if (!status.ok()) {
      buffer.discard();
      throw CIMException(status.code, fromUtf8(status.message));
    }
    buffer.endCall();
  }
}

OperationContext makeContext(const std::string& userName) {
  OperationContext context;
  context.insert(IdentityContainer(fromUtf8(toValidUtf8(userName))));
  return context;
}

}  // namespace cimhost
