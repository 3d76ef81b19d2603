// What the handles of everything that has qualifiers share.
#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Embedded/Shareable.h>

PEGASUS_NAMESPACE_BEGIN

class CIMConstQualifier;
class CIMQualifier;
class QualifiedRep;
struct HandleAccess;

/// The reading half: base of properties, parameters, methods, classes, instances and objects.
///
/// Every member but isUninitialized throws UninitializedObjectException on an empty handle.
class PEGASUS_COMMON_LINKAGE QualifiedReader {
 public:
  /// The index, ignoring letter case, or PEG_NOT_FOUND (also for a null name).
  Uint32 findQualifier(const CIMName& name) const;
  /// Throws IndexOutOfBoundsException.
  CIMConstQualifier getQualifier(Uint32 index) const;
  Uint32 getQualifierCount() const;
  Boolean isUninitialized() const;

 protected:
  QualifiedReader() = default;
  explicit QualifiedReader(Ref<QualifiedRep> rep) : rep_(std::move(rep)) {}
  ~QualifiedReader() = default;
  QualifiedReader(const QualifiedReader&) = default;
  QualifiedReader(QualifiedReader&&) = default;
  QualifiedReader& operator=(const QualifiedReader&) = default;
  QualifiedReader& operator=(QualifiedReader&&) = default;

  /// The object behind the handle; throws UninitializedObjectException when there is none.
  QualifiedRep& rep() const;
  void appendQualifier(const CIMQualifier& qualifier);
  CIMQualifier changeableQualifier(Uint32 index);
  void eraseQualifier(Uint32 index);

  friend struct HandleAccess;
  Ref<QualifiedRep> rep_;
};

/// The changing half: X is the handle class, Reader its reading half.
template <class X, class Reader>
class QualifiedHandle : public Reader {
 public:
  using Reader::getQualifier;

  /// Throws AlreadyExistsException for a name (in any letter case) that is there already.
  X& addQualifier(const CIMQualifier& qualifier) {
    this->appendQualifier(qualifier);
    return static_cast<X&>(*this);
  }
  // Defined where CIMQualifier is complete.
  CIMQualifier getQualifier(Uint32 index);
  void removeQualifier(Uint32 index) { this->eraseQualifier(index); }

 protected:
  using Reader::Reader;
};

PEGASUS_NAMESPACE_END
