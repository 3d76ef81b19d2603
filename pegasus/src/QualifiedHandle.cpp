#include <Pegasus/Embedded/QualifiedHandle.h>

#include "HandleAccess.h"

PEGASUS_NAMESPACE_BEGIN

bool QualifiedRep::hasTrueQualifier(const CIMName& qualifierName) const {
  const Uint32 index = qualifiers.find(qualifierName);
  if (index == PEG_NOT_FOUND) return false;
  const CIMValue& value = qualifiers.at(index)->value;
  Boolean flag = false;
  if (value.getType() == CIMTYPE_BOOLEAN && !value.isNull()) value.get(flag);
  return flag;
}

QualifiedRep& QualifiedReader::rep() const {
  if (!rep_) throw UninitializedObjectException();
  return *rep_;
}

Uint32 QualifiedReader::findQualifier(const CIMName& name) const {
  return rep().qualifiers.find(name);
}
CIMConstQualifier QualifiedReader::getQualifier(Uint32 index) const {
  return HandleAccess::handle<CIMConstQualifier>(rep().qualifiers.at(index));
}
Uint32 QualifiedReader::getQualifierCount() const {
  return rep().qualifiers.size();
}
Boolean QualifiedReader::isUninitialized() const {
  return !rep_;
}

void QualifiedReader::appendQualifier(const CIMQualifier& qualifier) {
  rep().qualifiers.add(HandleAccess::rep<QualifierRep>(qualifier));
}
CIMQualifier QualifiedReader::changeableQualifier(Uint32 index) {
  return HandleAccess::handle<CIMQualifier>(rep().qualifiers.changeable(index));
}
void QualifiedReader::eraseQualifier(Uint32 index) {
  rep().qualifiers.remove(index);
}

PEGASUS_NAMESPACE_END
