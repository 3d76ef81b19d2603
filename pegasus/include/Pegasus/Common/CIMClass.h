// A CIM class.
#pragma once

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMObject.h>

PEGASUS_NAMESPACE_BEGIN

class CIMClass;
class CIMConstClass;
class ClassRep;

/// The members that CIMClass and CIMConstClass have in common.
class PEGASUS_COMMON_LINKAGE ClassReader : public ObjectReader {
 public:
  /// The qualifier Association is there and TRUE.
  Boolean isAssociation() const;
  /// The qualifier Abstract is there and TRUE.
  Boolean isAbstract() const;
  const CIMName& getSuperClassName() const;
  Uint32 findMethod(const CIMName& name) const;
  CIMConstMethod getMethod(Uint32 index) const;
  Uint32 getMethodCount() const;
  /// Appends the names of the properties whose qualifier Key is TRUE, in the order of the class.
  void getKeyNames(Array<CIMName>& keyNames) const;
  Boolean hasKeys() const;
  /// A new instance with clones of the listed properties (a null list names all), default values
  /// included.
  CIMInstance buildInstance(Boolean includeQualifiers, Boolean includeClassOrigin,
                            const CIMPropertyList& propertyList) const;
  Boolean identical(const CIMConstClass& other) const;
  /// Costs little: qualifiers, methods and parameters are shared until one side hands them out for
  /// change. So a reference into one of them is sure to stay valid only while a handle to that very
  /// element is kept; references into properties live as long as the class. To read qualifiers,
  /// CIMConst handles are faster, because they un-share nothing.
  CIMClass clone() const;

 protected:
  using ObjectReader::ObjectReader;
  ClassReader() = default;
  ClassRep& rep() const;
};

/// A handle: copies refer to the same class, clone() makes another one.
class PEGASUS_COMMON_LINKAGE CIMClass : public ObjectHandle<CIMClass, ClassReader> {
 public:
  using ClassReader::getMethod;

  CIMClass() = default;
  /// Throws DynamicCastFailedException when `object` is no class.
  explicit CIMClass(const CIMObject& object);
  /// Throws UninitializedObjectException for a null name.
  CIMClass(const CIMName& className, const CIMName& superClassName = CIMName());

  void setSuperClassName(const CIMName& superClassName);
  /// Throws AlreadyExistsException for a name (in any letter case) that is there already.
  CIMClass& addMethod(const CIMMethod& method);
  CIMMethod getMethod(Uint32 index);
  void removeMethod(Uint32 index);

 private:
  friend struct HandleAccess;
  using ObjectHandle::ObjectHandle;
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstClass : public ClassReader {
 public:
  CIMConstClass() = default;
  CIMConstClass(const CIMClass& cimClass) : ClassReader(cimClass) {}

 private:
  friend struct HandleAccess;
  using ClassReader::ClassReader;
};

PEGASUS_NAMESPACE_END
