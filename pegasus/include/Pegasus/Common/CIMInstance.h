// A CIM instance.
#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMObject.h>

PEGASUS_NAMESPACE_BEGIN

class CIMInstance;
class CIMConstInstance;
class InstanceRep;

/// The members that CIMInstance and CIMConstInstance have in common.
class PEGASUS_COMMON_LINKAGE InstanceReader : public ObjectReader {
 public:
  Boolean identical(const CIMConstInstance& other) const;
  CIMInstance clone() const;
  /// A path without host and namespace, with the key properties that the class declares.
  /// Throws Exception when the instance lacks one of them.
  CIMObjectPath buildPath(const CIMConstClass& cimClass) const;

 protected:
  using ObjectReader::ObjectReader;
  InstanceReader() = default;
};

/// A handle: copies refer to the same instance, clone() makes another one.
class PEGASUS_COMMON_LINKAGE CIMInstance : public ObjectHandle<CIMInstance, InstanceReader> {
 public:
  CIMInstance() = default;
  /// Throws DynamicCastFailedException when `object` is no instance.
  explicit CIMInstance(const CIMObject& object);
  /// Throws UninitializedObjectException for a null name.
  CIMInstance(const CIMName& className);

  /// Strips in place what a client did not ask for: properties that the list does not name (a null
  /// list names all), qualifiers, class origins.
  void instanceFilter(Boolean includeQualifiers, Boolean includeClassOrigin,
                      const CIMPropertyList& propertyList);

 private:
  friend struct HandleAccess;
  using ObjectHandle::ObjectHandle;
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstInstance : public InstanceReader {
 public:
  CIMConstInstance() = default;
  CIMConstInstance(const CIMInstance& instance) : InstanceReader(instance) {}

 private:
  friend struct HandleAccess;
  using InstanceReader::InstanceReader;
};

PEGASUS_NAMESPACE_END
