#include <Pegasus/Common/CIMProperty.h>

#include "HandleAccess.h"
#include "PropertyRep.h"

PEGASUS_NAMESPACE_BEGIN

PropertyRep::PropertyRep(const CIMName& name, const CIMValue& initialValue, Uint32 fixedSize,
                         const CIMName& referenceClass, const CIMName& origin, Boolean isPropagated)
    : QualifiedRep(name),
      classOrigin(origin),
      propagated(isPropagated),
      value_(initialValue),
      arraySize_(fixedSize),
      referenceClassName_(referenceClass) {
  const bool isReference = value_.getType() == CIMTYPE_REFERENCE;
  if (isReference && value_.isArray()) throw TypeMismatchException();
  if (!isReference && !referenceClass.isNull()) throw TypeMismatchException();
  // A null array has the size that it was declared with.
  if (fixedSize != 0 && value_.getArraySize() != fixedSize) throw TypeMismatchException();
}

void PropertyRep::setValue(const CIMValue& newValue) {
  if (!newValue.typeCompatible(value_)) throw TypeMismatchException();
  if (arraySize_ != 0 && newValue.getArraySize() != arraySize_) {
    throw TypeMismatchException();
  }
  value_ = newValue;
}

bool PropertyRep::identical(const PropertyRep& other) const {
  return sameNameAndQualifiers(other) && value_ == other.value_ && arraySize_ == other.arraySize_ &&
         referenceClassName_ == other.referenceClassName_ && classOrigin == other.classOrigin &&
         propagated == other.propagated;
}

PropertyRep& PropertyReader::rep() const {
  return static_cast<PropertyRep&>(QualifiedReader::rep());
}

const CIMName& PropertyReader::getName() const {
  return rep().name();
}
const CIMValue& PropertyReader::getValue() const {
  return rep().value();
}
CIMType PropertyReader::getType() const {
  return rep().value().getType();
}
Boolean PropertyReader::isArray() const {
  return rep().value().isArray();
}
Uint32 PropertyReader::getArraySize() const {
  return rep().arraySize();
}
const CIMName& PropertyReader::getReferenceClassName() const {
  return rep().referenceClassName();
}
const CIMName& PropertyReader::getClassOrigin() const {
  return rep().classOrigin;
}
Boolean PropertyReader::getPropagated() const {
  return rep().propagated;
}
Boolean PropertyReader::identical(const CIMConstProperty& other) const {
  return rep().identical(*HandleAccess::rep<PropertyRep>(other));
}
CIMProperty PropertyReader::clone() const {
  return HandleAccess::handle<CIMProperty>(Ref<PropertyRep>(new PropertyRep(rep())));
}

CIMProperty::CIMProperty(const CIMName& name, const CIMValue& value, Uint32 arraySize,
                         const CIMName& referenceClassName, const CIMName& classOrigin,
                         Boolean propagated)
    : QualifiedHandle(Ref<QualifiedRep>(
          new PropertyRep(name, value, arraySize, referenceClassName, classOrigin, propagated))) {}

void CIMProperty::setName(const CIMName& name) {
  rep().rename(name, PropertyRep::kKind);
}
void CIMProperty::setValue(const CIMValue& value) {
  rep().setValue(value);
}
void CIMProperty::setClassOrigin(const CIMName& classOrigin) {
  rep().classOrigin = classOrigin;
}
void CIMProperty::setPropagated(Boolean propagated) {
  rep().propagated = propagated;
}

PEGASUS_NAMESPACE_END
