#include "cimhost/repository/QualifierTable.h"

namespace cimhost {

void QualifierTable::add(const QualifierDeclaration& declaration) {
  declarations_[declaration.qualifier.getName()] = declaration;
}

const QualifierDeclaration* QualifierTable::find(const Pegasus::CIMName& name) const {
  const auto found = declarations_.find(name);
  return found != declarations_.end() ? &found->second : findStandardQualifier(name);
}

}  // namespace cimhost
