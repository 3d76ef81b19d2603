#pragma once

#include "engine/ProviderDefArgument.h"
#include "engine/ProviderDefFunction.h"
#include "engine/ProviderDefValue.h"

#include <vector>

class ElementReader;
class ProviderDefModule;

/// A call of a plug-in function with the arguments that the definition gives.
///
/// The arguments decide which operation of the function is used; where they do not fit together,
/// the result is the operation's not-supported one (docs/definition-files.md). ProviderDefError
/// from loading or calling passes through.
class ProviderDefFunctionCall {
 public:
  using Values = std::vector<ProviderDefValue>;

  /// No call: for the places where a definition may have one.
  ProviderDefFunctionCall() = default;
  explicit ProviderDefFunctionCall(ProviderDefFunction* function,
                                   std::vector<ProviderDefArgument> arguments = {});

  /// Builds the call from its `functioncall` element; see ProviderDefModule for the arguments.
  ProviderDefFunctionCall(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefFunctionCall(ElementReader& reader, ProviderDefModule* module);

  ProviderDefFunctionCall(const ProviderDefFunctionCall&);
  ProviderDefFunctionCall(ProviderDefFunctionCall&&) noexcept;
  ProviderDefFunctionCall& operator=(const ProviderDefFunctionCall&);
  ProviderDefFunctionCall& operator=(ProviderDefFunctionCall&&) noexcept;
  ~ProviderDefFunctionCall();

  ProviderDefFunction* getDefFunction() const { return function_; }
  const std::vector<ProviderDefArgument>& getArguments() const { return arguments_; }

  /// Reads a value for the instance `index`.
  ProviderDefValue getValue(int index) const;
  /// Reads an integer without arguments: the integer field of what the function gives.
  int getValue() const;
  /// Writes `value` for the instance `index`; the plug-in's return code, 0 when not supported.
  int setValue(const ProviderDefValue& value, int index) const;
  /// Runs the function; its return code, 99 or 0 when not supported. Appends to `outputs`.
  int exec(const Values& inputs, Values& outputs, int index) const;
  /// Runs a module's initialisation call: a get call with index 0, its value unused.
  void init() const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  void read(ElementReader& reader, ProviderDefModule* module);
  ProviderDefFunction& function() const;
  int execWithOneArgument(const Values& inputs, Values& outputs, int index) const;
  Values evaluate(int index) const;

  std::vector<ProviderDefArgument> arguments_;
  ProviderDefFunction* function_ = nullptr;
};
