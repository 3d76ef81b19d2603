#include <Pegasus/Common/CIMMethod.h>

#include "HandleAccess.h"
#include "MethodRep.h"

PEGASUS_NAMESPACE_BEGIN

bool MethodRep::identical(const MethodRep& other) const {
  return sameNameAndQualifiers(other) && type == other.type && classOrigin == other.classOrigin &&
         propagated == other.propagated && parameters.identical(other.parameters);
}

MethodRep& MethodReader::rep() const {
  return static_cast<MethodRep&>(QualifiedReader::rep());
}

const CIMName& MethodReader::getName() const {
  return rep().name();
}
CIMType MethodReader::getType() const {
  return rep().type;
}
const CIMName& MethodReader::getClassOrigin() const {
  return rep().classOrigin;
}
Boolean MethodReader::getPropagated() const {
  return rep().propagated;
}
Uint32 MethodReader::findParameter(const CIMName& name) const {
  return rep().parameters.find(name);
}
CIMConstParameter MethodReader::getParameter(Uint32 index) const {
  return HandleAccess::handle<CIMConstParameter>(rep().parameters.at(index));
}
Uint32 MethodReader::getParameterCount() const {
  return rep().parameters.size();
}
Boolean MethodReader::identical(const CIMConstMethod& other) const {
  return rep().identical(*HandleAccess::rep<MethodRep>(other));
}
CIMMethod MethodReader::clone() const {
  return HandleAccess::handle<CIMMethod>(Ref<MethodRep>(new MethodRep(rep())));
}

CIMMethod::CIMMethod(const CIMName& name, CIMType type, const CIMName& classOrigin,
                     Boolean propagated)
    : QualifiedHandle(Ref<QualifiedRep>(new MethodRep(name, type, classOrigin, propagated))) {}

void CIMMethod::setName(const CIMName& name) {
  rep().rename(name, MethodRep::kKind);
}
void CIMMethod::setType(CIMType type) {
  rep().type = type;
}
void CIMMethod::setClassOrigin(const CIMName& classOrigin) {
  rep().classOrigin = classOrigin;
}
void CIMMethod::setPropagated(Boolean propagated) {
  rep().propagated = propagated;
}
CIMMethod& CIMMethod::addParameter(const CIMParameter& parameter) {
  rep().parameters.add(HandleAccess::rep<ParameterRep>(parameter));
  return *this;
}
CIMParameter CIMMethod::getParameter(Uint32 index) {
  return HandleAccess::handle<CIMParameter>(rep().parameters.changeable(index));
}
void CIMMethod::removeParameter(Uint32 index) {
  rep().parameters.remove(index);
}

PEGASUS_NAMESPACE_END
