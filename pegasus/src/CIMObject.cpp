#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMObject.h>

#include "ClassRep.h"
#include "HandleAccess.h"
#include "InstanceRep.h"

PEGASUS_NAMESPACE_BEGIN

void ObjectRep::setPath(const CIMObjectPath& newPath) {
  if (newPath.getClassName().isNull()) throw UninitializedObjectException();
  if (newPath.getClassName() != path_.getClassName()) throw TypeMismatchException();
  path_ = newPath;
}

void ObjectRep::filter(Boolean includeQualifiers, Boolean includeClassOrigin,
                       const CIMPropertyList& propertyList) {
  if (!includeQualifiers) qualifiers.clear();
  for (Uint32 i = properties.size(); i-- > 0;) {
    if (!propertyList.useThisProperty(properties.at(i)->name())) {
      properties.remove(i);
      continue;
    }
    PropertyRep& property = *properties.at(i);
    if (!includeQualifiers) property.qualifiers.clear();
    if (!includeClassOrigin) property.classOrigin.clear();
  }
}

bool ObjectRep::sameContent(const ObjectRep& other) const {
  return path_ == other.path_ && qualifiers.identical(other.qualifiers) &&
         properties.identical(other.properties);
}

ObjectRep& ObjectReader::rep() const {
  return static_cast<ObjectRep&>(QualifiedReader::rep());
}

const CIMName& ObjectReader::getClassName() const {
  return rep().path().getClassName();
}
const CIMObjectPath& ObjectReader::getPath() const {
  return rep().path();
}
Uint32 ObjectReader::findProperty(const CIMName& name) const {
  return rep().properties.find(name);
}
CIMConstProperty ObjectReader::getProperty(Uint32 index) const {
  return HandleAccess::handle<CIMConstProperty>(rep().properties.at(index));
}
Uint32 ObjectReader::getPropertyCount() const {
  return rep().properties.size();
}

void ObjectReader::changePath(const CIMObjectPath& path) {
  rep().setPath(path);
}
void ObjectReader::appendProperty(const CIMProperty& property) {
  const Ref<PropertyRep> added = HandleAccess::rep<PropertyRep>(property);
  ObjectRep& object = rep();
  object.checkProperty(*added);
  object.properties.add(added);
}
CIMProperty ObjectReader::changeableProperty(Uint32 index) {
  return HandleAccess::handle<CIMProperty>(rep().properties.changeable(index));
}
void ObjectReader::eraseProperty(Uint32 index) {
  rep().properties.remove(index);
}
void ObjectReader::filterProperties(Boolean includeQualifiers, Boolean includeClassOrigin,
                                    const CIMPropertyList& propertyList) {
  rep().filter(includeQualifiers, includeClassOrigin, propertyList);
}

Boolean AnyObjectReader::isClass() const {
  return dynamic_cast<const ClassRep*>(HandleAccess::repOrNull(*this).get()) != nullptr;
}
Boolean AnyObjectReader::isInstance() const {
  return dynamic_cast<const InstanceRep*>(HandleAccess::repOrNull(*this).get()) != nullptr;
}
Boolean AnyObjectReader::identical(const CIMConstObject& other) const {
  return rep().identical(*HandleAccess::rep<ObjectRep>(other));
}
CIMObject AnyObjectReader::clone() const {
  return HandleAccess::handle<CIMObject>(Ref<ObjectRep>(rep().clone()));
}

CIMObject::CIMObject(const CIMClass& cimClass) : ObjectHandle(HandleAccess::repOrNull(cimClass)) {}
CIMObject::CIMObject(const CIMInstance& instance)
    : ObjectHandle(HandleAccess::repOrNull(instance)) {}

void CIMObject::instanceFilter(Boolean includeQualifiers, Boolean includeClassOrigin,
                               const CIMPropertyList& propertyList) {
  filterProperties(includeQualifiers, includeClassOrigin, propertyList);
}

CIMConstObject::CIMConstObject(const CIMClass& cimClass)
    : AnyObjectReader(HandleAccess::repOrNull(cimClass)) {}
CIMConstObject::CIMConstObject(const CIMInstance& instance)
    : AnyObjectReader(HandleAccess::repOrNull(instance)) {}
CIMConstObject::CIMConstObject(const CIMConstClass& cimClass)
    : AnyObjectReader(HandleAccess::repOrNull(cimClass)) {}
CIMConstObject::CIMConstObject(const CIMConstInstance& instance)
    : AnyObjectReader(HandleAccess::repOrNull(instance)) {}

PEGASUS_NAMESPACE_END
