#include "diagnostics/debug.h"
#include "engine/ProviderDefError.h"
#include "platform/StringConverters.h"
#include "provider/CimConversion.h"
#include "provider/CommonProvider.h"
#include "provider/ValueMap.h"

#include <optional>

using namespace Pegasus;

namespace Vaneth {
namespace {

// The value to write, read as the type that the class declares, whatever type was sent; none for a
// null value and for a text that the mapping does not have.
std::optional<ProviderDefValue> valueToWrite(const CIMConstProperty& sent, CIMProperty& declared,
                                             CIMClass& cimClass,
                                             const ProviderDefProperty& definition) {
  const CIMValue& value = sent.getValue();
  if (value.isNull()) return std::nullopt;
  const bool isText = declared.getType() == CIMTYPE_STRING && !declared.isArray();
  if (!isText || !definition.getGetValuemap()) {
    return fromCimValue(value, declared.getType(), declared.isArray());
  }
  String text;
  value.get(text);
  const auto number = valueMapNumber(cimClass, definition.getGetValuemapProperty(), text);
  if (!number) return std::nullopt;
  return ProviderDefValue(*number);
}

}  // namespace

void CommonProvider::modifyInstance(const OperationContext& context,
                                    const CIMObjectPath& instanceReference,
                                    const CIMInstance& instanceObject, const Boolean,
                                    const CIMPropertyList&, ResponseHandler& handler) {
  const std::string className = make_string(instanceReference.getClassName().getString());
  DEBUG_FORMAT(8, "CommonProvider:modifyInstances %s Entry\n", className.c_str());
  const ProviderDefClass* definition = getProviderDefClass(className);
  if (definition == nullptr) {
    handler.complete();
    return;
  }
  handler.processing();
  const Place place = findPlace(context, instanceReference);
  if (place.found) {
    CIMClass cimClass = fetchClass(context, instanceReference);
    DEBUG_FORMAT(9, "number of properties is %d\n", static_cast<int>(cimClass.getPropertyCount()));
    for (Uint32 j = 0; j < cimClass.getPropertyCount(); ++j) {
      DEBUG_FORMAT(9, "CommonProvider: for each property %d\n", static_cast<int>(j));
      writeProperty(*definition, cimClass, j, instanceObject, place.index);
    }
  }
  handler.complete();
}

void CommonProvider::writeProperty(const ProviderDefClass& definition, CIMClass& cimClass,
                                   Uint32 position, const CIMInstance& sent, int index) {
  try {
    CIMProperty declared = cimClass.getProperty(position);
    const ProviderDefProperty* defined =
        definition.getProperty(make_string(declared.getName().getString()));
    if (defined == nullptr) return;
    DEBUG_FORMAT(9, "CommonProvider: ProviderDefProperty found %s\n", defined->getName().c_str());
    const Uint32 found = sent.findProperty(declared.getName());
    if (found == PEG_NOT_FOUND) return;
    const auto value = valueToWrite(sent.getProperty(found), declared, cimClass, *defined);
    if (value) defined->setValue(*value, index);
  } catch (const ProviderDefError& error) {
    debugFormat(1, "%s\n", error.getMessage().c_str());
  } catch (...) {
    // A value of another type than the class declares: the property is left out.
  }
}

}  // namespace Vaneth
