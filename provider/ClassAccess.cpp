// What the operations share: the server's class, the instances of a class, an instance's place.

#include "diagnostics/debug.h"
#include "platform/StringConverters.h"
#include "provider/CommonProvider.h"
#include "provider/SimpleInstanceResponseHandler.h"

using namespace Pegasus;

namespace Vaneth {

CIMObjectPath withoutPlace(const CIMObjectPath& path) {
  return CIMObjectPath(String(), CIMNamespaceName(), path.getClassName(), path.getKeyBindings());
}

CIMClass CommonProvider::fetchClass(const OperationContext& context, const CIMObjectPath& path) {
  DEBUG_FORMAT(9, "getClass - ns:%s, classname:%s\n",
               make_string(path.getNameSpace().getString()).c_str(),
               make_string(path.getClassName().getString()).c_str());
  return cimom_->getClass(context, path.getNameSpace(), path.getClassName(), false, true, true,
                          CIMPropertyList());
}

CommonProvider::Instances CommonProvider::enumerateOwn(const OperationContext& context,
                                                       const CIMNamespaceName& nameSpace,
                                                       const CIMName& className,
                                                       bool includeQualifiers,
                                                       bool includeClassOrigin) {
  SimpleInstanceResponseHandler collected;
  enumerateInstances(context, CIMObjectPath(String(), nameSpace, className), includeQualifiers,
                     includeClassOrigin, CIMPropertyList(), collected);
  return collected.instances;
}

CommonProvider::Instances CommonProvider::enumerateAny(const OperationContext& context,
                                                       const CIMNamespaceName& nameSpace,
                                                       const std::string& className,
                                                       const std::string& trace) {
  const CIMName name(make_String(className));
  if (getProviderDefClass(className) != nullptr) {
    return enumerateOwn(context, nameSpace, name, true, true);
  }
  debug(7, trace.c_str());
  return cimom_->enumerateInstances(context, nameSpace, name, true, false, true, true,
                                    CIMPropertyList());
}

CommonProvider::Place CommonProvider::findPlace(const OperationContext& context,
                                                const CIMObjectPath& reference) {
  const Instances instances =
      enumerateOwn(context, reference.getNameSpace(), reference.getClassName(), true, true);
  const CIMObjectPath wanted = withoutPlace(reference);
  for (Uint32 i = 0; i < instances.size(); ++i) {
    if (withoutPlace(instances[i].getPath()) == wanted) return {true, static_cast<int>(i)};
  }
  return {false, static_cast<int>(instances.size())};
}

}  // namespace Vaneth
