#include "cimhost/ServedClasses.h"

#include <algorithm>
#include <unordered_set>

namespace cimhost {

using Pegasus::CIMName;
using Pegasus::CIMNamespaceName;

namespace {

bool isIn(const ServedClass& served, const CIMNamespaceName& nameSpace) {
  return served.nameSpace.isNull() || served.nameSpace == nameSpace;
}

}  // namespace

void ServedClasses::add(ServedClass served) {
  byName_[served.className].push_back(classes_.size());
  classes_.push_back(std::move(served));
}

template <class Accept>
bool ServedClasses::anyOf(const CIMName& className, Accept accept) const {
  const auto found = byName_.find(className);
  return found != byName_.end() &&
         std::any_of(found->second.begin(), found->second.end(),
                     [&](std::size_t position) { return accept(classes_[position]); });
}

bool ServedClasses::serves(const CIMNamespaceName& nameSpace, const CIMName& className) const {
  return anyOf(className, [&](const ServedClass& served) { return isIn(served, nameSpace); });
}

bool ServedClasses::servesMethods(const CIMNamespaceName& nameSpace,
                                  const CIMName& className) const {
  return anyOf(className, [&](const ServedClass& served) {
    return served.hasMethods && isIn(served, nameSpace);
  });
}

std::vector<CIMName> ServedClasses::associations(const CIMNamespaceName& nameSpace) const {
  std::vector<CIMName> names;
  std::unordered_set<CIMName, NameHash, NameEqual> seen;
  for (const ServedClass& served : classes_) {
    if (!served.association || !isIn(served, nameSpace)) continue;
    if (seen.insert(served.className).second) names.push_back(served.className);
  }
  return names;
}

}  // namespace cimhost
