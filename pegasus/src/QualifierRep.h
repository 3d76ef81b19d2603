#pragma once

#include <Pegasus/Common/CIMFlavor.h>
#include <Pegasus/Common/CIMValue.h>

#include "Element.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of a qualifier refer to.
class QualifierRep final : public Element {
 public:
  static constexpr const char* kKind = "qualifier";
  static constexpr bool kSharedByCopies = true;

  QualifierRep(const CIMName& name, const CIMValue& initialValue, const CIMFlavor& initialFlavor,
               Boolean isPropagated)
      : Element(name), value(initialValue), flavor(initialFlavor), propagated(isPropagated) {}

  bool freezeParts() const { return true; }
  bool identical(const QualifierRep& other) const {
    return name() == other.name() && value == other.value && flavor.equal(other.flavor) &&
           propagated == other.propagated;
  }

  CIMValue value;
  CIMFlavor flavor;
  Boolean propagated;
};

PEGASUS_NAMESPACE_END
