// A CIM qualifier.
#pragma once

#include <Pegasus/Common/CIMFlavor.h>
#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Embedded/QualifiedHandle.h>
#include <Pegasus/Embedded/Shareable.h>

PEGASUS_NAMESPACE_BEGIN

class CIMQualifier;
class CIMConstQualifier;
class CIMValue;
class QualifierRep;

/// The members that CIMQualifier and CIMConstQualifier have in common.
///
/// Every member but isUninitialized throws UninitializedObjectException on an empty handle.
class PEGASUS_COMMON_LINKAGE QualifierReader {
 public:
  const CIMName& getName() const;
  CIMType getType() const;
  Boolean isArray() const;
  const CIMValue& getValue() const;
  const CIMFlavor& getFlavor() const;
  Uint32 getPropagated() const;
  Boolean isUninitialized() const;
  Boolean identical(const CIMConstQualifier& other) const;
  CIMQualifier clone() const;

 protected:
  QualifierReader() = default;
  explicit QualifierReader(Ref<QualifierRep> rep) : rep_(std::move(rep)) {}
  QualifierRep& rep() const;

  friend struct HandleAccess;
  Ref<QualifierRep> rep_;
};

/// A handle: copies refer to the same qualifier, clone() makes another one.
class PEGASUS_COMMON_LINKAGE CIMQualifier : public QualifierReader {
 public:
  CIMQualifier() = default;
  /// Throws UninitializedObjectException for a null name.
  CIMQualifier(const CIMName& name, const CIMValue& value,
               const CIMFlavor& flavor = CIMFlavor(CIMFlavor::NONE), Boolean propagated = false);

  /// Throws Exception when the name changes while the qualifier is in a container.
  void setName(const CIMName& name);
  /// Takes a value of any type.
  void setValue(const CIMValue& value);
  void setFlavor(const CIMFlavor& flavor);
  void unsetFlavor(const CIMFlavor& flavor);
  void setPropagated(Boolean propagated);

 private:
  friend struct HandleAccess;
  explicit CIMQualifier(Ref<QualifierRep> rep) : QualifierReader(std::move(rep)) {}
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstQualifier : public QualifierReader {
 public:
  CIMConstQualifier() = default;
  CIMConstQualifier(const CIMQualifier& qualifier) : QualifierReader(qualifier) {}

 private:
  friend struct HandleAccess;
  explicit CIMConstQualifier(Ref<QualifierRep> rep) : QualifierReader(std::move(rep)) {}
};

template <class X, class Reader>
CIMQualifier QualifiedHandle<X, Reader>::getQualifier(Uint32 index) {
  return this->changeableQualifier(index);
}

PEGASUS_NAMESPACE_END
