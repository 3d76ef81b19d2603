#pragma once

#include "platform/Mutex.h"

#include <atomic>
#include <memory>
#include <string>

/// Set while a module dumps its initialisation call, whose function dumps the module again: the
/// inner dump leaves the call out.
extern bool inModuleInitDump;

class ElementReader;
class ProviderDefFunctionCall;

/// A plug-in library and the call that initialises it.
///
/// Opened at the first use of one of its functions; closed when the object goes. A copy takes every
/// field but the lock; a library opened by either stays open until both are gone.
class ProviderDefModule {
 public:
  ProviderDefModule(std::string name, bool shortPath)
      : name_(std::move(name)), path_(shortPath ? kShort : kFull) {}

  /// Builds the module from its `module` element.
  ///
  /// `text` starts at the start tag and has `length` characters; `*consumed` becomes the number of
  /// characters up to and including the end tag. Throws ProviderDefXMLError.
  ProviderDefModule(const char* text, int length, int* consumed);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  explicit ProviderDefModule(ElementReader& reader);
  ProviderDefModule(const ProviderDefModule& other);
  ProviderDefModule& operator=(const ProviderDefModule&) = delete;
  ~ProviderDefModule();

  const std::string& getName() const { return name_; }
  /// 1: the name is short for "../lib/lib" + name + ".so"; 0: it is the path itself.
  int getPath() const { return path_; }
  /// What the loader is asked to open; a path is relative to the working directory.
  std::string pathToLoad() const;
  bool getNeedInit() const { return needInit_; }
  /// The call that runs once after the library is opened; not owned, nullptr without one.
  ProviderDefFunctionCall* getInit() const { return init_; }
  void setInit(ProviderDefFunctionCall* init) {
    init_ = init;
    needInit_ = true;
  }

  /// The address of an exported symbol, never null.
  ///
  /// Opens the library when it is not open and runs the initialisation call, once per opening.
  /// Throws ProviderDefError "Couldn't load module " + module name (the next call tries again) or
  /// "Couldn't load function " + `name`. Safe from several threads.
  void* getFunction(const std::string& name);

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  enum PathType { kFull = 0, kShort = 1 };

  void read(ElementReader& reader);
  void readOrDetach(ElementReader& reader);
  void open();
  void detachFunctions();

  std::string name_;
  ProviderDefFunctionCall* init_ = nullptr;
  bool needInit_ = false;
  std::atomic<int> loaded_{0};
  int path_ = kFull;
  std::shared_ptr<void> handle_;
  Vaneth::Mutex mutex_;
  // Functions registered before the module came to be cannot refer to it.
  size_t firstFunction_ = 0;
};
