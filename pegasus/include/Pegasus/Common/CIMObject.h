// A CIM class or a CIM instance.
#pragma once

#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMPropertyList.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Embedded/ObjectHandle.h>

PEGASUS_NAMESPACE_BEGIN

class CIMClass;
class CIMInstance;
class CIMConstClass;
class CIMConstInstance;
class CIMObject;
class CIMConstObject;

/// The members that CIMObject and CIMConstObject have in common.
class PEGASUS_COMMON_LINKAGE AnyObjectReader : public ObjectReader {
 public:
  Boolean isClass() const;
  Boolean isInstance() const;
  Boolean identical(const CIMConstObject& other) const;
  CIMObject clone() const;
  /// The object as a compact text in the manner of CIM-XML (DSP0201).
  String toString() const;

 protected:
  using ObjectReader::ObjectReader;
  AnyObjectReader() = default;
};

/// A handle to a class or an instance, whose own handles refer to the same object.
class PEGASUS_COMMON_LINKAGE CIMObject : public ObjectHandle<CIMObject, AnyObjectReader> {
 public:
  CIMObject() = default;
  CIMObject(const CIMClass& cimClass);
  CIMObject(const CIMInstance& instance);

  /// Strips in place what a client did not ask for.
  void instanceFilter(Boolean includeQualifiers, Boolean includeClassOrigin,
                      const CIMPropertyList& propertyList);

 private:
  friend struct HandleAccess;
  using ObjectHandle::ObjectHandle;
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstObject : public AnyObjectReader {
 public:
  CIMConstObject() = default;
  CIMConstObject(const CIMObject& object) : AnyObjectReader(object) {}
  CIMConstObject(const CIMClass& cimClass);
  CIMConstObject(const CIMInstance& instance);
  CIMConstObject(const CIMConstClass& cimClass);
  CIMConstObject(const CIMConstInstance& instance);

 private:
  friend struct HandleAccess;
  using AnyObjectReader::AnyObjectReader;
};

PEGASUS_NAMESPACE_END
