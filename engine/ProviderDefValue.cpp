#include "engine/ProviderDefValue.h"

#include "diagnostics/TraceLine.h"
#include "diagnostics/debug.h"

#include <algorithm>
#include <string_view>

namespace {

template <class T>
bool contains(const std::vector<T>& whole, const T& element) {
  return std::find(whole.begin(), whole.end(), element) != whole.end();
}

template <class T>
bool containsAll(const std::vector<T>& whole, const std::vector<T>& part) {
  return std::all_of(part.begin(), part.end(),
                     [&whole](const T& element) { return contains(whole, element); });
}

// As %s shows it: up to an embedded NUL.
std::string_view shown(const std::string& text) {
  return std::string_view(text.c_str());
}

}  // namespace

ProviderDefValue::ProviderDefValue(std::string value)
    : type_(kString), stringValue_(std::move(value)) {
  debug(9, "ProviderDefValue Constructor (string)\n");
}

bool ProviderDefValue::equal(const ProviderDefValue& other) const {
  TraceLine trace;
  trace << "ProviderDefValue::equal(ProviderDefValue value)";
  if (type_ != other.type_) return false;
  switch (type_) {
    case kString:
      trace << "Comparing strings: " << shown(stringValue_) << ", " << shown(other.stringValue_)
            << "\n";
      return stringValue_ == other.stringValue_;
    case kInteger:
      return intValue_ == other.intValue_;
    case kIntArray:
      return intArray_ == other.intArray_;
    case kStringArray:
      return stringArray_ == other.stringArray_;
    default:
      return false;
  }
}

bool ProviderDefValue::partof(const ProviderDefValue& other) const {
  switch (other.type_) {
    case kString:
      // Not found counts as true, a match at the very start as false: definitions rely on it.
      return type_ == kString && other.stringValue_.find(stringValue_) != 0;
    case kIntArray:
      if (type_ == kInteger) return contains(other.intArray_, intValue_);
      return type_ == kIntArray && containsAll(other.intArray_, intArray_);
    case kStringArray:
      if (type_ == kString) return contains(other.stringArray_, stringValue_);
      // Asked of an integer array, whose list of strings is empty: always true.
      return type_ == kIntArray && containsAll(other.stringArray_, stringArray_);
    default:
      return false;
  }
}
