#include "provider/CimConversion.h"

#include "diagnostics/debug.h"
#include "engine/ProviderDefArgument.h"
#include "platform/StringConverters.h"
#include "provider/CimTypes.h"

#include <climits>
#include <cstdint>

using namespace Pegasus;

namespace Vaneth {
namespace {

template <class T>
T numberTo(long number) {
  if constexpr (std::is_same_v<T, Boolean>) {
    return number != 0;
  } else if constexpr (std::is_same_v<T, Char16>) {
    return Char16(static_cast<Uint16>(number));
  } else {
    return static_cast<T>(number);
  }
}

template <class T>
T textTo(const std::string& text) {
  return T(make_String(text));
}

int saturated(double real) {
  if (real != real) return 0;
  if (real >= static_cast<double>(INT_MAX)) return INT_MAX;
  if (real <= static_cast<double>(INT_MIN)) return INT_MIN;
  return static_cast<int>(real);
}

template <class T>
int numberFrom(const T& value) {
  if constexpr (std::is_floating_point_v<T>) {
    return saturated(static_cast<double>(value));
  } else if constexpr (std::is_same_v<T, Char16>) {
    return static_cast<Uint16>(value);
  } else {
    // Keeps the low 32 bits, as a bit pattern.
    return static_cast<int>(static_cast<std::uint32_t>(value));
  }
}

template <class T>
std::string textFrom(const T& value) {
  if constexpr (std::is_same_v<T, String>) {
    return make_string(value);
  } else {
    return make_string(value.toString());
  }
}

template <class T>
CIMValue scalarTo(const ProviderDefValue& value) {
  if constexpr (kIsText<T>) {
    return CIMValue(textTo<T>(value.getStringValue()));
  } else {
    constexpr bool takesLong = sizeof(T) == 8 && std::is_integral_v<T>;
    return CIMValue(numberTo<T>(takesLong ? value.getLongValue() : value.getIntValue()));
  }
}

template <class T>
CIMValue arrayTo(const ProviderDefValue& value) {
  Array<T> elements;
  if constexpr (kIsText<T>) {
    for (const std::string& text : value.getStringArray()) elements.append(textTo<T>(text));
  } else {
    for (const int number : value.getIntArray()) elements.append(numberTo<T>(number));
  }
  return CIMValue(elements);
}

template <class T>
ProviderDefValue scalarFrom(const CIMValue& value) {
  T content{};  // a null value leaves it as it is
  value.get(content);
  if constexpr (kIsText<T>) {
    return ProviderDefValue(textFrom(content));
  } else {
    return ProviderDefValue(numberFrom(content));
  }
}

template <class T>
ProviderDefValue arrayFrom(const CIMValue& value) {
  Array<T> content;
  value.get(content);
  if constexpr (kIsText<T>) {
    std::vector<std::string> texts;
    for (Uint32 i = 0; i < content.size(); ++i) texts.push_back(textFrom(T(content[i])));
    return ProviderDefValue(std::move(texts));
  } else {
    std::vector<int> numbers;
    for (Uint32 i = 0; i < content.size(); ++i) numbers.push_back(numberFrom(T(content[i])));
    return ProviderDefValue(std::move(numbers));
  }
}

}  // namespace

CIMValue toCimValue(const ProviderDefValue& value, CIMType type, bool isArray) {
  return visitCimType<CIMValue>(type, [&](auto tag) {
    using T = typename decltype(tag)::Type;
    return isArray ? arrayTo<T>(value) : scalarTo<T>(value);
  });
}

ProviderDefValue fromCimValue(const CIMValue& value, CIMType type, bool isArray) {
  return visitCimType<ProviderDefValue>(type, [&](auto tag) {
    using T = typename decltype(tag)::Type;
    return isArray ? arrayFrom<T>(value) : scalarFrom<T>(value);
  });
}

CIMKeyBinding::Type keyBindingType(CIMType type) {
  switch (type) {
    case CIMTYPE_BOOLEAN:
      return CIMKeyBinding::BOOLEAN;
    case CIMTYPE_CHAR16:
    case CIMTYPE_STRING:
    case CIMTYPE_DATETIME:
      return CIMKeyBinding::STRING;
    case CIMTYPE_REFERENCE:
      return CIMKeyBinding::REFERENCE;
    default:
      return CIMKeyBinding::NUMERIC;
  }
}

ProviderDefValue getPropertyValue(CIMProperty property) {
  DEBUG_FORMAT(8, "getPropertyValue : Class %s, Value %s\n",
               make_string(property.getName().getString()).c_str(),
               make_string(property.getValue().toString()).c_str());
  return fromCimValue(property.getValue(), property.getType(), property.isArray());
}

std::vector<ProviderDefValue> getPropertyValues(CIMInstance& instance,
                                                const std::vector<std::string>& names) {
  std::vector<ProviderDefValue> values;
  values.reserve(names.size());
  for (const std::string& name : names) {
    DEBUG_FORMAT(8, "getPropertyValues: Property - %s\n", name.c_str());
    const Uint32 position = instance.findProperty(CIMName(make_String(name)));
    values.push_back(position == PEG_NOT_FOUND ? ProviderDefValue()
                                               : getPropertyValue(instance.getProperty(position)));
  }
  return values;
}

}  // namespace Vaneth

// A fixed placeholder: no query is looked up, whatever its text.
ProviderDefValue getCimProperty(const std::string&) {
  return ProviderDefValue(0);
}
