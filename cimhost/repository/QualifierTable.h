#pragma once

#include "cimhost/repository/NameHash.h"
#include "cimhost/repository/QualifierScope.h"

#include <Pegasus/Common/CIMQualifier.h>

#include <unordered_map>
#include <vector>

namespace cimhost {

/// A declared qualifier: type, default value and flavor in `qualifier`, and where it may stand.
struct QualifierDeclaration {
  Pegasus::CIMQualifier qualifier;
  unsigned scope = QualifierScope::kAny;
};

/// The qualifiers of one namespace: what was added, then the standard ones.
class QualifierTable {
 public:
  /// Replaces a declaration of the same name.
  void add(const QualifierDeclaration& declaration);

  /// nullptr when there is none; else valid until the next add() of that name.
  const QualifierDeclaration* find(const Pegasus::CIMName& name) const;

  /// All of them, the standard ones included, sorted by name.
  std::vector<QualifierDeclaration> all() const;

 private:
  std::unordered_map<Pegasus::CIMName, QualifierDeclaration, NameHash, NameEqual> declarations_;
};

/// A standard qualifier of DSP0004, section 5.6.3, or nullptr.
const QualifierDeclaration* findStandardQualifier(const Pegasus::CIMName& name);

/// All standard qualifiers.
std::vector<QualifierDeclaration> standardQualifiers();

}  // namespace cimhost
