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
  /// `qualifiers` must outlive the resolver.
  explicit ClassResolver(const QualifierTable& qualifiers) : qualifiers_(qualifiers) {}

  /// What a resolved class passes on: its features as propagated ones, without the qualifiers that
  /// are restricted to it. Shares properties with `resolved`; neither may be changed afterwards.
  Pegasus::CIMClass inheritable(Pegasus::CIMClass resolved) const;

  /// `superclass` is what inheritable() made of it, or uninitialized for a root class. The result
  /// shares inherited properties with it; neither may be changed afterwards.
  Pegasus::CIMClass resolve(const Pegasus::CIMConstClass& declared,
                            Pegasus::CIMClass superclass) const;

 private:
  const QualifierTable& qualifiers_;
};

}  // namespace cimhost
