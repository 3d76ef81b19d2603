#include "provider/InstanceBuilder.h"

#include "diagnostics/debug.h"
#include "platform/StringConverters.h"
#include "provider/CimConversion.h"
#include "provider/ValueMap.h"

#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMQualifier.h>

using namespace Pegasus;

namespace Vaneth {
namespace {

void setMappedText(CIMProperty& property, CIMClass& cimClass, const std::string& mappingProperty,
                   int number) {
  try {
    // A number that is not listed leaves the value as the class declared it.
    if (const auto text = valueMapText(cimClass, mappingProperty, number)) {
      property.setValue(CIMValue(*text));
    }
  } catch (...) {
    property.setValue(CIMValue(String("Unknown")));
  }
}

void setText(CIMProperty& property, const ProviderDefValue& value, int index) {
  std::string text = value.getStringValue();
  if (value.getType() == ProviderDefValue::kIndexString) text += " " + std::to_string(index);
  DEBUG_FORMAT(9, "Adding String property value:%s\n", text.c_str());
  property.setValue(CIMValue(make_String(text)));
}

void setValue(CIMProperty& property, CIMClass& cimClass, const ProviderDefProperty& definition,
              int index) {
  const bool isScalar = !property.isArray();
  ProviderDefValue value = definition.getValue(index);
  if (isScalar && property.getType() == CIMTYPE_STRING) {
    if (definition.getGetValuemap()) {
      setMappedText(property, cimClass, definition.getGetValuemapProperty(), value.getIntValue());
    } else {
      setText(property, value, index);
    }
    return;
  }
  if (isScalar && property.getType() == CIMTYPE_DATETIME) {
    // Evaluated once for the trace and once for the value: plug-ins see two calls.
    DEBUG_FORMAT(9, "DATE TIME: %s\n", value.getStringValue().c_str());
    value = definition.getValue(index);
  }
  property.setValue(toCimValue(value, property.getType(), property.isArray()));
}

// Read through a constant handle: asking for a changeable qualifier would copy the shared ones.
bool isKey(const CIMConstProperty& property) {
  Boolean key = false;
  property.getQualifier(property.findQualifier(CIMName("key"))).getValue().get(key);
  return key;
}

}  // namespace

CIMInstance buildInstance(const ProviderDefClass& definition, CIMClass& cimClass,
                          const CIMObjectPath& classPath, int index) {
  CIMInstance instance(classPath.getClassName());
  Array<CIMKeyBinding> keys;
  const Uint32 count = cimClass.getPropertyCount();
  DEBUG_FORMAT(9, "number of properties is %d\n", static_cast<int>(count));
  for (Uint32 j = 0; j < count; ++j) {
    DEBUG_FORMAT(9, "CommonProvider: for each property %d\n", static_cast<int>(j));
    // A handle: the value set on it stays in the fetched class, which goes with this instance.
    CIMProperty property = cimClass.getProperty(j);
    const CIMName& name = property.getName();
    const std::string text = make_string(name.getString());
    const ProviderDefProperty* defined = definition.getProperty(text);
    if (defined != nullptr) {
      DEBUG_FORMAT(9, "CommonProvider: ProviderDefProperty found %s\n", text.c_str());
      setValue(property, cimClass, *defined, index);
      const CIMValue& value = property.getValue();
      if (isKey(property)) {
        keys.append(CIMKeyBinding(name, value.toString(), keyBindingType(property.getType())));
      }
      instance.addProperty(CIMProperty(name, value));
    }
    DEBUG_FORMAT(9, "CommonProvider: end of a property process %s\n", text.c_str());
  }
  if (count != 0) {
    instance.setPath(
        CIMObjectPath(String(), classPath.getNameSpace(), classPath.getClassName(), keys));
  }
  return instance;
}

}  // namespace Vaneth
