#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>

#include "HandleAccess.h"
#include "InstanceRep.h"

PEGASUS_NAMESPACE_BEGIN

bool InstanceRep::identical(const ObjectRep& other) const {
  return sameContent(other);
}

Boolean InstanceReader::identical(const CIMConstInstance& other) const {
  return rep().identical(*HandleAccess::rep<ObjectRep>(other));
}

CIMInstance InstanceReader::clone() const {
  return HandleAccess::handle<CIMInstance>(Ref<ObjectRep>(rep().clone()));
}

CIMObjectPath InstanceReader::buildPath(const CIMConstClass& cimClass) const {
  Array<CIMName> keyNames;
  cimClass.getKeyNames(keyNames);
  Array<CIMKeyBinding> keyBindings;
  for (Uint32 i = 0; i < keyNames.size(); ++i) {
    const Uint32 index = findProperty(keyNames[i]);
    if (index == PEG_NOT_FOUND) {
      throw Exception(String("no such property: ") + keyNames[i].getString());
    }
    keyBindings.append(CIMKeyBinding(keyNames[i], rep().properties.at(index)->value()));
  }
  return CIMObjectPath(String(), CIMNamespaceName(), getClassName(), keyBindings);
}

CIMInstance::CIMInstance(const CIMObject& object) : ObjectHandle(HandleAccess::repOrNull(object)) {
  if (isUninitialized() || !object.isInstance()) throw DynamicCastFailedException();
}

CIMInstance::CIMInstance(const CIMName& className)
    : ObjectHandle(Ref<QualifiedRep>(new InstanceRep(className))) {}

void CIMInstance::instanceFilter(Boolean includeQualifiers, Boolean includeClassOrigin,
                                 const CIMPropertyList& propertyList) {
  filterProperties(includeQualifiers, includeClassOrigin, propertyList);
}

PEGASUS_NAMESPACE_END
