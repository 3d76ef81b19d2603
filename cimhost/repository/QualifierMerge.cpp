#include "cimhost/repository/QualifierMerge.h"

namespace cimhost {

using Pegasus::CIMConstQualifier;
using Pegasus::CIMFlavor;
using Pegasus::CIMQualifier;
using Pegasus::String;
using Pegasus::Uint32;

bool QualifierMerge::propagates(const CIMConstQualifier& qualifier) {
  const CIMFlavor& flavor = qualifier.getFlavor();
  return flavor.hasFlavor(CIMFlavor::TOSUBCLASS) && !flavor.hasFlavor(CIMFlavor::RESTRICTED);
}

// A propagated qualifier is never changed, so subclasses of subclasses hold copies that are cheap.
CIMQualifier QualifierMerge::propagated(const CIMConstQualifier& qualifier) {
  CIMQualifier copy = qualifier.clone();
  copy.setPropagated(true);
  return copy;
}

void QualifierMerge::fail(const CIMConstQualifier& qualifier, const char* problem) const {
  ClassDeclarationError::Part part = part_;
  part.qualifier = qualifier.getName();
  const String name = qualifier.getName().getString();
  throw ClassDeclarationError(Pegasus::CIM_ERR_INVALID_PARAMETER,
                              String("qualifier '") + name + String("' ") + String(problem), part);
}

const QualifierDeclaration& QualifierMerge::declarationOf(
    const CIMConstQualifier& qualifier) const {
  const QualifierDeclaration* declaration = table_.find(qualifier.getName());
  if (declaration == nullptr) fail(qualifier, "is not declared");
  if (!declaration->qualifier.getValue().typeCompatible(qualifier.getValue())) {
    fail(qualifier, "has a value of another type than declared");
  }
  if ((declaration->scope & scope_) == 0) fail(qualifier, "is not allowed here");
  return *declaration;
}

CIMQualifier QualifierMerge::ownQualifier(const CIMConstQualifier& declared,
                                          const CIMConstQualifier& inherited) const {
  const CIMFlavor& general = declarationOf(declared).qualifier.getFlavor();
  // What a declaration fixes stays fixed, or a flavor on one element would undo a key.
  const bool keepsGeneral =
      general.hasFlavor(CIMFlavor::DISABLEOVERRIDE) || declared.getFlavor().equal(CIMFlavor::NONE);
  CIMFlavor flavor = keepsGeneral ? general : declared.getFlavor();
  if (!inherited.isUninitialized() && propagates(inherited) &&
      inherited.getFlavor().hasFlavor(CIMFlavor::DISABLEOVERRIDE)) {
    if (!declared.getValue().equal(inherited.getValue())) {
      fail(declared, "cannot be overridden: the superclass fixes its value");
    }
    flavor = inherited.getFlavor();
  }
  return CIMQualifier(declared.getName(), declared.getValue(), flavor, false);
}

}  // namespace cimhost
