// The provider's way back into the server.
#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObject.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/CIMPropertyList.h>
#include <Pegasus/Common/OperationContext.h>
#include <Pegasus/Common/ResponseHandler.h>

PEGASUS_NAMESPACE_BEGIN

class CIMOMHandleRep;

/// Reaches the host that was the process's embedded host when the handle was made.
///
/// All errors are CIMException: CIM_ERR_FAILED without a host, CIM_ERR_NOT_SUPPORTED for what the
/// embedded host does not offer (everything but the first three operations).
class PEGASUS_PROVIDER_LINKAGE CIMOMHandle {
 public:
  CIMOMHandle();

  /// Returns an object that the caller may change: nobody else sees it.
  CIMClass getClass(const OperationContext& context, const CIMNamespaceName& nameSpace,
                    const CIMName& className, Boolean localOnly, Boolean includeQualifiers,
                    Boolean includeClassOrigin, const CIMPropertyList& propertyList);
  CIMInstance getInstance(const OperationContext& context, const CIMNamespaceName& nameSpace,
                          const CIMObjectPath& instanceName, Boolean localOnly,
                          Boolean includeQualifiers, Boolean includeClassOrigin,
                          const CIMPropertyList& propertyList);
  Array<CIMInstance> enumerateInstances(const OperationContext& context,
                                        const CIMNamespaceName& nameSpace, const CIMName& className,
                                        Boolean deepInheritance, Boolean localOnly,
                                        Boolean includeQualifiers, Boolean includeClassOrigin,
                                        const CIMPropertyList& propertyList);

  Array<CIMObjectPath> enumerateInstanceNames(const OperationContext& context,
                                              const CIMNamespaceName& nameSpace,
                                              const CIMName& className);
  CIMObjectPath createInstance(const OperationContext& context, const CIMNamespaceName& nameSpace,
                               const CIMInstance& newInstance);
  void modifyInstance(const OperationContext& context, const CIMNamespaceName& nameSpace,
                      const CIMInstance& modifiedInstance, Boolean includeQualifiers,
                      const CIMPropertyList& propertyList);
  void deleteInstance(const OperationContext& context, const CIMNamespaceName& nameSpace,
                      const CIMObjectPath& instanceName);
  Array<CIMClass> enumerateClasses(const OperationContext& context,
                                   const CIMNamespaceName& nameSpace, const CIMName& className,
                                   Boolean deepInheritance, Boolean localOnly,
                                   Boolean includeQualifiers, Boolean includeClassOrigin);
  Array<CIMName> enumerateClassNames(const OperationContext& context,
                                     const CIMNamespaceName& nameSpace, const CIMName& className,
                                     Boolean deepInheritance);
  void createClass(const OperationContext& context, const CIMNamespaceName& nameSpace,
                   const CIMClass& newClass);
  void modifyClass(const OperationContext& context, const CIMNamespaceName& nameSpace,
                   const CIMClass& modifiedClass);
  void deleteClass(const OperationContext& context, const CIMNamespaceName& nameSpace,
                   const CIMName& className);
  CIMValue invokeMethod(const OperationContext& context, const CIMNamespaceName& nameSpace,
                        const CIMObjectPath& instanceName, const CIMName& methodName,
                        const Array<CIMParamValue>& inParameters,
                        Array<CIMParamValue>& outParameters);
  /// The embedded host unloads no provider between operations: both do nothing.
  void disallowProviderUnload();
  void allowProviderUnload();

 private:
  CIMOMHandleRep& rep() const;

  CIMOMHandleRep* rep_;
};

PEGASUS_NAMESPACE_END
