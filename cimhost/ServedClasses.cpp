#include "cimhost/ServedClasses.h"

#include <algorithm>

namespace cimhost {

void ServedClasses::add(ServedClass served) {
  classes_.push_back(std::move(served));
}

bool ServedClasses::serves(const Pegasus::CIMNamespaceName& nameSpace,
                           const Pegasus::CIMName& className) const {
  return std::any_of(classes_.begin(), classes_.end(), [&](const ServedClass& served) {
    const bool here = served.nameSpace.isNull() || served.nameSpace == nameSpace;
    return here && served.className == className;
  });
}

}  // namespace cimhost
