// The declaration of a CIM method.
#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMParameter.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Embedded/QualifiedHandle.h>

PEGASUS_NAMESPACE_BEGIN

class CIMConstParameter;
class CIMMethod;
class CIMParameter;
class CIMConstMethod;
class MethodRep;

/// The members that CIMMethod and CIMConstMethod have in common.
class PEGASUS_COMMON_LINKAGE MethodReader : public QualifiedReader {
 public:
  const CIMName& getName() const;
  CIMType getType() const;
  const CIMName& getClassOrigin() const;
  Boolean getPropagated() const;
  Uint32 findParameter(const CIMName& name) const;
  CIMConstParameter getParameter(Uint32 index) const;
  Uint32 getParameterCount() const;
  Boolean identical(const CIMConstMethod& other) const;
  CIMMethod clone() const;

 protected:
  using QualifiedReader::QualifiedReader;
  MethodReader() = default;
  MethodRep& rep() const;
};

/// A handle: copies refer to the same method, clone() makes another one.
class PEGASUS_COMMON_LINKAGE CIMMethod : public QualifiedHandle<CIMMethod, MethodReader> {
 public:
  using MethodReader::getParameter;

  CIMMethod() = default;
  /// Throws UninitializedObjectException for a null name.
  CIMMethod(const CIMName& name, CIMType type, const CIMName& classOrigin = CIMName(),
            Boolean propagated = false);

  /// Throws Exception when the name changes while the method is in a container.
  void setName(const CIMName& name);
  void setType(CIMType type);
  void setClassOrigin(const CIMName& classOrigin);
  void setPropagated(Boolean propagated);
  /// Throws AlreadyExistsException for a name (in any letter case) that is there already.
  CIMMethod& addParameter(const CIMParameter& parameter);
  CIMParameter getParameter(Uint32 index);
  void removeParameter(Uint32 index);

 private:
  friend struct HandleAccess;
  using QualifiedHandle::QualifiedHandle;
};

/// A handle that can only read.
class PEGASUS_COMMON_LINKAGE CIMConstMethod : public MethodReader {
 public:
  CIMConstMethod() = default;
  CIMConstMethod(const CIMMethod& method) : MethodReader(method) {}

 private:
  friend struct HandleAccess;
  using MethodReader::MethodReader;
};

PEGASUS_NAMESPACE_END
