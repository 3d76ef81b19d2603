#include "engine/Registry.h"

#include "diagnostics/debug.h"

#include <string_view>
#include <unordered_map>
#include <vector>

namespace {

/// Objects in order of registration, with the first of each name at hand.
template <class T>
class NamedList {
 public:
  // Most look-ups miss, while definitions are read: sparse buckets let them end at once.
  NamedList() { byName_.max_load_factor(0.25f); }

  T* find(std::string_view name) const {
    const auto found = byName_.find(name);
    return found == byName_.end() ? nullptr : found->second;
  }

  T* add(std::unique_ptr<T> object) {
    objects_.push_back(std::move(object));
    T* added = objects_.back().get();
    byName_.emplace(added->getName(), added);
    return added;
  }

  /// Adds the object when its name is new; gives the first object of the name. One look-up.
  T* addNew(std::unique_ptr<T> object) {
    const auto [entry, isNew] = byName_.try_emplace(object->getName(), object.get());
    if (isNew) objects_.push_back(std::move(object));
    return entry->second;
  }

  void clear() {
    byName_.clear();
    // In order of registration; the objects are out of the list while they go.
    std::vector<std::unique_ptr<T>> going = std::move(objects_);
    objects_.clear();
    for (auto& object : going) object.reset();
  }

  const std::vector<std::unique_ptr<T>>& objects() const { return objects_; }

 private:
  std::vector<std::unique_ptr<T>> objects_;
  std::unordered_map<std::string_view, T*> byName_;  // the names belong to the objects
};

// At the end of a process that never released them the modules go before the functions, since a
// module looks through the functions when it goes.
struct Registries {
  NamedList<ProviderDefFunction> functions;
  NamedList<ProviderDefModule> modules;
  std::vector<std::unique_ptr<ProviderDefFunctionCall>> initCalls;
};

Registries& registries() {
  static Registries all;
  return all;
}

NamedList<ProviderDefModule>& modules() {
  return registries().modules;
}
NamedList<ProviderDefFunction>& functions() {
  return registries().functions;
}

}  // namespace

ProviderDefModule* getModule(const std::string& name) {
  ProviderDefModule* module = modules().find(name);
  // Not const on purpose: this overload writes to standard output.
  static char miss[] = "Can not find module\n";
  if (module == nullptr) debug(9, miss);
  return module;
}

namespace {

void noteMissingFunction() {
  static char miss[] = "Can not find a function\n";
  debug(9, miss);
}

}  // namespace

ProviderDefFunction* getFunction(const std::string& name) {
  ProviderDefFunction* function = functions().find(name);
  if (function == nullptr) noteMissingFunction();
  return function;
}

const std::vector<std::unique_ptr<ProviderDefModule>>& registeredModules() {
  return modules().objects();
}

ProviderDefModule* registerModule(std::unique_ptr<ProviderDefModule> module) {
  return modules().add(std::move(module));
}

ProviderDefFunction* registerFunction(std::unique_ptr<ProviderDefFunction> function) {
  return functions().add(std::move(function));
}

ProviderDefFunction* registerNewFunction(std::unique_ptr<ProviderDefFunction> function) {
  const ProviderDefFunction* added = function.get();
  ProviderDefFunction* registered = functions().addNew(std::move(function));
  if (registered == added) noteMissingFunction();
  return registered;
}

ProviderDefFunctionCall* keepInitCall(std::unique_ptr<ProviderDefFunctionCall> call) {
  registries().initCalls.push_back(std::move(call));
  return registries().initCalls.back().get();
}

const std::vector<std::unique_ptr<ProviderDefFunction>>& registeredFunctions() {
  return functions().objects();
}

size_t functionCount() {
  return functions().objects().size();
}

void replaceModule(const ProviderDefModule* from, ProviderDefModule* to, size_t first) {
  const auto& all = functions().objects();
  for (size_t i = first; i < all.size(); ++i) {
    if (all[i]->getModule() == from) all[i]->setModule(to);
  }
}

void releaseFunctions() {
  functions().clear();
}

void releaseModules() {
  modules().clear();
  releaseDefinitions();
  registries().initCalls.clear();
}
