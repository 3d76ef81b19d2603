#include "association/ProviderDefAssociation.h"
#include "diagnostics/TraceLine.h"
#include "diagnostics/debug.h"
#include "engine/ProviderDefError.h"
#include "platform/StringConverters.h"
#include "provider/CimConversion.h"
#include "provider/CommonProvider.h"
#include "provider/InstanceBuilder.h"
#include "provider/SimpleInstanceResponseHandler.h"

#include <optional>

using namespace Pegasus;

namespace Vaneth {
namespace {

// A count that fails ends the request: the server has nothing but "unknown error" to tell, so the
// log says what it was.
int countInstances(const ProviderDefClass& definition) {
  try {
    return boundedNumberOfInstances(definition);
  } catch (const ProviderDefError& error) {
    debugFormat(1, "%s\n", error.getMessage().c_str());
    throw;
  }
}

void logDelivery(const CIMInstance& instance) {
  DEBUG_FORMAT(9, "delever instances: %s\n", make_string(instance.getPath().toString()).c_str());
}

}  // namespace

void CommonProvider::enumerateInstances(const OperationContext& context,
                                        const CIMObjectPath& classReference, const Boolean,
                                        const Boolean, const CIMPropertyList&,
                                        InstanceResponseHandler& handler) {
  const std::string className = make_string(classReference.getClassName().getString());
  const ProviderDefClass* definition = getProviderDefClass(className);
  DEBUG_FORMAT(8, "CommonProvider:enumerateInstances %s Entry\n", className.c_str());
  if (definition != nullptr) {
    debug(8, "CommonProvider:ProviderDefClass found\n");
    enumerateDefined(context, classReference, *definition, handler);
  }
  debug(9, "CommonProvider:End of ProviderDefClass process\n");
  const ProviderDefAssociation* association = getProviderDefAssociation(className);
  if (association != nullptr) {
    debug(9, "CommonProvider:ProviderDefAssociation found\n");
    enumerateAssociation(context, classReference, *association, handler);
  }
}

void CommonProvider::enumerateDefined(const OperationContext& context,
                                      const CIMObjectPath& classReference,
                                      const ProviderDefClass& definition,
                                      InstanceResponseHandler& handler) {
  handler.processing();
  const int count = countInstances(definition);
  for (int i = 0; i < count; ++i) {
    DEBUG_FORMAT(9, "CommonProvider: for each instance %d\n", i);
    // An instance that cannot be built is left out; the others are still delivered.
    std::optional<CIMInstance> instance;
    try {
      CIMClass cimClass = fetchClass(context, classReference);
      instance = buildInstance(definition, cimClass, classReference, i);
    } catch (const ProviderDefError& error) {
      // The text as it stands: the message goes to the log alone.
      TraceLine() << "ProviderDefError $s\n";
      debugFormat(1, "%s\n", error.getMessage().c_str());
    } catch (...) {
      debug(9, "Unknown exception\n");
    }
    if (!instance) continue;
    logDelivery(*instance);
    handler.deliver(*instance);
  }
  handler.complete();
}

void CommonProvider::enumerateAssociation(const OperationContext& context,
                                          const CIMObjectPath& classReference,
                                          const ProviderDefAssociation& association,
                                          InstanceResponseHandler& handler) {
  handler.processing();
  const CIMNamespaceName& nameSpace = classReference.getNameSpace();
  const auto enumerateSide = [&](const std::string& className) {
    Instances instances = enumerateAny(
        context, nameSpace, className,
        "enumerateInstances in CommonProvider:enumerateInstances " + className + " Entry\n");
    DEBUG_FORMAT(9, "Source Instances %s: %d\n", className.c_str(),
                 static_cast<int>(instances.size()));
    return instances;
  };
  for (const auto& [firstClass, secondClass] : association.getClassNamePairs()) {
    Instances first = enumerateSide(firstClass);
    Instances second = enumerateSide(secondClass);
    const auto firstProperties = association.getClassProperties(firstClass);
    const auto secondProperties = association.getClassProperties(secondClass);
    std::vector<std::vector<ProviderDefValue>> secondValues;
    secondValues.reserve(second.size());
    for (Uint32 k = 0; k < second.size(); ++k) {
      secondValues.push_back(getPropertyValues(second[k], secondProperties));
    }
    for (Uint32 j = 0; j < first.size(); ++j) {
      const auto related = association.getAssociation(firstClass, static_cast<int>(j),
                                                      getPropertyValues(first[j], firstProperties),
                                                      secondClass, secondValues);
      for (const int k : related) {
        // A defined class may count more instances than could be built.
        if (static_cast<Uint32>(k) >= second.size()) continue;
        const CIMInstance instance =
            buildAssociationInstance(context, classReference, association, first[j].getPath(),
                                     second[static_cast<Uint32>(k)].getPath());
        logDelivery(instance);
        handler.deliver(instance);
      }
    }
  }
  debug(9, "CommonProvider:End of ProviderDefAssociation process\n");
  handler.complete();
}

CIMInstance CommonProvider::buildAssociationInstance(const OperationContext& context,
                                                     const CIMObjectPath& classReference,
                                                     const ProviderDefAssociation& association,
                                                     const CIMObjectPath& first,
                                                     const CIMObjectPath& second) {
  CIMInstance instance(classReference.getClassName());
  CIMClass cimClass =
      cimom_->getClass(context, classReference.getNameSpace(), classReference.getClassName(), false,
                       true, false, CIMPropertyList());
  Array<CIMKeyBinding> keys;
  const auto addReference = [&](const std::string& name, const CIMObjectPath& path) {
    CIMProperty property = cimClass.getProperty(cimClass.findProperty(CIMName(make_String(name))));
    property.setValue(CIMValue(path));
    instance.addProperty(CIMProperty(property.getName(), property.getValue()));
    keys.append(CIMKeyBinding(property.getName(), property.getValue().toString(),
                              CIMKeyBinding::REFERENCE));
  };
  const auto [firstName, secondName] = association.getPropertyNamePair();
  addReference(firstName, first);
  addReference(secondName, second);
  instance.setPath(
      CIMObjectPath(String(), classReference.getNameSpace(), classReference.getClassName(), keys));
  return instance;
}

void CommonProvider::enumerateInstanceNames(const OperationContext& context,
                                            const CIMObjectPath& classReference,
                                            ObjectPathResponseHandler& handler) {
  handler.processing();
  SimpleInstanceResponseHandler collected;
  enumerateInstances(context, classReference, false, false, CIMPropertyList(), collected);
  for (Uint32 i = 0; i < collected.instances.size(); ++i) {
    handler.deliver(collected.instances[i].getPath());
  }
  handler.complete();
}

void CommonProvider::getInstance(const OperationContext& context,
                                 const CIMObjectPath& instanceReference,
                                 const Boolean includeQualifiers, const Boolean includeClassOrigin,
                                 const CIMPropertyList&, InstanceResponseHandler& handler) {
  handler.processing();
  SimpleInstanceResponseHandler collected;
  enumerateInstances(context, instanceReference, includeQualifiers, includeClassOrigin,
                     CIMPropertyList(), collected);
  const String& className = instanceReference.getClassName().getString();
  for (Uint32 i = 0; i < collected.instances.size(); ++i) {
    const CIMObjectPath& path = collected.instances[i].getPath();
    if (path.getClassName().getString() != className) continue;
    if (!compareBindings(path.getKeyBindings(), instanceReference.getKeyBindings())) continue;
    handler.deliver(collected.instances[i]);
    break;
  }
  handler.complete();
}

bool compareBindings(const Array<CIMKeyBinding>& a, const Array<CIMKeyBinding>& b) {
  if (a.size() != b.size()) return false;
  for (Uint32 k = 0; k < a.size(); ++k) {
    if (a[k].getType() != b[k].getType() || a[k].getName() != b[k].getName()) return false;
    if (a[k].getType() == CIMKeyBinding::REFERENCE) {
      const CIMObjectPath pathA(a[k].getValue());
      const CIMObjectPath pathB(b[k].getValue());
      if (!compareBindings(pathA.getKeyBindings(), pathB.getKeyBindings())) return false;
    } else if (!(a[k] == b[k])) {
      return false;
    }
  }
  return true;
}

}  // namespace Vaneth
