#include "engine/ProviderDefProperty.h"

ProviderDefValue ProviderDefProperty::getValue(int index) const {
  return getFromFunction_ ? getCall_.getValue(index) : getConstant_;
}

int ProviderDefProperty::setValue(const ProviderDefValue& value, int index) const {
  return setFromFunction_ ? setCall_.setValue(value, index) : 0;
}
