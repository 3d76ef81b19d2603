#include <Pegasus/Embedded/CIMOMHandleRep.h>
#include <Pegasus/Provider/CIMOMHandle.h>

#include <atomic>

PEGASUS_NAMESPACE_BEGIN

namespace {

std::atomic<CIMOMHandleRep*> embeddedHost{nullptr};

[[noreturn]] void throwNotSupported(const char* operation) {
  throw CIMException(CIM_ERR_NOT_SUPPORTED, String("CIMOMHandle::") + String(operation));
}

}  // namespace

CIMOMHandleRep::CIMOMHandleRep() = default;
CIMOMHandleRep::~CIMOMHandleRep() = default;

void setEmbeddedHost(CIMOMHandleRep* rep) {
  embeddedHost.store(rep);
}

CIMOMHandle::CIMOMHandle() : rep_(embeddedHost.load()) {}

CIMOMHandleRep& CIMOMHandle::rep() const {
  if (!rep_) throw CIMException(CIM_ERR_FAILED, String("No CIM server in this process."));
  return *rep_;
}

CIMClass CIMOMHandle::getClass(const OperationContext& context, const CIMNamespaceName& nameSpace,
                               const CIMName& className, Boolean localOnly,
                               Boolean includeQualifiers, Boolean includeClassOrigin,
                               const CIMPropertyList& propertyList) {
  return rep().getClass(context, nameSpace, className, localOnly, includeQualifiers,
                        includeClassOrigin, propertyList);
}

CIMInstance CIMOMHandle::getInstance(const OperationContext& context,
                                     const CIMNamespaceName& nameSpace,
                                     const CIMObjectPath& instanceName, Boolean localOnly,
                                     Boolean includeQualifiers, Boolean includeClassOrigin,
                                     const CIMPropertyList& propertyList) {
  return rep().getInstance(context, nameSpace, instanceName, localOnly, includeQualifiers,
                           includeClassOrigin, propertyList);
}

Array<CIMInstance> CIMOMHandle::enumerateInstances(
    const OperationContext& context, const CIMNamespaceName& nameSpace, const CIMName& className,
    Boolean deepInheritance, Boolean localOnly, Boolean includeQualifiers,
    Boolean includeClassOrigin, const CIMPropertyList& propertyList) {
  return rep().enumerateInstances(context, nameSpace, className, deepInheritance, localOnly,
                                  includeQualifiers, includeClassOrigin, propertyList);
}

Array<CIMObjectPath> CIMOMHandle::enumerateInstanceNames(const OperationContext&,
                                                         const CIMNamespaceName&, const CIMName&) {
  rep();
  throwNotSupported("enumerateInstanceNames");
}

CIMObjectPath CIMOMHandle::createInstance(const OperationContext&, const CIMNamespaceName&,
                                          const CIMInstance&) {
  rep();
  throwNotSupported("createInstance");
}

void CIMOMHandle::modifyInstance(const OperationContext&, const CIMNamespaceName&,
                                 const CIMInstance&, Boolean, const CIMPropertyList&) {
  rep();
  throwNotSupported("modifyInstance");
}

void CIMOMHandle::deleteInstance(const OperationContext&, const CIMNamespaceName&,
                                 const CIMObjectPath&) {
  rep();
  throwNotSupported("deleteInstance");
}

Array<CIMClass> CIMOMHandle::enumerateClasses(const OperationContext&, const CIMNamespaceName&,
                                              const CIMName&, Boolean, Boolean, Boolean, Boolean) {
  rep();
  throwNotSupported("enumerateClasses");
}

Array<CIMName> CIMOMHandle::enumerateClassNames(const OperationContext&, const CIMNamespaceName&,
                                                const CIMName&, Boolean) {
  rep();
  throwNotSupported("enumerateClassNames");
}

void CIMOMHandle::createClass(const OperationContext&, const CIMNamespaceName&, const CIMClass&) {
  rep();
  throwNotSupported("createClass");
}

void CIMOMHandle::modifyClass(const OperationContext&, const CIMNamespaceName&, const CIMClass&) {
  rep();
  throwNotSupported("modifyClass");
}

void CIMOMHandle::deleteClass(const OperationContext&, const CIMNamespaceName&, const CIMName&) {
  rep();
  throwNotSupported("deleteClass");
}

CIMValue CIMOMHandle::invokeMethod(const OperationContext&, const CIMNamespaceName&,
                                   const CIMObjectPath&, const CIMName&,
                                   const Array<CIMParamValue>&, Array<CIMParamValue>&) {
  rep();
  throwNotSupported("invokeMethod");
}

void CIMOMHandle::disallowProviderUnload() {}
void CIMOMHandle::allowProviderUnload() {}

PEGASUS_NAMESPACE_END
