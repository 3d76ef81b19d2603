// The list of the properties that a client asks for.
#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/CIMName.h>

PEGASUS_NAMESPACE_BEGIN

/// A value class. A null list means all properties, an empty one means none.
class PEGASUS_COMMON_LINKAGE CIMPropertyList {
 public:
  CIMPropertyList();
  /// Throws UninitializedObjectException when one of the names is null.
  CIMPropertyList(const Array<CIMName>& propertyNames);

  void set(const Array<CIMName>& propertyNames);
  /// Makes the list null.
  void clear();
  Boolean isNull() const;
  Uint32 size() const;
  /// Throws IndexOutOfBoundsException.
  const CIMName& operator[](Uint32 index) const;
  Array<CIMName> getPropertyNameArray() const;
  /// Ignores letter case; false for a null list.
  Boolean contains(const CIMName& name) const;
  /// True for a null list and for a name that it contains.
  Boolean useThisProperty(const CIMName& name) const;
  /// "NULL", "EMPTY" or the names, separated by ", ".
  String toString() const;

 private:
  Array<CIMName> names_;
  Boolean isNull_ = true;
};

PEGASUS_NAMESPACE_END
