// The sinks into which a provider delivers its results.
#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMIndication.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMObject.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/CIMParameter.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMPropertyList.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Common/OperationContext.h>

PEGASUS_NAMESPACE_BEGIN

/// Base of all handlers. The caller of an operation owns its handler; a provider calls processing()
/// first, then the deliver functions, then complete().
class PEGASUS_COMMON_LINKAGE ResponseHandler {
 public:
  virtual ~ResponseHandler();
  virtual void processing() = 0;
  virtual void complete() = 0;
  void setContext(const OperationContext& context);

 protected:
  ResponseHandler();
  ResponseHandler(const ResponseHandler& handler);
  ResponseHandler& operator=(const ResponseHandler& handler);
  OperationContext getContext() const;

 private:
  OperationContext context_;
};

/// A delivered instance is kept as the same object, so a later change shows in the response.
class PEGASUS_COMMON_LINKAGE InstanceResponseHandler : virtual public ResponseHandler {
 public:
  ~InstanceResponseHandler() override;
  virtual void deliver(const CIMInstance& instance) = 0;
  virtual void deliver(const Array<CIMInstance>& instances) = 0;

 protected:
  InstanceResponseHandler();
  InstanceResponseHandler(const InstanceResponseHandler& handler);
  InstanceResponseHandler& operator=(const InstanceResponseHandler& handler);
};

class PEGASUS_COMMON_LINKAGE ObjectPathResponseHandler : virtual public ResponseHandler {
 public:
  ~ObjectPathResponseHandler() override;
  virtual void deliver(const CIMObjectPath& objectPath) = 0;
  virtual void deliver(const Array<CIMObjectPath>& objectPaths) = 0;

 protected:
  ObjectPathResponseHandler();
  ObjectPathResponseHandler(const ObjectPathResponseHandler& handler);
  ObjectPathResponseHandler& operator=(const ObjectPathResponseHandler& handler);
};

class PEGASUS_COMMON_LINKAGE ObjectResponseHandler : virtual public ResponseHandler {
 public:
  ~ObjectResponseHandler() override;
  virtual void deliver(const CIMObject& object) = 0;
  virtual void deliver(const Array<CIMObject>& objects) = 0;

 protected:
  ObjectResponseHandler();
  ObjectResponseHandler(const ObjectResponseHandler& handler);
  ObjectResponseHandler& operator=(const ObjectResponseHandler& handler);
};

class PEGASUS_COMMON_LINKAGE MethodResultResponseHandler : virtual public ResponseHandler {
 public:
  ~MethodResultResponseHandler() override;
  virtual void deliverParamValue(const CIMParamValue& paramValue) = 0;
  virtual void deliverParamValue(const Array<CIMParamValue>& paramValues) = 0;
  virtual void deliver(const CIMValue& returnValue) = 0;

 protected:
  MethodResultResponseHandler();
  MethodResultResponseHandler(const MethodResultResponseHandler& handler);
  MethodResultResponseHandler& operator=(const MethodResultResponseHandler& handler);
};

PEGASUS_NAMESPACE_END
