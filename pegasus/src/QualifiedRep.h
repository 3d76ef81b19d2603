#pragma once

#include "ElementList.h"
#include "QualifierRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of everything that has qualifiers refer to.
class QualifiedRep : public Element {
 public:
  using Element::Element;

  bool freezeParts() const { return qualifiers.freeze(); }
  /// A Boolean qualifier of that name is there and TRUE. TypeMismatchException for an array of
  /// them.
  bool hasTrueQualifier(const CIMName& qualifierName) const;

  ElementList<QualifierRep> qualifiers;

 protected:
  bool sameNameAndQualifiers(const QualifiedRep& other) const {
    return name() == other.name() && qualifiers.identical(other.qualifiers);
  }
};

PEGASUS_NAMESPACE_END
