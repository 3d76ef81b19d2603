// The declaration of a CIM method's parameter.
#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Embedded/QualifiedHandle.h>

PEGASUS_NAMESPACE_BEGIN

class CIMParameter;
class CIMConstParameter;
class ParameterRep;

/// The members that CIMParameter and CIMConstParameter have in common.
class PEGASUS_COMMON_LINKAGE ParameterReader : public QualifiedReader {
 public:
  const CIMName& getName() const;
  Boolean isArray() const;
  Uint32 getArraySize() const;
  const CIMName& getReferenceClassName() const;
  CIMType getType() const;
  Boolean identical(const CIMConstParameter& other) const;
  CIMParameter clone() const;

 protected:
  using QualifiedReader::QualifiedReader;
  ParameterReader() = default;
  ParameterRep& rep() const;
};

/// A handle: copies refer to the same parameter, clone() makes another one.
class PEGASUS_COMMON_LINKAGE CIMParameter : public QualifiedHandle<CIMParameter, ParameterReader> {
 public:
  CIMParameter() = default;
  /// Throws UninitializedObjectException for a null name. Throws TypeMismatchException when the
  /// type is reference and no class is named or the other way round, and for a size without
  /// `isArray`.
  CIMParameter(const CIMName& name, CIMType type, Boolean isArray = false, Uint32 arraySize = 0,
               const CIMName& referenceClassName = CIMName());

  /// Throws Exception when the name changes while the parameter is in a container.
  void setName(const CIMName& name);

 private:
  friend struct HandleAccess;
  using QualifiedHandle::QualifiedHandle;
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstParameter : public ParameterReader {
 public:
  CIMConstParameter() = default;
  CIMConstParameter(const CIMParameter& parameter) : ParameterReader(parameter) {}

 private:
  friend struct HandleAccess;
  using ParameterReader::ParameterReader;
};

PEGASUS_NAMESPACE_END
