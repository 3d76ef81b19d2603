#include "cimhost/repository/QualifierTable.h"

#include <algorithm>

namespace cimhost {

void QualifierTable::add(const QualifierDeclaration& declaration) {
  declarations_[declaration.qualifier.getName()] = declaration;
}

const QualifierDeclaration* QualifierTable::find(const Pegasus::CIMName& name) const {
  const auto found = declarations_.find(name);
  return found != declarations_.end() ? &found->second : findStandardQualifier(name);
}

std::vector<QualifierDeclaration> QualifierTable::all() const {
  std::vector<QualifierDeclaration> result;
  for (const auto& each : declarations_) result.push_back(each.second);
  for (const QualifierDeclaration& standard : standardQualifiers()) {
    if (declarations_.count(standard.qualifier.getName()) == 0) result.push_back(standard);
  }
  const auto name = [](const QualifierDeclaration& each) {
    return each.qualifier.getName().getString();
  };
  std::sort(result.begin(), result.end(), [&](const auto& a, const auto& b) {
    return Pegasus::String::compareNoCase(name(a), name(b)) < 0;
  });
  return result;
}

}  // namespace cimhost
