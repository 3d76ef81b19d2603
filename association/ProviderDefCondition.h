#pragma once

#include "engine/ClonePointer.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefValue.h"

#include <vector>

class ElementReader;
class ProviderDefModule;

/// Decides whether an instance of a pair's first class is related to one of its second class.
class ProviderDefCondition {
 public:
  using Values = std::vector<ProviderDefValue>;

  enum Type {
    kEqual = 0,
    kPartOf = 1,
    kInclude = 2,
    kAnd = 3,
    kOr = 4,
    kTrue = 5,
    kFalse = 6,
    kUnread = 99
  };
  enum ValueType { kConstant = 0, kFunctionCall = 1, kPropertyIndex = 2 };

  /// Builds the condition from its `condition` element; see ProviderDefModule for the arguments.
  ProviderDefCondition(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefCondition(ElementReader& reader, ProviderDefModule* module);

  int getType() const { return type_; }

  /// Side 1 is the pair's first class: its instance index and its property values in the order of
  /// the class's list; side 2 the second class. An operand that names a position which its side
  /// does not have is the empty value. Writes a trace line on standard output, as its
  /// sub-conditions do.
  bool getValue(int index1, const Values& values1, int index2, const Values& values2) const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  // The three kinds of an operand side by side; `kind` says which one holds.
  struct Operand {
    int kind = kConstant;
    ProviderDefValue constant;
    ProviderDefFunctionCall call;
    int propertyIndex = 0;
  };

  struct Parser;

  void read(ElementReader& reader, ProviderDefModule* module);

  bool compare(int index1, const Values& values1, int index2, const Values& values2) const;
  // The operand's value: where it stands already, else evaluated into `made`.
  static const ProviderDefValue& evaluate(const Operand& operand, int index, const Values& values,
                                          ProviderDefValue& made);

  int type_ = kUnread;
  Operand operand1_;
  Operand operand2_;
  ClonePointer<ProviderDefCondition> condition1_;
  ClonePointer<ProviderDefCondition> condition2_;
};
