#include <Pegasus/Common/Exception.h>

PEGASUS_NAMESPACE_BEGIN

Exception::Exception(const String& message) : message_(message) {}
Exception::Exception(const Exception& exception) = default;
Exception& Exception::operator=(const Exception& exception) = default;
Exception::~Exception() = default;

const String& Exception::getMessage() const {
  return message_;
}

IndexOutOfBoundsException::IndexOutOfBoundsException() : Exception("index out of bounds") {}
IndexOutOfBoundsException::IndexOutOfBoundsException(const IndexOutOfBoundsException&) = default;
IndexOutOfBoundsException& IndexOutOfBoundsException::operator=(const IndexOutOfBoundsException&) =
    default;
IndexOutOfBoundsException::~IndexOutOfBoundsException() = default;

UninitializedObjectException::UninitializedObjectException() : Exception("uninitialized object") {}
UninitializedObjectException::UninitializedObjectException(const UninitializedObjectException&) =
    default;
UninitializedObjectException& UninitializedObjectException::operator=(
    const UninitializedObjectException&) = default;
UninitializedObjectException::~UninitializedObjectException() = default;

TypeMismatchException::TypeMismatchException() : Exception("type mismatch") {}
TypeMismatchException::TypeMismatchException(const String& message)
    : Exception(String("type mismatch: ") + message) {}
TypeMismatchException::TypeMismatchException(const TypeMismatchException&) = default;
TypeMismatchException& TypeMismatchException::operator=(const TypeMismatchException&) = default;
TypeMismatchException::~TypeMismatchException() = default;

DynamicCastFailedException::DynamicCastFailedException() : Exception("dynamic cast failed") {}
DynamicCastFailedException::DynamicCastFailedException(const DynamicCastFailedException&) = default;
DynamicCastFailedException& DynamicCastFailedException::operator=(
    const DynamicCastFailedException&) = default;
DynamicCastFailedException::~DynamicCastFailedException() = default;

AlreadyExistsException::AlreadyExistsException(const String& message)
    : Exception(String("already exists: ") + message) {}
AlreadyExistsException::AlreadyExistsException(const AlreadyExistsException&) = default;
AlreadyExistsException& AlreadyExistsException::operator=(const AlreadyExistsException&) = default;
AlreadyExistsException::~AlreadyExistsException() = default;

InvalidNameException::InvalidNameException(const String& name)
    : Exception(String("The CIM name is not valid: ") + name) {}
InvalidNameException::InvalidNameException(const InvalidNameException&) = default;
InvalidNameException& InvalidNameException::operator=(const InvalidNameException&) = default;
InvalidNameException::~InvalidNameException() = default;

InvalidNamespaceNameException::InvalidNamespaceNameException(const String& name)
    : Exception(String("invalid CIM namespace name: ") + name) {}
InvalidNamespaceNameException::InvalidNamespaceNameException(const InvalidNamespaceNameException&) =
    default;
InvalidNamespaceNameException& InvalidNamespaceNameException::operator=(
    const InvalidNamespaceNameException&) = default;
InvalidNamespaceNameException::~InvalidNamespaceNameException() = default;

InvalidDateTimeFormatException::InvalidDateTimeFormatException()
    : Exception("invalid datetime format") {}
InvalidDateTimeFormatException::InvalidDateTimeFormatException(
    const InvalidDateTimeFormatException&) = default;
InvalidDateTimeFormatException& InvalidDateTimeFormatException::operator=(
    const InvalidDateTimeFormatException&) = default;
InvalidDateTimeFormatException::~InvalidDateTimeFormatException() = default;

DateTimeOutOfRangeException::DateTimeOutOfRangeException(const String& message)
    : Exception(String("DateTime is out of range : ") + message) {}
DateTimeOutOfRangeException::DateTimeOutOfRangeException(const DateTimeOutOfRangeException&) =
    default;
DateTimeOutOfRangeException& DateTimeOutOfRangeException::operator=(
    const DateTimeOutOfRangeException&) = default;
DateTimeOutOfRangeException::~DateTimeOutOfRangeException() = default;

MalformedObjectNameException::MalformedObjectNameException(const String& message)
    : Exception(String("malformed object name: ") + message) {}
MalformedObjectNameException::MalformedObjectNameException(const MalformedObjectNameException&) =
    default;
MalformedObjectNameException& MalformedObjectNameException::operator=(
    const MalformedObjectNameException&) = default;
MalformedObjectNameException::~MalformedObjectNameException() = default;

CIMException::CIMException(CIMStatusCode code, const String& message)
    : Exception(message), code_(code) {}
CIMException::CIMException(const CIMException& exception) = default;
CIMException& CIMException::operator=(const CIMException& exception) = default;
CIMException::~CIMException() = default;

CIMStatusCode CIMException::getCode() const {
  return code_;
}

PEGASUS_NAMESPACE_END
