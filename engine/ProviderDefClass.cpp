#include "engine/ProviderDefClass.h"

#include "diagnostics/debug.h"

#include <algorithm>

namespace {

template <class T>
const T* findByName(const std::vector<T>& items, std::string_view name) {
  const auto found = std::find_if(items.begin(), items.end(),
                                  [name](const T& item) { return item.getName() == name; });
  return found == items.end() ? nullptr : &*found;
}

}  // namespace

const ProviderDefProperty* ProviderDefClass::getProperty(std::string_view name) const {
  return findByName(properties_, name);
}

const ProviderDefMethod* ProviderDefClass::getMethod(std::string_view name) const {
  return findByName(methods_, name);
}

int ProviderDefClass::getNumberOfInstances() const {
  return instancesFromFunction_ ? instancesCall_.getValue() : numberOfInstances_;
}

int boundedNumberOfInstances(const ProviderDefClass& definition) {
  const int count = definition.getNumberOfInstances();
  if (count > kMaxInstances) {
    DEBUG_FORMAT(1, "Class %s has %d instances, more than %d: the rest is left out\n",
                 definition.getName().c_str(), count, kMaxInstances);
  }
  return std::min(count, kMaxInstances);
}
