#pragma once

#include "cimhost/repository/QualifierTable.h"

#include <Pegasus/Common/CIMClass.h>

namespace cimhost {

/// Joins a declared class with its resolved superclass (DSP0004, 5.6.1 and 5.6.3 on propagation).
///
/// Properties that are inherited and not overridden come first, in the superclass's order, then
/// the declared ones in theirs; methods likewise. Class origins and propagated flags are set.
/// Qualifiers are those written plus those that propagate; defaults are not filled in.
/// Throws ClassDeclarationError.
class ClassResolver {
 public:
  /// `superclass` is uninitialized for a root class. Features that a class and its superclass have
  /// in common are one shared object, so neither may be changed afterwards.
  ClassResolver(const QualifierTable& qualifiers, const Pegasus::CIMClass& superclass)
      : qualifiers_(qualifiers), superclass_(superclass) {}

  Pegasus::CIMClass resolve(const Pegasus::CIMConstClass& declared) const;

 private:
  const QualifierTable& qualifiers_;
  Pegasus::CIMClass superclass_;
};

}  // namespace cimhost
