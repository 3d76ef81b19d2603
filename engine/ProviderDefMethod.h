#pragma once

#include "engine/ProviderDefFunctionCall.h"

#include <string>
#include <vector>

class ElementReader;

/// Which call carries out a method of a class.
class ProviderDefMethod {
 public:
  /// Builds the method from its `method` element; see ProviderDefModule for the arguments.
  ProviderDefMethod(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefMethod(ElementReader& reader, ProviderDefModule* module);

  const std::string& getName() const { return name_; }

  /// Runs the call; see ProviderDefFunctionCall::exec.
  int exec(const std::vector<ProviderDefValue>& inputs, std::vector<ProviderDefValue>& outputs,
           int index) const {
    return call_.exec(inputs, outputs, index);
  }

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  void read(ElementReader& reader, ProviderDefModule* module);

  std::string name_;
  ProviderDefFunctionCall call_;
};
