#pragma once

#include "cimhost/repository/QualifierTable.h"

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMPropertyList.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <memory>
#include <string>
#include <vector>

namespace cimhost {

/// The declared classes of every namespace, with inheritance resolved.
///
/// Filled by the MOF reader while the host starts; read-only afterwards, when every const member
/// may be called from several threads at once. Class and namespace names ignore letter case. Errors
/// are Pegasus::CIMException: 3 (invalid namespace, text: the namespace), 6 (not found, text: the
/// class).
class ClassRepository {
 public:
  /// Knows the standard qualifiers of DSP0004 (types and flavors) in every namespace.
  ClassRepository();
  ~ClassRepository();
  ClassRepository(const ClassRepository&) = delete;
  ClassRepository& operator=(const ClassRepository&) = delete;

  /// Declares a namespace; one that exists already stays as it is. CIM_ERR_INVALID_NAMESPACE for a
  /// null name, CIM_ERR_FAILED for more than 4096.
  void addNamespace(const Pegasus::CIMNamespaceName& nameSpace);

  /// Adds a class as declared: own features only, superclass by name. Resolves inheritance at once;
  /// the superclass must be there (else CIM_ERR_INVALID_SUPERCLASS). A name that exists already in
  /// the namespace is CIM_ERR_ALREADY_EXISTS, another fault CIM_ERR_INVALID_PARAMETER; all three
  /// are ClassDeclarationError, which tells the part at fault. A qualifier without any flavor has
  /// that of its declaration. `declared` is not kept; one that was refused leaves no trace.
  void addClass(const Pegasus::CIMNamespaceName& nameSpace, const Pegasus::CIMClass& declared);

  /// Declares a qualifier for classes that are added to the namespace from now on: type, default
  /// value, flavor and the QualifierScope bits of the elements on which it may stand. Replaces a
  /// standard qualifier and an earlier declaration.
  void addQualifier(const Pegasus::CIMNamespaceName& nameSpace,
                    const Pegasus::CIMQualifier& declaration,
                    unsigned scope = QualifierScope::kAny);

  bool hasNamespace(const Pegasus::CIMNamespaceName& nameSpace) const;
  std::vector<Pegasus::CIMNamespaceName> namespaces() const;

  /// The declaration of a qualifier (a copy), or an uninitialized handle.
  Pegasus::CIMQualifier findQualifier(const Pegasus::CIMNamespaceName& nameSpace,
                                      const Pegasus::CIMName& name) const;

  /// All qualifier declarations, the standard ones included, sorted by name. Read them only.
  std::vector<QualifierDeclaration> qualifiers(const Pegasus::CIMNamespaceName& nameSpace) const;

  /// True when the namespace exists and has the class.
  bool hasClass(const Pegasus::CIMNamespaceName& nameSpace, const Pegasus::CIMName& name) const;

  /// A fresh object on every call: changing it never shows in a later one. With the flags false,
  /// true, true and a null list it costs no deep copy.
  Pegasus::CIMClass getClass(const Pegasus::CIMNamespaceName& nameSpace,
                             const Pegasus::CIMName& name, bool localOnly, bool includeQualifiers,
                             bool includeClassOrigin,
                             const Pegasus::CIMPropertyList& propertyList) const;

  /// Subclasses of `name` (of the whole namespace when null), direct ones or, with `deep`, all; in
  /// order of declaration, without `name` itself.
  std::vector<Pegasus::CIMName> subclassNames(const Pegasus::CIMNamespaceName& nameSpace,
                                              const Pegasus::CIMName& name, bool deep) const;

  /// True when `name` is `ancestor` or inherits from it; false when there is no such class.
  bool isSubclass(const Pegasus::CIMNamespaceName& nameSpace, const Pegasus::CIMName& name,
                  const Pegasus::CIMName& ancestor) const;

 private:
  struct Impl;
  std::unique_ptr<Impl> impl_;
};

}  // namespace cimhost
