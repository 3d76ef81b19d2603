#include <Pegasus/Common/CIMParameter.h>

#include "HandleAccess.h"
#include "ParameterRep.h"

PEGASUS_NAMESPACE_BEGIN

ParameterRep::ParameterRep(const CIMName& name, CIMType parameterType, Boolean parameterIsArray,
                           Uint32 fixedSize, const CIMName& referenceClass)
    : QualifiedRep(name),
      type(parameterType),
      isArray(parameterIsArray),
      arraySize(fixedSize),
      referenceClassName(referenceClass) {
  const bool isReference = type == CIMTYPE_REFERENCE;
  if (isReference == referenceClass.isNull()) throw TypeMismatchException();
  if (arraySize != 0 && !isArray) throw TypeMismatchException();
}

bool ParameterRep::identical(const ParameterRep& other) const {
  return sameNameAndQualifiers(other) && type == other.type && isArray == other.isArray &&
         arraySize == other.arraySize && referenceClassName == other.referenceClassName;
}

ParameterRep& ParameterReader::rep() const {
  return static_cast<ParameterRep&>(QualifiedReader::rep());
}

const CIMName& ParameterReader::getName() const {
  return rep().name();
}
Boolean ParameterReader::isArray() const {
  return rep().isArray;
}
Uint32 ParameterReader::getArraySize() const {
  return rep().arraySize;
}
const CIMName& ParameterReader::getReferenceClassName() const {
  return rep().referenceClassName;
}
CIMType ParameterReader::getType() const {
  return rep().type;
}
Boolean ParameterReader::identical(const CIMConstParameter& other) const {
  return rep().identical(*HandleAccess::rep<ParameterRep>(other));
}
CIMParameter ParameterReader::clone() const {
  return HandleAccess::handle<CIMParameter>(Ref<ParameterRep>(new ParameterRep(rep())));
}

CIMParameter::CIMParameter(const CIMName& name, CIMType type, Boolean isArray, Uint32 arraySize,
                           const CIMName& referenceClassName)
    : QualifiedHandle(
          Ref<QualifiedRep>(new ParameterRep(name, type, isArray, arraySize, referenceClassName))) {
}

void CIMParameter::setName(const CIMName& name) {
  rep().rename(name, ParameterRep::kKind);
}

PEGASUS_NAMESPACE_END
