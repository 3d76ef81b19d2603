#pragma once

#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/Char16.h>
#include <Pegasus/Common/String.h>

#include <type_traits>

namespace Vaneth {

template <class T>
struct CimTag {
  using Type = T;
};

/// The only list of the fifteen CIM types: gives visit(CimTag<T>{}) for the C++ type behind `type`,
/// Result{} for any other.
template <class Result, class Visit>
Result visitCimType(Pegasus::CIMType type, Visit visit) {
  using namespace Pegasus;
  switch (type) {
    case CIMTYPE_BOOLEAN:
      return visit(CimTag<Boolean>{});
    case CIMTYPE_UINT8:
      return visit(CimTag<Uint8>{});
    case CIMTYPE_SINT8:
      return visit(CimTag<Sint8>{});
    case CIMTYPE_UINT16:
      return visit(CimTag<Uint16>{});
    case CIMTYPE_SINT16:
      return visit(CimTag<Sint16>{});
    case CIMTYPE_UINT32:
      return visit(CimTag<Uint32>{});
    case CIMTYPE_SINT32:
      return visit(CimTag<Sint32>{});
    case CIMTYPE_UINT64:
      return visit(CimTag<Uint64>{});
    case CIMTYPE_SINT64:
      return visit(CimTag<Sint64>{});
    case CIMTYPE_REAL32:
      return visit(CimTag<Real32>{});
    case CIMTYPE_REAL64:
      return visit(CimTag<Real64>{});
    case CIMTYPE_CHAR16:
      return visit(CimTag<Char16>{});
    case CIMTYPE_STRING:
      return visit(CimTag<String>{});
    case CIMTYPE_DATETIME:
      return visit(CimTag<CIMDateTime>{});
    case CIMTYPE_REFERENCE:
      return visit(CimTag<CIMObjectPath>{});
    default:
      return Result{};
  }
}

/// True for the types that travel as text: string, datetime, reference. All others are numbers.
template <class T>
inline constexpr bool kIsText =
    std::is_same_v<T, Pegasus::String> || std::is_same_v<T, Pegasus::CIMDateTime> ||
    std::is_same_v<T, Pegasus::CIMObjectPath>;

}  // namespace Vaneth
