#include "cimhost/EmbeddedCimom.h"

#include "cimhost/Text.h"

namespace cimhost {

using namespace Pegasus;

namespace {

thread_local int currentDepth = 0;

class DepthGuard {
 public:
  DepthGuard() {
    if (currentDepth >= EmbeddedCimom::kMaximumDepth) {
      throw CIMException(CIM_ERR_FAILED, "Too many requests of the provider inside each other.");
    }
    ++currentDepth;
  }
  ~DepthGuard() { --currentDepth; }
  DepthGuard(const DepthGuard&) = delete;
  DepthGuard& operator=(const DepthGuard&) = delete;
};

class CollectingSink final : public InstanceSink {
 public:
  // The caller may change what it gets, and the delivered object may be the provider's own.
  bool deliverInstance(const CIMInstance& instance) override {
    instances.append(instance.clone());
    return true;
  }

  Array<CIMInstance> instances;
};

void throwUnlessOk(const OperationStatus& status) {
  if (!status.ok()) throw CIMException(status.code, fromUtf8(status.message));
}

}  // namespace

EmbeddedCimom::EmbeddedCimom(const ClassRepository& repository, const Operations& operations)
    : repository_(repository), operations_(operations) {}

CIMClass EmbeddedCimom::getClass(const OperationContext&, const CIMNamespaceName& nameSpace,
                                 const CIMName& className, Boolean localOnly,
                                 Boolean includeQualifiers, Boolean includeClassOrigin,
                                 const CIMPropertyList& propertyList) {
  return repository_.getClass(nameSpace, className, localOnly, includeQualifiers,
                              includeClassOrigin, propertyList);
}

CIMInstance EmbeddedCimom::getInstance(const OperationContext& context,
                                       const CIMNamespaceName& nameSpace,
                                       const CIMObjectPath& instanceName, Boolean,
                                       Boolean includeQualifiers, Boolean includeClassOrigin,
                                       const CIMPropertyList& propertyList) {
  const DepthGuard guard;
  GetInstanceRequest request;
  request.nameSpace = nameSpace;
  request.instanceName = instanceName;
  request.selection = {true, false, includeQualifiers, includeClassOrigin, propertyList};
  CollectingSink sink;
  throwUnlessOk(operations_.getInstance(context, request, sink));
  return sink.instances[0];
}

Array<CIMInstance> EmbeddedCimom::enumerateInstances(
    const OperationContext& context, const CIMNamespaceName& nameSpace, const CIMName& className,
    Boolean deepInheritance, Boolean, Boolean includeQualifiers, Boolean includeClassOrigin,
    const CIMPropertyList& propertyList) {
  const DepthGuard guard;
  EnumerateInstancesRequest request;
  request.nameSpace = nameSpace;
  request.className = className;
  request.selection = {deepInheritance, false, includeQualifiers, includeClassOrigin, propertyList};
  CollectingSink sink;
  throwUnlessOk(operations_.enumerateInstances(context, request, sink));
  return sink.instances;
}

}  // namespace cimhost
