// The interface of providers of associations.
#pragma once

#include <Pegasus/Provider/CIMProvider.h>

PEGASUS_NAMESPACE_BEGIN

/// Operations arrive on several threads. Errors are Exception, best CIMException.
class PEGASUS_PROVIDER_LINKAGE CIMAssociationProvider : public virtual CIMProvider {
 public:
  CIMAssociationProvider();
  ~CIMAssociationProvider() override;
  virtual void associators(const OperationContext& context, const CIMObjectPath& objectName,
                           const CIMName& associationClass, const CIMName& resultClass,
                           const String& role, const String& resultRole,
                           const Boolean includeQualifiers, const Boolean includeClassOrigin,
                           const CIMPropertyList& propertyList, ObjectResponseHandler& handler) = 0;
  virtual void associatorNames(const OperationContext& context, const CIMObjectPath& objectName,
                               const CIMName& associationClass, const CIMName& resultClass,
                               const String& role, const String& resultRole,
                               ObjectPathResponseHandler& handler) = 0;
  virtual void references(const OperationContext& context, const CIMObjectPath& objectName,
                          const CIMName& resultClass, const String& role,
                          const Boolean includeQualifiers, const Boolean includeClassOrigin,
                          const CIMPropertyList& propertyList, ObjectResponseHandler& handler) = 0;
  virtual void referenceNames(const OperationContext& context, const CIMObjectPath& objectName,
                              const CIMName& resultClass, const String& role,
                              ObjectPathResponseHandler& handler) = 0;
};

PEGASUS_NAMESPACE_END
