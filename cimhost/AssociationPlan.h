#pragma once

#include "cimhost/ServedClasses.h"
#include "cimhost/repository/ClassRepository.h"

#include <Pegasus/Common/String.h>

#include <vector>

namespace cimhost {

/// What a client wants of the objects that are linked to one object (DSP0200, Associators).
struct AssociationFilter {
  Pegasus::CIMName associationClass;  ///< Null: any; else this class or a subclass.
  Pegasus::CIMName resultClass;       ///< Null: any; else this class or a subclass.
  Pegasus::String role;               ///< Empty: any; else the reference that leads to the object.
  Pegasus::String resultRole;         ///< Empty: any; else the reference that leads to the results.
};

/// Which association classes a provider is asked for, and which of its results the client wants.
///
/// A served association class takes part when one of its references is declared for the object's
/// class or a superclass of it, and another one leads to the results. A filter is applied to the
/// declarations and to the class of each result. Where both ends of an association are declared for
/// one class, the roles cannot tell its results apart. For one request.
class AssociationPlan {
 public:
  struct Step {
    Pegasus::CIMName associationClass;
    std::vector<Pegasus::CIMName> resultClasses;  ///< Declared where the results stand.
  };

  /// `repository` must outlive the plan. Throws CIM_ERR_INVALID_PARAMETER when the filter names a
  /// class that is not declared.
  AssociationPlan(const ClassRepository& repository, const ServedClasses& served,
                  const Pegasus::CIMNamespaceName& nameSpace, const Pegasus::CIMName& objectClass,
                  const AssociationFilter& filter);

  /// In order of the definitions, each class once.
  const std::vector<Step>& steps() const { return steps_; }

  /// True when the client wants an object of class `name` as a result of `step`.
  bool wantsResult(const Step& step, const Pegasus::CIMName& name) const;
  /// True when it wants an object of the association class `name` as a reference (References).
  bool wantsReference(const Step& step, const Pegasus::CIMName& name) const;

 private:
  void requireDeclared(const Pegasus::CIMName& name) const;
  bool isWithin(const Pegasus::CIMName& name, const Pegasus::CIMName& ancestor) const;
  Step makeStep(const Pegasus::CIMName& associationClass,
                const Pegasus::CIMName& objectClass) const;

  const ClassRepository& repository_;
  Pegasus::CIMNamespaceName nameSpace_;
  AssociationFilter filter_;
  std::vector<Step> steps_;
};

}  // namespace cimhost
