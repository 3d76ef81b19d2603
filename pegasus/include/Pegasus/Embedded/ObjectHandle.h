// What the handles of classes, instances and objects share.
#pragma once

#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Embedded/QualifiedHandle.h>

PEGASUS_NAMESPACE_BEGIN

class CIMConstProperty;
class CIMProperty;
class CIMPropertyList;
class ObjectRep;

/// The reading half.
class PEGASUS_COMMON_LINKAGE ObjectReader : public QualifiedReader {
 public:
  const CIMName& getClassName() const;
  /// Shows later setPath calls, too.
  const CIMObjectPath& getPath() const;
  /// The index, ignoring letter case, or PEG_NOT_FOUND (also for a null name).
  Uint32 findProperty(const CIMName& name) const;
  /// Throws IndexOutOfBoundsException.
  CIMConstProperty getProperty(Uint32 index) const;
  Uint32 getPropertyCount() const;

 protected:
  using QualifiedReader::QualifiedReader;
  ObjectReader() = default;
  ObjectRep& rep() const;

  void changePath(const CIMObjectPath& path);
  void appendProperty(const CIMProperty& property);
  CIMProperty changeableProperty(Uint32 index);
  void eraseProperty(Uint32 index);
  void filterProperties(Boolean includeQualifiers, Boolean includeClassOrigin,
                        const CIMPropertyList& propertyList);
};

/// The changing half: X is the handle class, Reader its reading half.
template <class X, class Reader>
class ObjectHandle : public QualifiedHandle<X, Reader> {
 public:
  using Reader::getProperty;

  /// Throws TypeMismatchException for another class, UninitializedObjectException for a null one.
  void setPath(const CIMObjectPath& path) { this->changePath(path); }
  /// The object refers to the property from now on. Throws AlreadyExistsException for a name (in
  /// any letter case) that is there already.
  X& addProperty(const CIMProperty& property) {
    this->appendProperty(property);
    return static_cast<X&>(*this);
  }
  // Defined where CIMProperty is complete.
  CIMProperty getProperty(Uint32 index);
  void removeProperty(Uint32 index) { this->eraseProperty(index); }

 protected:
  using QualifiedHandle<X, Reader>::QualifiedHandle;
};

PEGASUS_NAMESPACE_END
