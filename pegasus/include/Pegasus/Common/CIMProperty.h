// A CIM property.
#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Embedded/ObjectHandle.h>
#include <Pegasus/Embedded/QualifiedHandle.h>

PEGASUS_NAMESPACE_BEGIN

class CIMValue;
class CIMProperty;
class CIMConstProperty;
class PropertyRep;

/// The members that CIMProperty and CIMConstProperty have in common.
class PEGASUS_COMMON_LINKAGE PropertyReader : public QualifiedReader {
 public:
  const CIMName& getName() const;
  /// Shows later setValue calls, too.
  const CIMValue& getValue() const;
  CIMType getType() const;
  Boolean isArray() const;
  /// The declared fixed size; 0 means variable.
  Uint32 getArraySize() const;
  const CIMName& getReferenceClassName() const;
  const CIMName& getClassOrigin() const;
  Boolean getPropagated() const;
  Boolean identical(const CIMConstProperty& other) const;
  CIMProperty clone() const;

 protected:
  using QualifiedReader::QualifiedReader;
  PropertyReader() = default;
  PropertyRep& rep() const;
};

/// A handle: copies refer to the same property, clone() makes another one.
class PEGASUS_COMMON_LINKAGE CIMProperty : public QualifiedHandle<CIMProperty, PropertyReader> {
 public:
  CIMProperty() = default;
  /// Throws UninitializedObjectException for a null name. Throws TypeMismatchException for an array
  /// of references, for a fixed size that is not the value's, and for the name of a referenced
  /// class when the value is no reference.
  CIMProperty(const CIMName& name, const CIMValue& value, Uint32 arraySize = 0,
              const CIMName& referenceClassName = CIMName(), const CIMName& classOrigin = CIMName(),
              Boolean propagated = false);

  /// Throws Exception when the name changes while the property is in a container.
  void setName(const CIMName& name);
  /// Throws TypeMismatchException for another type, array flag or fixed size.
  void setValue(const CIMValue& value);
  void setClassOrigin(const CIMName& classOrigin);
  void setPropagated(Boolean propagated);

 private:
  friend struct HandleAccess;
  using QualifiedHandle::QualifiedHandle;
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstProperty : public PropertyReader {
 public:
  CIMConstProperty() = default;
  CIMConstProperty(const CIMProperty& property) : PropertyReader(property) {}

 private:
  friend struct HandleAccess;
  using PropertyReader::PropertyReader;
};

template <class X, class Reader>
CIMProperty ObjectHandle<X, Reader>::getProperty(Uint32 index) {
  return this->changeableProperty(index);
}

PEGASUS_NAMESPACE_END
