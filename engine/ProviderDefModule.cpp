#include "engine/ProviderDefModule.h"

#include "diagnostics/debug.h"
#include "engine/ProviderDefError.h"
#include "engine/ProviderDefFunction.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/Registry.h"

#include <dlfcn.h>

#include <cstdint>
#include <mutex>

namespace {

unsigned long shown(const void* pointer) {
  return static_cast<unsigned long>(reinterpret_cast<std::uintptr_t>(pointer));
}

// Held while a library is opened and initialised. An initialisation call may open further modules;
// taking this lock before a module's own keeps two such chains from waiting for each other.
std::recursive_mutex& openingMutex() {
  static std::recursive_mutex mutex;
  return mutex;
}

class ModuleLock {
 public:
  explicit ModuleLock(Vaneth::Mutex& mutex) : mutex_(mutex) {
    mutex_.lock(Vaneth::Mutex::kInfinite);
  }
  ~ModuleLock() { mutex_.unlock(); }
  ModuleLock(const ModuleLock&) = delete;
  ModuleLock& operator=(const ModuleLock&) = delete;

 private:
  Vaneth::Mutex& mutex_;
};

}  // namespace

ProviderDefModule::ProviderDefModule(const ProviderDefModule& other)
    : name_(other.name_),
      init_(other.init_),
      needInit_(other.needInit_),
      loaded_(other.loaded_.load()),
      path_(other.path_),
      handle_(other.handle_),
      firstFunction_(functionCount()) {}

ProviderDefModule::~ProviderDefModule() {
  detachFunctions();
}

// A function whose module never came to be, or has gone, fails as one that cannot be loaded.
void ProviderDefModule::detachFunctions() {
  replaceModule(this, nullptr, firstFunction_);
}

std::string ProviderDefModule::pathToLoad() const {
  return path_ == kShort ? "../lib/lib" + name_ + ".so" : name_;
}

void ProviderDefModule::open() {
  DEBUG_FORMAT(7, "Loading %s\n", name_.c_str());
  const std::string file = pathToLoad();
  // The loader takes an empty name for the program itself.
  void* handle = file.empty() ? nullptr : dlopen(file.c_str(), RTLD_NOW);
  if (handle == nullptr) {
    const char* reason = file.empty() ? nullptr : dlerror();
    DEBUG_FORMAT(7, "Loading %s: %s\n", name_.c_str(), reason == nullptr ? "no name" : reason);
    throw ProviderDefError("Couldn't load module " + name_);
  }
  handle_.reset(handle, [](void* opened) { dlclose(opened); });
  loaded_.store(1, std::memory_order_release);
  DEBUG_FORMAT(7, "%s loaded: %lx\n", name_.c_str(), shown(handle));
  if (!needInit_) return;
  DEBUG_FORMAT(7, "Calling init: %lx\n", shown(init_));
  init_->init();
}

void* ProviderDefModule::getFunction(const std::string& name) {
  DEBUG_FORMAT(7, "ProviderDefModule::getFunction(std::string %s)\n", name.c_str());
  std::unique_lock<std::recursive_mutex> opening(openingMutex(), std::defer_lock);
  if (loaded_.load(std::memory_order_acquire) == 0) opening.lock();
  ModuleLock lock(mutex_);
  if (loaded_.load(std::memory_order_acquire) == 0) open();
  DEBUG_FORMAT(7, "Loading %s : %lx\n", name.c_str(), shown(handle_.get()));
  void* symbol = dlsym(handle_.get(), name.c_str());
  if (symbol == nullptr) throw ProviderDefError("Couldn't load function " + name);
  DEBUG_FORMAT(7, "%s loaded\n", name.c_str());
  return symbol;
}
