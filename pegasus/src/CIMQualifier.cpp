#include <Pegasus/Common/CIMQualifier.h>

#include "HandleAccess.h"
#include "QualifierRep.h"

PEGASUS_NAMESPACE_BEGIN

QualifierRep& QualifierReader::rep() const {
  if (!rep_) throw UninitializedObjectException();
  return *rep_;
}

const CIMName& QualifierReader::getName() const {
  return rep().name();
}
CIMType QualifierReader::getType() const {
  return rep().value.getType();
}
Boolean QualifierReader::isArray() const {
  return rep().value.isArray();
}
const CIMValue& QualifierReader::getValue() const {
  return rep().value;
}
const CIMFlavor& QualifierReader::getFlavor() const {
  return rep().flavor;
}
Uint32 QualifierReader::getPropagated() const {
  return rep().propagated;
}
Boolean QualifierReader::isUninitialized() const {
  return !rep_;
}
Boolean QualifierReader::identical(const CIMConstQualifier& other) const {
  return rep().identical(*HandleAccess::rep<QualifierRep>(other));
}
CIMQualifier QualifierReader::clone() const {
  return HandleAccess::handle<CIMQualifier>(Ref<QualifierRep>(new QualifierRep(rep())));
}

CIMQualifier::CIMQualifier(const CIMName& name, const CIMValue& value, const CIMFlavor& flavor,
                           Boolean propagated)
    : QualifierReader(Ref<QualifierRep>(new QualifierRep(name, value, flavor, propagated))) {}

void CIMQualifier::setName(const CIMName& name) {
  rep().rename(name, QualifierRep::kKind);
}
void CIMQualifier::setValue(const CIMValue& value) {
  rep().value = value;
}
void CIMQualifier::setFlavor(const CIMFlavor& flavor) {
  rep().flavor.addFlavor(flavor);
}
void CIMQualifier::unsetFlavor(const CIMFlavor& flavor) {
  rep().flavor.removeFlavor(flavor);
}
void CIMQualifier::setPropagated(Boolean propagated) {
  rep().propagated = propagated;
}

PEGASUS_NAMESPACE_END
