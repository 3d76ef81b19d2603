#include "association/ProviderDefAssociation.h"
#include "diagnostics/TraceLine.h"
#include "diagnostics/debug.h"
#include "platform/StringConverters.h"
#include "provider/CimConversion.h"
#include "provider/CommonProvider.h"
#include "provider/SimpleInstanceResponseHandler.h"
#include "provider/SimpleObjectPathResponseHandler.h"

#include <Pegasus/Common/CIMObject.h>

using namespace Pegasus;

namespace Vaneth {

void CommonProvider::associatorNames(const OperationContext& context,
                                     const CIMObjectPath& objectName,
                                     const CIMName& associationClass, const CIMName& resultClass,
                                     const String&, const String&,
                                     ObjectPathResponseHandler& handler) {
  TraceLine() << "CommonProvider::associatorNames Entry\n";
  const std::string objectClass = make_string(objectName.getClassName().getString());
  const std::string associationName = make_string(associationClass.getString());
  const std::string resultName = make_string(resultClass.getString());
  const auto candidates = getProviderDefAssociation(associationName, objectClass, resultName);
  const CIMObjectPath object = withoutPlace(objectName);
  DEBUG_FORMAT(7, "associatorNames : object: %s, association : %s, result : %s",
               make_string(object.toString()).c_str(), associationName.c_str(), resultName.c_str());
  if (candidates.empty()) {
    throw CIMException(CIM_ERR_NOT_SUPPORTED, String("CommonProvider::associatorNames"));
  }
  debug(8, "ProviderDefAssociation found\n");
  handler.processing();
  for (const ProviderDefAssociation* association : candidates) {
    const std::string targetClass =
        resultName.empty() ? association->getPair(objectClass) : resultName;
    deliverTargets(context, objectName.getNameSpace(), object, *association, objectClass,
                   targetClass, handler);
  }
  handler.complete();
  TraceLine() << "CommonProvider::associatorNames Exit\n";
}

void CommonProvider::deliverTargets(const OperationContext& context,
                                    const CIMNamespaceName& nameSpace, const CIMObjectPath& object,
                                    const ProviderDefAssociation& association,
                                    const std::string& objectClass, const std::string& targetClass,
                                    ObjectPathResponseHandler& handler) {
  DEBUG_FORMAT(8, "Result class is : %s", targetClass.c_str());
  const auto enumerateSide = [&](const std::string& className) {
    return enumerateAny(context, nameSpace, className,
                        "EnumerateInstances in associatorNames : object: " + className);
  };
  Instances sources = enumerateSide(objectClass);
  debug(8, "Source instances enumerated\n");
  Instances targets = enumerateSide(targetClass);
  debug(8, "Target instances enumerated\n");

  const auto targetProperties = association.getClassProperties(targetClass);
  std::vector<std::vector<ProviderDefValue>> targetValues;
  targetValues.reserve(targets.size());
  for (Uint32 t = 0; t < targets.size(); ++t) {
    targetValues.push_back(getPropertyValues(targets[t], targetProperties));
  }
  const auto sourceProperties = association.getClassProperties(objectClass);
  for (Uint32 s = 0; s < sources.size(); ++s) {
    if (withoutPlace(sources[s].getPath()) != object) continue;
    const auto related = association.getAssociation(objectClass, static_cast<int>(s),
                                                    getPropertyValues(sources[s], sourceProperties),
                                                    targetClass, targetValues);
    DEBUG_FORMAT(8, "Number of associated instance is : %d\n", static_cast<int>(related.size()));
    for (const int k : related) {
      // A defined class may count more instances than could be built.
      if (static_cast<Uint32>(k) >= targets.size()) continue;
      const CIMObjectPath& path = targets[static_cast<Uint32>(k)].getPath();
      TraceLine() << "Delivering Association names!!! " << make_string(path.toString()) << "\n";
      handler.deliver(path);
    }
  }
}

void CommonProvider::associators(const OperationContext& context, const CIMObjectPath& objectName,
                                 const CIMName& associationClass, const CIMName& resultClass,
                                 const String& role, const String& resultRole, const Boolean,
                                 const Boolean, const CIMPropertyList&,
                                 ObjectResponseHandler& handler) {
  TraceLine() << "associators\n";
  SimpleObjectPathResponseHandler names;
  associatorNames(context, objectName, associationClass, resultClass, role, resultRole, names);
  Array<CIMObject> objects;
  for (Uint32 i = 0; i < names.paths.size(); ++i) {
    const CIMObjectPath& path = names.paths[i];
    if (getProviderDefClass(make_string(path.getClassName().getString())) != nullptr) {
      SimpleInstanceResponseHandler found;
      getInstance(context, path, false, false, CIMPropertyList(), found);
      if (found.instances.size() != 0) objects.append(CIMObject(found.instances[0]));
    } else {
      objects.append(CIMObject(cimom_->getInstance(context, objectName.getNameSpace(), path, false,
                                                   true, true, CIMPropertyList())));
    }
  }
  handler.processing();
  for (Uint32 i = 0; i < objects.size(); ++i) handler.deliver(objects[i]);
  handler.complete();
}

}  // namespace Vaneth
