#include "engine/ProviderDefFunctionCall.h"

#include "diagnostics/debug.h"
#include "engine/ProviderDefError.h"

namespace {

// What a get or set call passes in the place of an input argument, which only exec calls have.
const char kNotSupported[] = "Not Supported";

}  // namespace

ProviderDefFunctionCall::ProviderDefFunctionCall(ProviderDefFunction* function,
                                                 std::vector<ProviderDefArgument> arguments)
    : arguments_(std::move(arguments)), function_(function) {}

ProviderDefFunctionCall::ProviderDefFunctionCall(const ProviderDefFunctionCall&) = default;
ProviderDefFunctionCall::ProviderDefFunctionCall(ProviderDefFunctionCall&&) noexcept = default;
ProviderDefFunctionCall& ProviderDefFunctionCall::operator=(const ProviderDefFunctionCall&) =
    default;
ProviderDefFunctionCall& ProviderDefFunctionCall::operator=(ProviderDefFunctionCall&&) noexcept =
    default;
ProviderDefFunctionCall::~ProviderDefFunctionCall() = default;

ProviderDefFunction& ProviderDefFunctionCall::function() const {
  if (function_ == nullptr) throw ProviderDefError("Couldn't load function ");
  return *function_;
}

ProviderDefFunctionCall::Values ProviderDefFunctionCall::evaluate(int index) const {
  Values values;
  values.reserve(arguments_.size());
  for (const ProviderDefArgument& argument : arguments_) {
    switch (argument.getType()) {
      case ProviderDefArgument::kIndex:
        values.emplace_back(index);
        break;
      case ProviderDefArgument::kInput:
        values.emplace_back(kNotSupported);
        break;
      case ProviderDefArgument::kElement:
        values.push_back(argument.evaluate(index));
        break;
      default:
        break;  // an output adds nothing
    }
  }
  return values;
}

ProviderDefValue ProviderDefFunctionCall::getValue(int index) const {
  if (arguments_.empty()) {
    debug(7, "ProviderDefFunctionCall::getValue(int index) : no argument\n");
    return function().get();
  }
  if (arguments_.size() > 1) return function().get(evaluate(index));
  switch (arguments_[0].getType()) {
    case ProviderDefArgument::kIndex:
      return function().get(ProviderDefValue(index));
    case ProviderDefArgument::kInput:
      return ProviderDefValue(kNotSupported);
    case ProviderDefArgument::kElement:
      return function().get(arguments_[0].evaluate(index));
    default:
      return ProviderDefValue(0);
  }
}

int ProviderDefFunctionCall::getValue() const {
  return function().get().getIntValue();
}

int ProviderDefFunctionCall::setValue(const ProviderDefValue& value, int index) const {
  if (arguments_.empty()) return function().set(value);
  if (arguments_.size() > 1) return function().set(value, evaluate(index));
  switch (arguments_[0].getType()) {
    case ProviderDefArgument::kIndex:
      return function().set(value, ProviderDefValue(index));
    case ProviderDefArgument::kElement:
      return function().set(value, arguments_[0].evaluate(index));
    default:
      return 0;
  }
}

int ProviderDefFunctionCall::execWithOneArgument(const Values& inputs, Values& outputs,
                                                 int index) const {
  switch (arguments_[0].getType()) {
    case ProviderDefArgument::kIndex:
      return function().exec(ProviderDefValue(index));
    case ProviderDefArgument::kInput:
      return function().exec(inputs);
    case ProviderDefArgument::kElement:
      return function().exec(arguments_[0].evaluate(index));
    case ProviderDefArgument::kOutput:
      return function().exec(inputs, outputs);
    default:
      return 0;
  }
}

int ProviderDefFunctionCall::exec(const Values& inputs, Values& outputs, int index) const {
  if (arguments_.empty()) return function().exec();
  if (arguments_.size() == 1) return execWithOneArgument(inputs, outputs, index);
  Values extras;
  bool hasInput = false;
  bool hasOutput = false;
  for (const ProviderDefArgument& argument : arguments_) {
    switch (argument.getType()) {
      case ProviderDefArgument::kIndex:
        extras.emplace_back(index);
        break;
      case ProviderDefArgument::kElement:
        extras.push_back(argument.evaluate(index));
        break;
      case ProviderDefArgument::kInput:
        hasInput = true;
        break;
      default:
        hasOutput = true;
        break;
    }
  }
  if (extras.size() > 1) return 0;
  if (extras.empty()) return hasInput && hasOutput ? function().exec(inputs, outputs) : 0;
  return hasOutput ? function().exec(extras[0], inputs, outputs)
                   : function().exec(extras[0], inputs);
}

void ProviderDefFunctionCall::init() const {
  debug(7, "ProviderDefFunctionCall::init(void)\n");
  getValue(0);
}
