// Operations that change something: instances and methods.

#include "cimhost/Operations.h"
#include "cimhost/ResponseHandlers.h"

namespace cimhost {

using namespace Pegasus;

namespace {

// Of an instance that a client sends: a property that its list does not name is not to be changed
// (DSP0200, ModifyInstance), and not every provider looks at the list.
CIMInstance listedPart(const CIMInstance& sent, const CIMPropertyList& propertyList) {
  if (propertyList.isNull()) return sent;
  CIMInstance listed = sent.clone();
  listed.instanceFilter(true, true, propertyList);
  return listed;
}

}  // namespace

OperationStatus Operations::modifyInstance(const OperationContext& context,
                                           const ModifyInstanceRequest& request) const {
  return runOperation([&] {
    const CIMObjectPath& name = request.instance.getPath();
    requireServed(request.nameSpace, name.getClassName());
    EmptyHandler handler;
    instanceProvider().modifyInstance(context, providerPath(request.nameSpace, name),
                                      listedPart(request.instance, request.propertyList),
                                      request.includeQualifiers, request.propertyList, handler);
  });
}

OperationStatus Operations::createInstance(const OperationContext& context,
                                           const CreateInstanceRequest& request,
                                           ObjectPathSink& sink) const {
  return runOperation([&] {
    const CIMObjectPath& name = request.instance.getPath();
    requireServed(request.nameSpace, name.getClassName());
    SinglePath handler;
    instanceProvider().createInstance(context, providerPath(request.nameSpace, name),
                                      request.instance, handler);
    CIMObjectPath created = handler.result();
    completePath(created, request.nameSpace, String());
    sink.deliverPath(created);
  });
}

OperationStatus Operations::deleteInstance(const OperationContext& context,
                                           const DeleteInstanceRequest& request) const {
  return runOperation([&] {
    requireServed(request.nameSpace, request.instanceName.getClassName());
    EmptyHandler handler;
    instanceProvider().deleteInstance(
        context, providerPath(request.nameSpace, request.instanceName), handler);
  });
}

OperationStatus Operations::invokeMethod(const OperationContext& context,
                                         const InvokeMethodRequest& request,
                                         MethodResultSink& sink) const {
  return runOperation([&] {
    requireMethod(request);
    MethodResultHandler handler;
    methodProvider().invokeMethod(context, providerPath(request.nameSpace, request.objectName),
                                  request.methodName, request.parameters, handler);
    sink.deliverMethodResult(handler.returnValue(), handler.parameters());
  });
}

// A class without a provider: nobody can change its instances.
void Operations::requireServed(const CIMNamespaceName& nameSpace, const CIMName& className) const {
  requireClass(nameSpace, className);
  if (served_.serves(nameSpace, className)) return;
  throw CIMException(CIM_ERR_NOT_SUPPORTED,
                     String("No provider serves class ") + className.getString());
}

void Operations::requireMethod(const InvokeMethodRequest& request) const {
  const CIMName className = request.objectName.getClassName();
  const CIMClass declaration =
      repository_.getClass(request.nameSpace, className, false, true, true, CIMPropertyList());
  if (served_.servesMethods(request.nameSpace, className)) return;
  const bool declared = declaration.findMethod(request.methodName) != PEG_NOT_FOUND;
  throw CIMException(declared ? CIM_ERR_METHOD_NOT_AVAILABLE : CIM_ERR_METHOD_NOT_FOUND,
                     request.methodName.getString());
}

}  // namespace cimhost
