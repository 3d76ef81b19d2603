#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/CIMStatusCode.h>
#include <Pegasus/Common/ContentLanguageList.h>
#include <Pegasus/Common/String.h>

PEGASUS_NAMESPACE_BEGIN

/// Base of all exceptions of this API; not a std::exception.
class PEGASUS_COMMON_LINKAGE Exception {
 public:
  Exception(const String& message);
  Exception(const Exception& exception);
  Exception& operator=(const Exception& exception);
  virtual ~Exception();

  virtual const String& getMessage() const;

 private:
  String message_;
};

class PEGASUS_COMMON_LINKAGE IndexOutOfBoundsException : public Exception {
 public:
  IndexOutOfBoundsException();
  IndexOutOfBoundsException(const IndexOutOfBoundsException&);
  IndexOutOfBoundsException& operator=(const IndexOutOfBoundsException&);
  ~IndexOutOfBoundsException() override;
};

class PEGASUS_COMMON_LINKAGE UninitializedObjectException : public Exception {
 public:
  UninitializedObjectException();
  UninitializedObjectException(const UninitializedObjectException&);
  UninitializedObjectException& operator=(const UninitializedObjectException&);
  ~UninitializedObjectException() override;
};

class PEGASUS_COMMON_LINKAGE TypeMismatchException : public Exception {
 public:
  TypeMismatchException();
  TypeMismatchException(const String& message);
  TypeMismatchException(const TypeMismatchException&);
  TypeMismatchException& operator=(const TypeMismatchException&);
  ~TypeMismatchException() override;
};

class PEGASUS_COMMON_LINKAGE DynamicCastFailedException : public Exception {
 public:
  DynamicCastFailedException();
  DynamicCastFailedException(const DynamicCastFailedException&);
  DynamicCastFailedException& operator=(const DynamicCastFailedException&);
  ~DynamicCastFailedException() override;
};

class PEGASUS_COMMON_LINKAGE AlreadyExistsException : public Exception {
 public:
  AlreadyExistsException(const String& message);
  AlreadyExistsException(const AlreadyExistsException&);
  AlreadyExistsException& operator=(const AlreadyExistsException&);
  ~AlreadyExistsException() override;
};

class PEGASUS_COMMON_LINKAGE InvalidNameException : public Exception {
 public:
  InvalidNameException(const String& name);
  InvalidNameException(const InvalidNameException&);
  InvalidNameException& operator=(const InvalidNameException&);
  ~InvalidNameException() override;
};

class PEGASUS_COMMON_LINKAGE InvalidNamespaceNameException : public Exception {
 public:
  InvalidNamespaceNameException(const String& name);
  InvalidNamespaceNameException(const InvalidNamespaceNameException&);
  InvalidNamespaceNameException& operator=(const InvalidNamespaceNameException&);
  ~InvalidNamespaceNameException() override;
};

class PEGASUS_COMMON_LINKAGE InvalidDateTimeFormatException : public Exception {
 public:
  InvalidDateTimeFormatException();
  InvalidDateTimeFormatException(const InvalidDateTimeFormatException&);
  InvalidDateTimeFormatException& operator=(const InvalidDateTimeFormatException&);
  ~InvalidDateTimeFormatException() override;
};

class PEGASUS_COMMON_LINKAGE DateTimeOutOfRangeException : public Exception {
 public:
  DateTimeOutOfRangeException(const String& message);
  DateTimeOutOfRangeException(const DateTimeOutOfRangeException&);
  DateTimeOutOfRangeException& operator=(const DateTimeOutOfRangeException&);
  ~DateTimeOutOfRangeException() override;
};

class PEGASUS_COMMON_LINKAGE MalformedObjectNameException : public Exception {
 public:
  MalformedObjectNameException(const String& message);
  MalformedObjectNameException(const MalformedObjectNameException&);
  MalformedObjectNameException& operator=(const MalformedObjectNameException&);
  ~MalformedObjectNameException() override;
};

/// An error with the status code that the client of the operation receives; the message stays as
/// given.
class PEGASUS_COMMON_LINKAGE CIMException : public Exception {
 public:
  CIMException(CIMStatusCode code = CIM_ERR_SUCCESS, const String& message = String::EMPTY);
  CIMException(const CIMException& exception);
  CIMException& operator=(const CIMException& exception);
  ~CIMException() override;

  CIMStatusCode getCode() const;

 private:
  CIMStatusCode code_;
};

PEGASUS_NAMESPACE_END
