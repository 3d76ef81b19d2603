#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/Exception.h>
#include <Pegasus/Common/String.h>

PEGASUS_NAMESPACE_BEGIN

/// The name of a class, property, method, parameter or qualifier.
///
/// Null only by default construction or clear(); its text is then empty. Equality ignores the case
/// of A-Z, the text keeps it.
class PEGASUS_COMMON_LINKAGE CIMName {
 public:
  CIMName();
  /// Throws InvalidNameException unless legal().
  CIMName(const String& name);
  CIMName(const char* name);

  CIMName& operator=(const String& name);

  const String& getString() const;
  Boolean isNull() const;
  void clear();
  Boolean equal(const CIMName& name) const;
  /// A letter, `_` or U+0080..U+FFEF, then also digits.
  static Boolean legal(const String& name);

 private:
  String name_;
};

PEGASUS_COMMON_LINKAGE bool operator==(const CIMName& name1, const CIMName& name2);
PEGASUS_COMMON_LINKAGE bool operator!=(const CIMName& name1, const CIMName& name2);

/// The name of a namespace; a leading `/` is dropped.
///
/// Null only by default construction or clear(); its text is then empty. Equality ignores the case
/// of A-Z, the text keeps it.
class PEGASUS_COMMON_LINKAGE CIMNamespaceName {
 public:
  CIMNamespaceName();
  /// Throws InvalidNamespaceNameException unless legal().
  CIMNamespaceName(const String& name);
  CIMNamespaceName(const char* name);

  CIMNamespaceName& operator=(const String& name);

  const String& getString() const;
  Boolean isNull() const;
  void clear();
  Boolean equal(const CIMNamespaceName& name) const;
  /// Legal CIM names separated by single `/`, with at most one `/` in front.
  static Boolean legal(const String& name);

 private:
  String name_;
};

PEGASUS_COMMON_LINKAGE bool operator==(const CIMNamespaceName& name1,
                                       const CIMNamespaceName& name2);
PEGASUS_COMMON_LINKAGE bool operator!=(const CIMNamespaceName& name1,
                                       const CIMNamespaceName& name2);

PEGASUS_NAMESPACE_END
