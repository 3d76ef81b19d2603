#include "provider/ValueMap.h"

#include "diagnostics/debug.h"
#include "platform/StringConverters.h"

#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <algorithm>
#include <climits>
#include <cstdlib>

using namespace Pegasus;

namespace Vaneth {
namespace {

CIMProperty findMappingProperty(CIMClass& cimClass, const std::string& name) {
  CIMProperty property = cimClass.getProperty(cimClass.findProperty(CIMName(make_String(name))));
  debug(9, "Found valuemap property \n");
  if (debugEnabled(9)) {
    for (Uint32 i = 0; i < property.getQualifierCount(); ++i) {
      debugFormat(9, "Qualifier: %s\n",
                  make_string(property.getQualifier(i).getName().getString()).c_str());
    }
  }
  return property;
}

Array<String> textsOf(CIMProperty& property, const char* qualifier) {
  Array<String> texts;
  property.getQualifier(property.findQualifier(CIMName(qualifier))).getValue().get(texts);
  return texts;
}

Uint32 findText(const Array<String>& texts, const String& text) {
  for (Uint32 i = 0; i < texts.size(); ++i) {
    if (texts[i] == text) return i;
  }
  return PEG_NOT_FOUND;
}

}  // namespace

std::optional<String> valueMapText(CIMClass& cimClass, const std::string& property, int number) {
  CIMProperty mapping = findMappingProperty(cimClass, property);
  const Array<String> numbers = textsOf(mapping, "ValueMap");
  debug(9, "Found ValueMap Quarifier\n");
  const Uint32 position = findText(numbers, make_String(std::to_string(number)));
  if (position == PEG_NOT_FOUND) return std::nullopt;
  debug(9, "Found Value\n");
  const Array<String> texts = textsOf(mapping, "Values");
  debug(9, "Found Values Quarifier\n");
  return texts[position];
}

std::optional<int> valueMapNumber(CIMClass& cimClass, const std::string& property,
                                  const String& text) {
  CIMProperty mapping = findMappingProperty(cimClass, property);
  const Array<String> texts = textsOf(mapping, "Values");
  debug(9, "Found Values Quarifier\n");
  const Uint32 position = findText(texts, text);
  if (position != PEG_NOT_FOUND) debug(9, "Found Value\n");
  const Array<String> numbers = textsOf(mapping, "ValueMap");
  debug(9, "Found ValueMap Quarifier\n");
  if (position == PEG_NOT_FOUND) return std::nullopt;
  const long number = std::strtol(make_string(numbers[position]).c_str(), nullptr, 10);
  return static_cast<int>(std::clamp<long>(number, INT_MIN, INT_MAX));
}

}  // namespace Vaneth
