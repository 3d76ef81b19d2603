#pragma once

#include "engine/CallBuffer.h"
#include "engine/FunctionTypes.h"
#include "engine/ProviderDefValue.h"

#include <array>
#include <atomic>
#include <string>
#include <vector>

class ElementReader;
class ProviderDefModule;

/// A plug-in function: its symbol, its calling type, its module, and the calls themselves.
///
/// The type code fixes the C signature (docs/plugins.md). An operation that does not fit the type,
/// or a value of a type that the function cannot take, does not call the plug-in and yields the
/// operation's not-supported result: 0 from set, 99 from exec, the empty value from get.
///
/// All operations throw ProviderDefError when the library or the symbol cannot be loaded, when an
/// input does not fit the 1024 bytes of a buffer (the plug-in is not called then), and when a
/// result does not lie within its buffer. They may be called from several threads at once.
class ProviderDefFunction {
 public:
  using Values = std::vector<ProviderDefValue>;

  /// What exec returns when the type does not fit.
  static constexpr int kExecNotSupported = 99;

  ProviderDefFunction(std::string name, int type, ProviderDefModule* module)
      : name_(std::move(name)), type_(type), module_(module) {}

  /// Builds the function from its `function` element; the other arguments as for every element.
  ProviderDefFunction(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefFunction(ElementReader& reader, ProviderDefModule* module);
  ProviderDefFunction(const ProviderDefFunction& other);
  ProviderDefFunction& operator=(const ProviderDefFunction&) = delete;

  const std::string& getName() const { return name_; }
  int getType() const { return type_; }
  ProviderDefModule* getModule() const { return module_; }
  void setModule(ProviderDefModule* module) { module_ = module; }

  /// Fills the slot of the function's own type. 0: resolved, now or before, or the type is unknown;
  /// 1: not marked as resolved (always so for the execC family, which is looked up at every call).
  int loadFunction();

  int set(const ProviderDefValue& value);
  int set(const ProviderDefValue& value, const ProviderDefValue& extra);
  int set(const ProviderDefValue& value, const Values& extras);

  ProviderDefValue get();
  ProviderDefValue get(const ProviderDefValue& extra);
  ProviderDefValue get(const Values& extras);

  int exec();
  int exec(const ProviderDefValue& extra);
  int exec(const Values& inputs);
  int exec(const ProviderDefValue& extra, const Values& inputs);
  /// Appends what the plug-in delivers to `outputs`.
  int exec(const Values& inputs, Values& outputs);
  int exec(const ProviderDefValue& extra, const Values& inputs, Values& outputs);

  // Packing: writes one item at `position`, returns the position behind it. `end` is the end of the
  // buffer: ProviderDefError when the item does not fit.
  char* packI(char* position, const char* end, int value) const;
  char* packS(char* position, const char* end, const std::string& value) const;
  char* packAI(char* position, const char* end, const std::vector<int>& values) const;
  char* packAS(char* position, const char* end, const std::vector<std::string>& values) const;

  // Unpacking: reads the item at `item` without looking at its tag; `next`, when given, becomes the
  // position of the following item. ProviderDefError when the item does not end before `end`.
  int makeI(const char* item, const char** next, const char* end) const;
  std::string makeS(const char* item, const char** next, const char* end) const;
  std::vector<int> makeAI(const char* item, const char** next, const char* end) const;
  std::vector<std::string> makeAS(const char* item, const char** next, const char* end) const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  struct Extra;

  void read(ElementReader& reader);
  int slot() const { return functionTypeSlot(type_); }
  bool isType(Family family, Suffix suffix) const;
  /// The entry point after loadFunction().
  void* entry();
  void logExec() const;

  char* packList(char* position, const char* end, const Values& values, bool endMark) const;
  void readOutputs(const char* begin, const char* end, Values& outputs) const;
  bool takeExtra(Extra& extra, Suffix suffix, const ProviderDefValue& value) const;
  void checkIntact(const CallBuffer& buffer) const;
  [[noreturn]] void failInput() const;
  [[noreturn]] void failResult() const;

  template <class Result, class... Arguments>
  Result call(void* entry, const Extra& extra, Arguments... arguments) const;
  int callSet(const ProviderDefValue& value, const Extra& extra);
  ProviderDefValue callGet(const Extra& extra);
  int callExec(const Extra& extra, const Values* inputs, Values* outputs);

  std::string name_;
  int type_;
  ProviderDefModule* module_;
  std::atomic<bool> loaded_{false};
  std::array<std::atomic<void*>, kFunctionTypes> slots_{};
};
