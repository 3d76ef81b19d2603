#include <Pegasus/Common/CIMClass.h>

#include "ClassRep.h"
#include "HandleAccess.h"
#include "InstanceRep.h"

PEGASUS_NAMESPACE_BEGIN

bool ClassRep::identical(const ObjectRep& other) const {
  const auto* otherClass = dynamic_cast<const ClassRep*>(&other);
  return otherClass && sameContent(other) && superClassName == otherClass->superClassName &&
         methods.identical(otherClass->methods);
}

void ClassRep::checkProperty(const PropertyRep& property) const {
  const bool isReference = property.value().getType() == CIMTYPE_REFERENCE;
  if (!isReference || !property.referenceClassName().isNull()) return;
  // A name that is there already is the first thing to complain about.
  if (properties.find(property.name()) == PEG_NOT_FOUND) throw TypeMismatchException();
}

ClassRep& ClassReader::rep() const {
  return static_cast<ClassRep&>(QualifiedReader::rep());
}

Boolean ClassReader::isAssociation() const {
  return rep().hasTrueQualifier(CIMName("Association"));
}
Boolean ClassReader::isAbstract() const {
  return rep().hasTrueQualifier(CIMName("Abstract"));
}
const CIMName& ClassReader::getSuperClassName() const {
  return rep().superClassName;
}
Uint32 ClassReader::findMethod(const CIMName& name) const {
  return rep().methods.find(name);
}
CIMConstMethod ClassReader::getMethod(Uint32 index) const {
  return HandleAccess::handle<CIMConstMethod>(rep().methods.at(index));
}
Uint32 ClassReader::getMethodCount() const {
  return rep().methods.size();
}

void ClassReader::getKeyNames(Array<CIMName>& keyNames) const {
  const CIMName key("Key");
  const ElementList<PropertyRep>& properties = rep().properties;
  for (Uint32 i = 0; i < properties.size(); ++i) {
    if (properties.at(i)->hasTrueQualifier(key)) keyNames.append(properties.at(i)->name());
  }
}

Boolean ClassReader::hasKeys() const {
  Array<CIMName> keyNames;
  getKeyNames(keyNames);
  return keyNames.size() > 0;
}

CIMInstance ClassReader::buildInstance(Boolean includeQualifiers, Boolean includeClassOrigin,
                                       const CIMPropertyList& propertyList) const {
  const ClassRep& source = rep();
  Ref<InstanceRep> built(new InstanceRep(getClassName()));
  for (Uint32 i = 0; includeQualifiers && i < source.qualifiers.size(); ++i) {
    built->qualifiers.add(Ref<QualifierRep>(new QualifierRep(*source.qualifiers.at(i))));
  }
  for (Uint32 i = 0; i < source.properties.size(); ++i) {
    const PropertyRep& property = *source.properties.at(i);
    if (!propertyList.useThisProperty(property.name())) continue;
    Ref<PropertyRep> copy(new PropertyRep(property));
    if (!includeQualifiers) copy->qualifiers.clear();
    if (!includeClassOrigin) copy->classOrigin.clear();
    built->properties.add(copy);
  }
  return HandleAccess::handle<CIMInstance>(std::move(built));
}

Boolean ClassReader::identical(const CIMConstClass& other) const {
  return rep().identical(*HandleAccess::rep<ObjectRep>(other));
}

CIMClass ClassReader::clone() const {
  return HandleAccess::handle<CIMClass>(Ref<ClassRep>(rep().clone()));
}

CIMClass::CIMClass(const CIMObject& object) : ObjectHandle(HandleAccess::repOrNull(object)) {
  if (isUninitialized() || !object.isClass()) throw DynamicCastFailedException();
}

CIMClass::CIMClass(const CIMName& className, const CIMName& superClassName)
    : ObjectHandle(Ref<QualifiedRep>(new ClassRep(className, superClassName))) {}

void CIMClass::setSuperClassName(const CIMName& superClassName) {
  rep().superClassName = superClassName;
}
CIMClass& CIMClass::addMethod(const CIMMethod& method) {
  rep().methods.add(HandleAccess::rep<MethodRep>(method));
  return *this;
}
CIMMethod CIMClass::getMethod(Uint32 index) {
  return HandleAccess::handle<CIMMethod>(rep().methods.changeable(index));
}
void CIMClass::removeMethod(Uint32 index) {
  rep().methods.remove(index);
}

PEGASUS_NAMESPACE_END
