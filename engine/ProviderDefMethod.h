#pragma once

#include "engine/ProviderDefFunctionCall.h"

#include <string>
#include <vector>

/// Which call carries out a method of a class.
class ProviderDefMethod {
 public:
  /// Builds the method from its `method` element; see ProviderDefModule for the arguments.
  ProviderDefMethod(const char* text, int length, int* consumed, ProviderDefModule* module);

  const std::string& getName() const { return name_; }

  /// Runs the call; see ProviderDefFunctionCall::exec.
  int exec(const std::vector<ProviderDefValue>& inputs, std::vector<ProviderDefValue>& outputs,
           int index) const {
    return call_.exec(inputs, outputs, index);
  }

 private:
  std::string name_;
  ProviderDefFunctionCall call_;
};
