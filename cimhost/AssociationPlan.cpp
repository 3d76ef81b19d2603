#include "cimhost/AssociationPlan.h"

#include <algorithm>

namespace cimhost {

using namespace Pegasus;

namespace {

std::vector<CIMConstProperty> referencesOf(const CIMClass& declaration) {
  const CIMConstClass object(declaration);
  std::vector<CIMConstProperty> references;
  for (Uint32 i = 0; i < object.getPropertyCount(); ++i) {
    const CIMConstProperty property = object.getProperty(i);
    if (property.getType() == CIMTYPE_REFERENCE) references.push_back(property);
  }
  return references;
}

bool hasRole(const CIMConstProperty& reference, const String& role) {
  return role.size() == 0 || String::equalNoCase(reference.getName().getString(), role);
}

}  // namespace

AssociationPlan::AssociationPlan(const ClassRepository& repository, const ServedClasses& served,
                                 const CIMNamespaceName& nameSpace, const CIMName& objectClass,
                                 const AssociationFilter& filter)
    : repository_(repository), nameSpace_(nameSpace), filter_(filter) {
  requireDeclared(filter.associationClass);
  requireDeclared(filter.resultClass);
  for (const CIMName& name : served.associations(nameSpace)) {
    if (!repository.hasClass(nameSpace, name) || !isWithin(name, filter.associationClass)) continue;
    Step step = makeStep(name, objectClass);
    if (!step.resultClasses.empty()) steps_.push_back(std::move(step));
  }
}

void AssociationPlan::requireDeclared(const CIMName& name) const {
  if (name.isNull() || repository_.hasClass(nameSpace_, name)) return;
  throw CIMException(CIM_ERR_INVALID_PARAMETER, name.getString());
}

// Everything is within a null class.
bool AssociationPlan::isWithin(const CIMName& name, const CIMName& ancestor) const {
  return ancestor.isNull() || repository_.isSubclass(nameSpace_, name, ancestor);
}

AssociationPlan::Step AssociationPlan::makeStep(const CIMName& associationClass,
                                                const CIMName& objectClass) const {
  Step step{associationClass, {}};
  const std::vector<CIMConstProperty> references = referencesOf(
      repository_.getClass(nameSpace_, associationClass, false, true, true, CIMPropertyList()));
  for (std::size_t from = 0; from < references.size(); ++from) {
    const CIMConstProperty& source = references[from];
    if (!hasRole(source, filter_.role)) continue;
    if (!repository_.isSubclass(nameSpace_, objectClass, source.getReferenceClassName())) continue;
    for (std::size_t to = 0; to < references.size(); ++to) {
      if (to == from || !hasRole(references[to], filter_.resultRole)) continue;
      step.resultClasses.push_back(references[to].getReferenceClassName());
    }
  }
  return step;
}

bool AssociationPlan::wantsResult(const Step& step, const CIMName& name) const {
  if (!isWithin(name, filter_.resultClass)) return false;
  if (filter_.role.size() == 0 && filter_.resultRole.size() == 0) return true;
  return std::any_of(step.resultClasses.begin(), step.resultClasses.end(),
                     [&](const CIMName& declared) { return isWithin(name, declared); });
}

bool AssociationPlan::wantsReference(const Step&, const CIMName& name) const {
  return isWithin(name, filter_.associationClass);
}

}  // namespace cimhost
