#include "association/ProviderDefCondition.h"

#include "diagnostics/TraceLine.h"

const ProviderDefValue& ProviderDefCondition::evaluate(const Operand& operand, int index,
                                                       const Values& values,
                                                       ProviderDefValue& made) {
  switch (operand.kind) {
    case kConstant:
      return operand.constant;
    case kFunctionCall:
      made = operand.call.getValue(index);
      return made;
    case kPropertyIndex: {
      const size_t position = static_cast<size_t>(operand.propertyIndex);
      return operand.propertyIndex >= 0 && position < values.size() ? values[position] : made;
    }
    default:
      return made;
  }
}

bool ProviderDefCondition::compare(int index1, const Values& values1, int index2,
                                   const Values& values2) const {
  ProviderDefValue made1;
  ProviderDefValue made2;
  const ProviderDefValue& value1 = evaluate(operand1_, index1, values1, made1);
  const ProviderDefValue& value2 = evaluate(operand2_, index2, values2, made2);
  switch (type_) {
    case kEqual:
      return value1.equal(value2);
    case kPartOf:
      return value1.partof(value2);
    default:
      return value1.include(value2);
  }
}

bool ProviderDefCondition::getValue(int index1, const Values& values1, int index2,
                                    const Values& values2) const {
  TraceLine() << "ProviderDefCondition::getValue( " << index1 << ", " << index2
              << ") type = " << type_ << " \n";
  switch (type_) {
    case kEqual:
    case kPartOf:
    case kInclude:
      return compare(index1, values1, index2, values2);
    case kAnd:
    case kOr:  // evaluated like "and" on purpose: definitions are written for it
      return condition1_->getValue(index1, values1, index2, values2) &&
             condition2_->getValue(index1, values1, index2, values2);
    case kTrue:
      return true;
    default:
      return false;
  }
}
