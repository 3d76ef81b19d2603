#pragma once

#include "ParameterRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of a method refer to.
class MethodRep final : public QualifiedRep {
 public:
  static constexpr const char* kKind = "method";
  static constexpr bool kSharedByCopies = true;

  MethodRep(const CIMName& name, CIMType returnType, const CIMName& origin, Boolean isPropagated)
      : QualifiedRep(name), type(returnType), classOrigin(origin), propagated(isPropagated) {}

  bool freezeParts() const {
    // Both: what can be frozen is to be frozen even where the other part cannot.
    const bool parametersFrozen = parameters.freeze();
    return QualifiedRep::freezeParts() && parametersFrozen;
  }
  bool identical(const MethodRep& other) const;

  CIMType type;
  CIMName classOrigin;
  Boolean propagated;
  ElementList<ParameterRep> parameters;
};

PEGASUS_NAMESPACE_END
