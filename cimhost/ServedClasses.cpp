#include "cimhost/ServedClasses.h"

#include <algorithm>

namespace cimhost {

using Pegasus::CIMName;
using Pegasus::CIMNamespaceName;

namespace {

bool isIn(const ServedClass& served, const CIMNamespaceName& nameSpace) {
  return served.nameSpace.isNull() || served.nameSpace == nameSpace;
}

}  // namespace

void ServedClasses::add(ServedClass served) {
  classes_.push_back(std::move(served));
}

bool ServedClasses::serves(const CIMNamespaceName& nameSpace, const CIMName& className) const {
  return std::any_of(classes_.begin(), classes_.end(), [&](const ServedClass& served) {
    return isIn(served, nameSpace) && served.className == className;
  });
}

bool ServedClasses::servesMethods(const CIMNamespaceName& nameSpace,
                                  const CIMName& className) const {
  return std::any_of(classes_.begin(), classes_.end(), [&](const ServedClass& served) {
    return served.hasMethods && isIn(served, nameSpace) && served.className == className;
  });
}

std::vector<CIMName> ServedClasses::associations(const CIMNamespaceName& nameSpace) const {
  std::vector<CIMName> names;
  for (const ServedClass& served : classes_) {
    if (!served.association || !isIn(served, nameSpace)) continue;
    if (std::find(names.begin(), names.end(), served.className) == names.end()) {
      names.push_back(served.className);
    }
  }
  return names;
}

}  // namespace cimhost
