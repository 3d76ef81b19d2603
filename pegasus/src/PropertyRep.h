#pragma once

#include <Pegasus/Common/CIMValue.h>

#include "QualifiedRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of a property refer to.
class PropertyRep final : public QualifiedRep {
 public:
  static constexpr const char* kKind = "property";
  // Every class and instance has property objects of its own, so that references to their values
  // stay valid as long as the container; most of their content is shared all the same.
  static constexpr bool kSharedByCopies = false;

  PropertyRep(const CIMName& name, const CIMValue& initialValue, Uint32 fixedSize,
              const CIMName& referenceClass, const CIMName& origin, Boolean isPropagated);

  void setValue(const CIMValue& newValue);
  bool identical(const PropertyRep& other) const;
  const CIMValue& value() const { return value_; }
  Uint32 arraySize() const { return arraySize_; }
  const CIMName& referenceClassName() const { return referenceClassName_; }

  CIMName classOrigin;
  Boolean propagated;

 private:
  CIMValue value_;
  Uint32 arraySize_;
  CIMName referenceClassName_;
};

PEGASUS_NAMESPACE_END
