#pragma once

#include "engine/ClonePointer.h"
#include "engine/ProviderDefValue.h"

#include <string>

class ElementReader;
class ProviderDefFunctionCall;
class ProviderDefModule;

/// One argument of a function call.
class ProviderDefArgument {
 public:
  enum Type {
    kIndex = 0,    ///< The instance index.
    kInput = 1,    ///< The caller's input values.
    kElement = 2,  ///< A value that the definition gives, by element type.
    kOutput = 3    ///< The place of the results.
  };
  enum ElementType { kConstant = 0, kFunctionCall = 1, kCimProperty = 2 };

  /// An index, input or output argument.
  explicit ProviderDefArgument(Type type);
  /// An element argument with a constant.
  explicit ProviderDefArgument(ProviderDefValue constant);

  /// Builds the argument from its `argument` element; see ProviderDefModule for the arguments.
  ProviderDefArgument(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefArgument(ElementReader& reader, ProviderDefModule* module);

  ProviderDefArgument(const ProviderDefArgument&);
  ProviderDefArgument(ProviderDefArgument&&) noexcept;
  ProviderDefArgument& operator=(const ProviderDefArgument&);
  ProviderDefArgument& operator=(ProviderDefArgument&&) noexcept;
  ~ProviderDefArgument();

  int getType() const { return type_; }
  int getElementType() const { return elementType_; }
  const ProviderDefValue& getConstant() const { return constant_; }
  /// The nested call of a functioncall element; nullptr for the others.
  ProviderDefFunctionCall* getFunctionCall() const { return functionCall_.get(); }
  const std::string& getQueryString() const { return queryString_; }

  /// The value of an element argument, for the instance `index`.
  ProviderDefValue evaluate(int index) const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  void read(ElementReader& reader, ProviderDefModule* module);
  void readElement(ElementReader& reader, ProviderDefModule* module);

  int type_ = kIndex;
  int elementType_ = kConstant;
  ProviderDefValue constant_;
  std::string queryString_;
  ClonePointer<ProviderDefFunctionCall> functionCall_;
};

/// The value of a CIM property that a query names. The CIM conversion implements it.
ProviderDefValue getCimProperty(const std::string& query);
