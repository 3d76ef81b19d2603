#pragma once

#include "cimhost/repository/ClassDeclarationError.h"
#include "cimhost/repository/QualifierTable.h"

namespace cimhost {

/// Gives one element its qualifiers: those written on it and those that propagate to it.
class QualifierMerge {
 public:
  /// `scope`: the QualifierScope bits that fit the element; one common bit suffices.
  QualifierMerge(const QualifierTable& table, unsigned scope, ClassDeclarationError::Part part)
      : table_(table), scope_(scope), part_(std::move(part)) {}

  /// Adds the qualifiers of `own` (an element as declared) and of `inherited` (the element that it
  /// overrides or subclasses, resolved) to `target`, which has none yet. Either may be nullptr.
  /// Throws ClassDeclarationError: unknown, wrong type or place, change of a fixed value.
  template <class Target, class Source>
  void run(Target& target, const Source* own, const Source* inherited) {
    using Pegasus::Uint32;
    for (Uint32 i = 0; own != nullptr && i < own->getQualifierCount(); ++i) {
      const Pegasus::CIMConstQualifier qualifier = own->getQualifier(i);
      target.addQualifier(ownQualifier(qualifier, inheritedQualifier(inherited, qualifier)));
    }
    for (Uint32 i = 0; inherited != nullptr && i < inherited->getQualifierCount(); ++i) {
      const Pegasus::CIMConstQualifier qualifier = inherited->getQualifier(i);
      if (!propagates(qualifier)) continue;
      if (target.findQualifier(qualifier.getName()) != PEG_NOT_FOUND) continue;
      target.addQualifier(propagated(qualifier));
    }
  }

 private:
  template <class Source>
  static Pegasus::CIMConstQualifier inheritedQualifier(
      const Source* inherited, const Pegasus::CIMConstQualifier& qualifier) {
    if (inherited == nullptr) return {};
    using Pegasus::Uint32;
    const Uint32 index = inherited->findQualifier(qualifier.getName());
    return index == PEG_NOT_FOUND ? Pegasus::CIMConstQualifier() : inherited->getQualifier(index);
  }

  static bool propagates(const Pegasus::CIMConstQualifier& qualifier);
  static Pegasus::CIMQualifier propagated(const Pegasus::CIMConstQualifier& qualifier);
  Pegasus::CIMQualifier ownQualifier(const Pegasus::CIMConstQualifier& declared,
                                     const Pegasus::CIMConstQualifier& inherited) const;
  const QualifierDeclaration& declarationOf(const Pegasus::CIMConstQualifier& qualifier) const;
  [[noreturn]] void fail(const Pegasus::CIMConstQualifier& qualifier, const char* problem) const;

  const QualifierTable& table_;
  unsigned scope_;
  ClassDeclarationError::Part part_;
};

}  // namespace cimhost
