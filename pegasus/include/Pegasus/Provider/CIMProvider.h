// Base of all provider interfaces.
#pragma once

#include <Pegasus/Common/ResponseHandler.h>
#include <Pegasus/Provider/CIMOMHandle.h>
#include <Pegasus/Provider/ProviderException.h>

PEGASUS_NAMESPACE_BEGIN

/// What a server gets from a provider library; it finds the interfaces by dynamic_cast.
class PEGASUS_PROVIDER_LINKAGE CIMProvider {
 public:
  CIMProvider();
  virtual ~CIMProvider();
  /// Called once before the first operation. The handle outlives terminate().
  virtual void initialize(CIMOMHandle& cimom) = 0;
  /// The last call: the server touches the object no more, so it may delete itself.
  virtual void terminate() = 0;
};

PEGASUS_NAMESPACE_END
