// The exceptions with which a provider refuses an operation.
#pragma once

#include <Pegasus/Common/Exception.h>

PEGASUS_NAMESPACE_BEGIN

/// CIM_ERR_FAILED, and base of those with a code of their own. The message is kept as given.
class PEGASUS_PROVIDER_LINKAGE CIMOperationFailedException : public CIMException {
 public:
  explicit CIMOperationFailedException(const String& message);
  ~CIMOperationFailedException() override;

 protected:
  CIMOperationFailedException(CIMStatusCode code, const String& message);
};

/// CIM_ERR_ACCESS_DENIED
class PEGASUS_PROVIDER_LINKAGE CIMAccessDeniedException : public CIMOperationFailedException {
 public:
  explicit CIMAccessDeniedException(const String& message);
  ~CIMAccessDeniedException() override;
};

/// CIM_ERR_INVALID_PARAMETER
class PEGASUS_PROVIDER_LINKAGE CIMInvalidParameterException : public CIMOperationFailedException {
 public:
  explicit CIMInvalidParameterException(const String& message);
  ~CIMInvalidParameterException() override;
};

/// CIM_ERR_NOT_FOUND
class PEGASUS_PROVIDER_LINKAGE CIMObjectNotFoundException : public CIMOperationFailedException {
 public:
  explicit CIMObjectNotFoundException(const String& message);
  ~CIMObjectNotFoundException() override;
};

/// CIM_ERR_NOT_SUPPORTED
class PEGASUS_PROVIDER_LINKAGE CIMNotSupportedException : public CIMOperationFailedException {
 public:
  explicit CIMNotSupportedException(const String& message);
  ~CIMNotSupportedException() override;
};

/// CIM_ERR_ALREADY_EXISTS
class PEGASUS_PROVIDER_LINKAGE CIMObjectAlreadyExistsException
    : public CIMOperationFailedException {
 public:
  explicit CIMObjectAlreadyExistsException(const String& message);
  ~CIMObjectAlreadyExistsException() override;
};

/// CIM_ERR_NO_SUCH_PROPERTY
class PEGASUS_PROVIDER_LINKAGE CIMPropertyNotFoundException : public CIMOperationFailedException {
 public:
  explicit CIMPropertyNotFoundException(const String& message);
  ~CIMPropertyNotFoundException() override;
};

/// CIM_ERR_METHOD_NOT_FOUND
class PEGASUS_PROVIDER_LINKAGE CIMMethodNotFoundException : public CIMOperationFailedException {
 public:
  explicit CIMMethodNotFoundException(const String& message);
  ~CIMMethodNotFoundException() override;
};

PEGASUS_NAMESPACE_END
