#include "engine/ProviderDefArgument.h"

#include "engine/ProviderDefFunctionCall.h"

ProviderDefArgument::ProviderDefArgument(Type type) : type_(type) {}

ProviderDefArgument::ProviderDefArgument(ProviderDefValue constant)
    : type_(kElement), constant_(std::move(constant)) {}

ProviderDefArgument::ProviderDefArgument(const ProviderDefArgument&) = default;
ProviderDefArgument::ProviderDefArgument(ProviderDefArgument&&) noexcept = default;
ProviderDefArgument& ProviderDefArgument::operator=(const ProviderDefArgument&) = default;
ProviderDefArgument& ProviderDefArgument::operator=(ProviderDefArgument&&) noexcept = default;
ProviderDefArgument::~ProviderDefArgument() = default;

ProviderDefValue ProviderDefArgument::evaluate(int index) const {
  switch (elementType_) {
    case kConstant:
      return constant_;
    case kFunctionCall:
      return functionCall_->getValue(index);
    case kCimProperty:
      return getCimProperty(queryString_);
    default:
      return ProviderDefValue();
  }
}
