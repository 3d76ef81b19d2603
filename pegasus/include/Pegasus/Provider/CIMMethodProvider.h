// The interface of providers of extrinsic methods.
#pragma once

#include <Pegasus/Provider/CIMProvider.h>

PEGASUS_NAMESPACE_BEGIN

/// Operations arrive on several threads. Errors are Exception, best CIMException.
class PEGASUS_PROVIDER_LINKAGE CIMMethodProvider : public virtual CIMProvider {
 public:
  CIMMethodProvider();
  ~CIMMethodProvider() override;
  /// Neither the method's name nor the parameters were checked by the server.
  virtual void invokeMethod(const OperationContext& context, const CIMObjectPath& objectReference,
                            const CIMName& methodName, const Array<CIMParamValue>& inParameters,
                            MethodResultResponseHandler& handler) = 0;
};

PEGASUS_NAMESPACE_END
