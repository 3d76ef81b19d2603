#pragma once

#include "MethodRep.h"
#include "ObjectRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of a class refer to.
class ClassRep final : public ObjectRep {
 public:
  ClassRep(const CIMName& className, const CIMName& superClass)
      : ObjectRep(className), superClassName(superClass) {}

  ClassRep* clone() const override { return new ClassRep(*this); }
  bool identical(const ObjectRep& other) const override;
  void checkProperty(const PropertyRep& property) const override;

  CIMName superClassName;
  ElementList<MethodRep> methods;
};

PEGASUS_NAMESPACE_END
