#pragma once

#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObject.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/Exception.h>

// The only list of the CIM types: X(type code, C++ type) for each.
#define PEGASUS_FOR_EACH_CIM_TYPE(X)  \
  X(CIMTYPE_BOOLEAN, Boolean)         \
  X(CIMTYPE_UINT8, Uint8)             \
  X(CIMTYPE_SINT8, Sint8)             \
  X(CIMTYPE_UINT16, Uint16)           \
  X(CIMTYPE_SINT16, Sint16)           \
  X(CIMTYPE_UINT32, Uint32)           \
  X(CIMTYPE_SINT32, Sint32)           \
  X(CIMTYPE_UINT64, Uint64)           \
  X(CIMTYPE_SINT64, Sint64)           \
  X(CIMTYPE_REAL32, Real32)           \
  X(CIMTYPE_REAL64, Real64)           \
  X(CIMTYPE_CHAR16, Char16)           \
  X(CIMTYPE_STRING, String)           \
  X(CIMTYPE_DATETIME, CIMDateTime)    \
  X(CIMTYPE_REFERENCE, CIMObjectPath) \
  X(CIMTYPE_OBJECT, CIMObject)        \
  X(CIMTYPE_INSTANCE, CIMInstance)

PEGASUS_NAMESPACE_BEGIN

template <class T>
struct CimTypeTag {
  using Type = T;
};

/// visit(CimTypeTag<T>{}) for the C++ type behind `type`; TypeMismatchException when there is none.
template <class Visit>
auto visitCimType(CIMType type, Visit visit) {
  switch (type) {
#define PEGASUS_VISIT(code, T) \
  case code:                   \
    return visit(CimTypeTag<T>{});
    PEGASUS_FOR_EACH_CIM_TYPE(PEGASUS_VISIT)
#undef PEGASUS_VISIT
  }
  throw TypeMismatchException();
}

/// The type code of a C++ type.
template <class T>
struct CimTypeCode;
#define PEGASUS_TYPE_CODE(code, T)         \
  template <>                              \
  struct CimTypeCode<T> {                  \
    static constexpr CIMType value = code; \
  };
PEGASUS_FOR_EACH_CIM_TYPE(PEGASUS_TYPE_CODE)
#undef PEGASUS_TYPE_CODE

PEGASUS_NAMESPACE_END
