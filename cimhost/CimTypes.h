#pragma once

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObject.h>
#include <Pegasus/Common/CIMValue.h>

#include <type_traits>

namespace cimhost {

template <class T>
struct CimTag {
  using Type = T;
};

/// The host's only list of the CIM types: visit(CimTag<T>{}) for the C++ type behind `type`.
template <class Visit>
auto visitCimType(Pegasus::CIMType type, Visit visit) {
  // clang-format off
  switch (type) {
    case Pegasus::CIMTYPE_BOOLEAN:   return visit(CimTag<Pegasus::Boolean>{});
    case Pegasus::CIMTYPE_UINT8:     return visit(CimTag<Pegasus::Uint8>{});
    case Pegasus::CIMTYPE_SINT8:     return visit(CimTag<Pegasus::Sint8>{});
    case Pegasus::CIMTYPE_UINT16:    return visit(CimTag<Pegasus::Uint16>{});
    case Pegasus::CIMTYPE_SINT16:    return visit(CimTag<Pegasus::Sint16>{});
    case Pegasus::CIMTYPE_UINT32:    return visit(CimTag<Pegasus::Uint32>{});
    case Pegasus::CIMTYPE_SINT32:    return visit(CimTag<Pegasus::Sint32>{});
    case Pegasus::CIMTYPE_UINT64:    return visit(CimTag<Pegasus::Uint64>{});
    case Pegasus::CIMTYPE_SINT64:    return visit(CimTag<Pegasus::Sint64>{});
    case Pegasus::CIMTYPE_REAL32:    return visit(CimTag<Pegasus::Real32>{});
    case Pegasus::CIMTYPE_REAL64:    return visit(CimTag<Pegasus::Real64>{});
    case Pegasus::CIMTYPE_CHAR16:    return visit(CimTag<Pegasus::Char16>{});
    case Pegasus::CIMTYPE_DATETIME:  return visit(CimTag<Pegasus::CIMDateTime>{});
    case Pegasus::CIMTYPE_REFERENCE: return visit(CimTag<Pegasus::CIMObjectPath>{});
    case Pegasus::CIMTYPE_OBJECT:    return visit(CimTag<Pegasus::CIMObject>{});
    case Pegasus::CIMTYPE_INSTANCE:  return visit(CimTag<Pegasus::CIMInstance>{});
    case Pegasus::CIMTYPE_STRING:    break;
  }
  // clang-format on
  return visit(CimTag<Pegasus::String>{});
}

/// The value as its C++ type: visit(T) for a scalar, visit(Array<T>) for an array. Not for null
/// values.
template <class Visit>
auto visitCimValue(const Pegasus::CIMValue& value, Visit visit) {
  return visitCimType(value.getType(), [&](auto tag) {
    using T = typename decltype(tag)::Type;
    if (value.isArray()) {
      Pegasus::Array<T> elements;
      value.get(elements);
      return visit(elements);
    }
    T element{};
    value.get(element);
    return visit(element);
  });
}

template <class T>
inline constexpr bool kIsNumber = std::is_arithmetic_v<T> && !std::is_same_v<T, bool>;

}  // namespace cimhost
