#include "definition/DefinitionRegistry.h"

#include "engine/Registry.h"
#include "engine/ciEqual.h"

#include <string_view>
#include <unordered_map>

namespace {

struct Definitions {
  std::deque<ProviderDefClass> classes;
  // The first class of each name; the names belong to the classes.
  std::unordered_map<std::string_view, const ProviderDefClass*, CiHash, CiEqual> classByName;
  std::deque<ProviderDefAssociation> associations;
};

Definitions& definitions() {
  static Definitions all;
  return all;
}

}  // namespace

const std::deque<ProviderDefClass>& registeredClasses() {
  return definitions().classes;
}

const std::deque<ProviderDefAssociation>& registeredAssociations() {
  return definitions().associations;
}

void registerClass(ElementReader& reader, ProviderDefModule* module) {
  const ProviderDefClass& added = definitions().classes.emplace_back(reader, module);
  definitions().classByName.emplace(added.getName(), &added);
}

void registerAssociation(ElementReader& reader, ProviderDefModule* module) {
  definitions().associations.emplace_back(reader, module);
}

const ProviderDefClass* getProviderDefClass(const std::string& name) {
  const auto& byName = definitions().classByName;
  const auto found = byName.find(name);
  return found == byName.end() ? nullptr : found->second;
}

void releaseDefinitions() {
  definitions().classByName.clear();
  definitions().classes.clear();
  definitions().associations.clear();
}
