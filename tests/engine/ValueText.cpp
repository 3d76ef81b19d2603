#include "tests/engine/ValueText.h"

#include <ostream>
#include <sstream>

const Values& oneOfEachType() {
  static const Values values = [] {
    ProviderDefValue indexString("index");
    indexString.setIndexStringType();
    return Values{7, "seven", Ints{7}, Texts{"seven"}, indexString, true, 7L};
  }();
  return values;
}

template <class T>
static std::string listText(const std::vector<T>& items) {
  std::ostringstream text;
  for (const T& item : items) text << (&item == items.data() ? "" : ", ") << item;
  return "{" + text.str() + "}";
}

std::string valueText(const ProviderDefValue& value) {
  const std::string type = std::to_string(value.getType()) + " ";
  switch (value.getType()) {
    case ProviderDefValue::kString:
    case ProviderDefValue::kIndexString:
      return type + value.getStringValue();
    case ProviderDefValue::kIntArray:
      return type + listText(value.getIntArray());
    case ProviderDefValue::kStringArray:
      return type + listText(value.getStringArray());
    case ProviderDefValue::kBoolean:
      return type + (value.getBoolValue() ? "true" : "false");
    default:
      return type + std::to_string(value.getLongValue());
  }
}

std::string valueText(const Values& values) {
  std::string text;
  for (const ProviderDefValue& value : values) text += valueText(value) + "; ";
  return text;
}

std::string words(std::initializer_list<int> list) {
  std::string bytes;
  for (const int word : list) {
    for (int shift = 0; shift < 32; shift += 8) {
      bytes += static_cast<char>(static_cast<unsigned>(word) >> shift);
    }
  }
  return bytes;
}

void PrintTo(const ProviderDefValue& value, std::ostream* stream) {
  *stream << valueText(value);
}
