#include "cimhost/Operations.h"

#include "cimhost/ProviderCall.h"
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
      completePath(path, request.nameSpace, String());
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
    SingleInstance handler;
    const CIMObjectPath path = providerPath(request.nameSpace, request.instanceName);
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

void Operations::requireClass(const CIMNamespaceName& nameSpace, const CIMName& className,
                              CIMStatusCode missing) const {
  if (!repository_.hasNamespace(nameSpace)) {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, nameSpace.getString());
  }
  if (!repository_.hasClass(nameSpace, className)) {
    throw CIMException(missing, className.getString());
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

// Providers see the host's own name and the request's namespace, whatever the client wrote.
CIMObjectPath Operations::providerPath(const CIMNamespaceName& nameSpace,
                                       const CIMObjectPath& objectName) const {
  return CIMObjectPath(hostName_, nameSpace, objectName.getClassName(),
                       objectName.getKeyBindings());
}

// Without the interface a server would not have registered the provider for these requests.
template <class Interface>
Interface& Operations::provider(Interface* (ProviderLibrary::*interface)() const) const {
  if (!provider_.isLoaded()) throw CIMException(CIM_ERR_FAILED, "No provider is loaded.");
  Interface* found = (provider_.*interface)();
  if (found == nullptr) {
    throw CIMException(CIM_ERR_NOT_SUPPORTED, "The provider does not support the operation.");
  }
  return *found;
}

CIMInstanceProvider& Operations::instanceProvider() const {
  return provider(&ProviderLibrary::instances);
}

CIMAssociationProvider& Operations::associationProvider() const {
  return provider(&ProviderLibrary::associations);
}

CIMMethodProvider& Operations::methodProvider() const {
  return provider(&ProviderLibrary::methods);
}

// One class that fails fails the request.
template <class Object>
void Operations::callForEachTarget(const CIMNamespaceName& nameSpace, const CIMName& className,
                                   DeliveryBuffer<Object>& buffer, const TargetCall& call) const {
  for (const CIMName& target : servedTargets(nameSpace, className)) {
    const CIMObjectPath path(hostName_, nameSpace, target);
    callProvider(buffer, [&] { call(path); });
  }
}

OperationContext makeContext(const std::string& userName) {
  OperationContext context;
  context.insert(IdentityContainer(fromUtf8(toValidUtf8(userName))));
  return context;
}

}  // namespace cimhost
