// The dumps of all definition objects, on standard output. They stand here, beside the log, for
// what they are used for; the classes declare them.

#include "association/ProviderDefAssociation.h"
#include "engine/ProviderDefClass.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefModule.h"

#include <cstdio>

bool inModuleInitDump = false;

namespace {

/// The two lines that frame the dump of one object.
class DumpFrame {
 public:
  explicit DumpFrame(const char* className) : className_(className) {
    std::printf("*** Start of %s Dump ***\n", className_);
  }
  ~DumpFrame() { std::printf("*** End   of %s Dump ***\n", className_); }
  DumpFrame(const DumpFrame&) = delete;
  DumpFrame& operator=(const DumpFrame&) = delete;

 private:
  const char* className_;
};

const char* trueOrFalse(bool flag) {
  return flag ? "true" : "false";
}
const char* functionOrConstant(bool function) {
  return function ? "function" : "constant";
}

}  // namespace

// The items of an array stand on one line, and what follows goes on in it.
void ProviderDefValue::dump() const {
  const DumpFrame frame("ProviderDefValue");
  switch (type_) {
    case kInteger:
      std::printf("Value Type: int, Value: %d\n", intValue_);
      break;
    case kString:
      std::printf("Value Type: string, Value: %s\n", stringValue_.c_str());
      break;
    case kIntArray:
      std::puts("Value Type: int array");
      for (size_t i = 0; i < intArray_.size(); ++i) {
        std::printf("%d : %d, ", static_cast<int>(i), intArray_[i]);
      }
      break;
    case kStringArray:
      std::puts("Value Type: string array");
      for (size_t i = 0; i < stringArray_.size(); ++i) {
        std::printf("%d : %s, ", static_cast<int>(i), stringArray_[i].c_str());
      }
      break;
    case kIndexString:
      std::printf("Value Type: index string, Value: %s\n", stringValue_.c_str());
      break;
    case kBoolean:
      std::printf("Value Type: boolean, Value: %s\n", trueOrFalse(boolValue_));
      break;
    default:
      break;
  }
}

void ProviderDefArgument::dump() const {
  const DumpFrame frame("ProviderDefArgument");
  switch (type_) {
    case kIndex:
      std::puts("Argument Type: index");
      return;
    case kInput:
      std::puts("Argument Type: input");
      return;
    case kOutput:
      std::puts("Argument Type: output");
      return;
    case kElement:
      std::puts("Argument Type: element");
      break;
    default:
      return;
  }
  switch (elementType_) {
    case kConstant:
      std::puts("Argument Element Type: constant");
      constant_.dump();
      break;
    case kFunctionCall:
      std::puts("Argument Element Type: functioncall");
      functionCall_->dump();
      break;
    case kCimProperty:
      std::puts("Argument Element Type: cimproperty");
      std::printf("WQL Query: %s\n", queryString_.c_str());
      break;
    default:
      break;
  }
}

void ProviderDefFunctionCall::dump() const {
  const DumpFrame frame("ProviderDefFunctionCall");
  if (function_ != nullptr) function_->dump();
  for (const ProviderDefArgument& argument : arguments_) argument.dump();
}

void ProviderDefFunction::dump() const {
  const DumpFrame frame("ProviderDefFunction");
  std::printf("Function Name: %s\n", name_.c_str());
  std::printf("Function Type: %d\n", type_);
  if (module_ != nullptr) module_->dump();
}

void ProviderDefModule::dump() const {
  const DumpFrame frame("ProviderDefModule");
  std::printf("Module Name: %s\n", name_.c_str());
  std::printf("Path type: %s\n", path_ == kShort ? "short" : "fullpath");
  std::printf("Need Init: %s\n", trueOrFalse(needInit_));
  if (!needInit_ || inModuleInitDump) return;
  inModuleInitDump = true;
  init_->dump();
  inModuleInitDump = false;
}

void ProviderDefMethod::dump() const {
  const DumpFrame frame("ProviderDefMethod");
  std::printf("Method Name: %s\n", name_.c_str());
  call_.dump();
}

void ProviderDefProperty::dump() const {
  const auto dumpSide = [](bool fromFunction, const ProviderDefFunctionCall& call,
                           const ProviderDefValue& constant) {
    if (fromFunction) {
      call.dump();
    } else {
      constant.dump();
    }
  };
  const DumpFrame frame("ProviderDefProperty");
  std::printf("Property Name: %s\n", name_.c_str());
  std::printf("Get Valuemap conversion %s\n", trueOrFalse(getValuemap_));
  std::printf("Get Type: %s\n", functionOrConstant(getFromFunction_));
  dumpSide(getFromFunction_, getCall_, getConstant_);
  if (!hasSet_) return;
  std::printf("Set Type: %s\n", functionOrConstant(setFromFunction_));
  dumpSide(setFromFunction_, setCall_, setConstant_);
}

void ProviderDefClass::dump() const {
  const DumpFrame frame("ProviderDefClass");
  std::printf("Class Name: %s\n", name_.c_str());
  std::printf("Namespaces Name: %s\n", namespace_.c_str());
  std::printf("Number of Instances Type: %s\n", functionOrConstant(instancesFromFunction_));
  if (instancesFromFunction_) {
    instancesCall_.dump();
  } else {
    std::printf("Number of Instances : %d\n", numberOfInstances_);
  }
  for (const ProviderDefProperty& property : properties_) property.dump();
  for (const ProviderDefMethod& method : methods_) method.dump();
}

void ProviderDefCondition::dump() const {
  const DumpFrame frame("ProviderDefCondition");
  std::printf("Condition Type : %d\n", type_);
  if (type_ > kInclude) {
    // "true" and "false" have no sub-conditions; the labels stand all the same.
    std::puts("Condition 1");
    if (condition1_) condition1_->dump();
    std::puts("Condition 2");
    if (condition2_) condition2_->dump();
    return;
  }
  const auto dumpOperand = [](int number, const Operand& operand) {
    std::printf("ValueType %d: %d \n", number, operand.kind);
    if (operand.kind == kConstant) operand.constant.dump();
    if (operand.kind == kFunctionCall) operand.call.dump();
    if (operand.kind == kPropertyIndex) {
      std::printf("property index : %d\n", operand.propertyIndex);
    }
  };
  dumpOperand(1, operand1_);
  dumpOperand(2, operand2_);
}

void ProviderDefAssociation::dump() const {
  const DumpFrame frame("ProviderDefAssociation");
  std::printf("Class Name: %s\n", name_.c_str());
  std::printf("Namespaces Name: %s\n", namespace_.c_str());
  std::printf("Property Name 1: %s\n", propertyName1_.c_str());
  std::printf("Property Name 2: %s\n", propertyName2_.c_str());
  for (size_t i = 0; i < classNamePairs_.size(); ++i) {
    const int position = static_cast<int>(i);
    const auto& [first, second] = classNamePairs_[i];
    std::printf("Class Name Pair[%d] Class Name 1: %s\n", position, first.c_str());
    std::printf("Class Name Pair[%d] Class Name 2: %s\n", position, second.c_str());
    conditions_[i].dump();
  }
  std::puts("Class properties");
  for (const auto& [className, properties] : classProperties_) {
    std::printf("Class : %s - ", className.c_str());
    for (const std::string& property : properties) std::printf(" %s ", property.c_str());
  }
}
