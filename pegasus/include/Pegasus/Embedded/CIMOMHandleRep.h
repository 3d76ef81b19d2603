#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMPropertyList.h>
#include <Pegasus/Common/OperationContext.h>

PEGASUS_NAMESPACE_BEGIN

/// What a host implements so that CIMOMHandle reaches it. Embedded API only: providers never see
/// it.
///
/// Every member may be called from several threads at once. Errors are CIMException. getClass
/// returns an object that the caller may change without anybody else seeing it.
class PEGASUS_COMMON_LINKAGE CIMOMHandleRep {
 public:
  CIMOMHandleRep();
  virtual ~CIMOMHandleRep();
  CIMOMHandleRep(const CIMOMHandleRep&) = delete;
  CIMOMHandleRep& operator=(const CIMOMHandleRep&) = delete;

  virtual CIMClass getClass(const OperationContext& context, const CIMNamespaceName& nameSpace,
                            const CIMName& className, Boolean localOnly, Boolean includeQualifiers,
                            Boolean includeClassOrigin, const CIMPropertyList& propertyList) = 0;
  virtual CIMInstance getInstance(const OperationContext& context,
                                  const CIMNamespaceName& nameSpace,
                                  const CIMObjectPath& instanceName, Boolean localOnly,
                                  Boolean includeQualifiers, Boolean includeClassOrigin,
                                  const CIMPropertyList& propertyList) = 0;
  virtual Array<CIMInstance> enumerateInstances(const OperationContext& context,
                                                const CIMNamespaceName& nameSpace,
                                                const CIMName& className, Boolean deepInheritance,
                                                Boolean localOnly, Boolean includeQualifiers,
                                                Boolean includeClassOrigin,
                                                const CIMPropertyList& propertyList) = 0;
};

/// Makes `rep` the host that every CIMOMHandle constructed from now on reaches; nullptr detaches.
/// Not owned: it must outlive the handles. Takes effect at once in the whole process.
PEGASUS_COMMON_LINKAGE void setEmbeddedHost(CIMOMHandleRep* rep);

PEGASUS_NAMESPACE_END
