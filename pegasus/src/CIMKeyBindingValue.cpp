// Key bindings and typed values.
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMValue.h>

#include <cerrno>
#include <cstdlib>
#include <limits>

#include "CIMTypeList.h"
#include "ObjectPathParser.h"

PEGASUS_NAMESPACE_BEGIN

namespace {

CIMKeyBinding::Type keyTypeOf(const CIMValue& value) {
  if (value.isArray()) throw TypeMismatchException();
  switch (value.getType()) {
    case CIMTYPE_BOOLEAN:
      return CIMKeyBinding::BOOLEAN;
    case CIMTYPE_CHAR16:
    case CIMTYPE_STRING:
    case CIMTYPE_DATETIME:
      return CIMKeyBinding::STRING;
    case CIMTYPE_REFERENCE:
      return CIMKeyBinding::REFERENCE;
    case CIMTYPE_OBJECT:
    case CIMTYPE_INSTANCE:
      throw TypeMismatchException();
    default:
      return CIMKeyBinding::NUMERIC;
  }
}

template <class T>
bool parseInteger(const String& text, T& x) {
  using Wide = std::conditional_t<std::is_signed_v<T>, Sint64, Uint64>;
  Wide wide;
  if constexpr (std::is_signed_v<T>) {
    if (!parseSigned(text, wide)) return false;
  } else {
    if (!parseUnsigned(text, wide)) return false;
  }
  if (wide < Wide(std::numeric_limits<T>::min()) || wide > Wide(std::numeric_limits<T>::max())) {
    return false;
  }
  x = static_cast<T>(wide);
  return true;
}

const char* skipDigits(const char* text) {
  while (*text >= '0' && *text <= '9') ++text;
  return text;
}

const char* skipSign(const char* text) {
  return *text == '+' || *text == '-' ? text + 1 : text;
}

// A point with digits behind it is there, and all is ASCII digits.
bool isReal(const char* text) {
  text = skipDigits(skipSign(text));
  if (*text != '.') return false;
  const char* end = skipDigits(text + 1);
  if (end == text + 1) return false;
  if (*end == 'e' || *end == 'E') {
    text = skipSign(end + 1);
    end = skipDigits(text);
    if (end == text) return false;
  }
  return *end == '\0';
}

template <class T>
bool parseReal(const String& text, T& x) {
  const CString utf8 = text.getCString();
  if (!isReal(utf8)) return false;
  errno = 0;
  x = static_cast<T>(std::strtod(utf8, nullptr));
  return errno == 0;
}

/// The key's text as a value of type T. False, or an exception of T's own, when it is none.
template <class T>
bool parseKey(const String& text, T& x) {
  if constexpr (std::is_same_v<T, Boolean>) {
    x = String::equalNoCase(text, String("TRUE"));
    return x || String::equalNoCase(text, String("FALSE"));
  } else if constexpr (std::is_integral_v<T>) {
    return parseInteger(text, x);
  } else if constexpr (std::is_floating_point_v<T>) {
    return parseReal(text, x);
  } else if constexpr (std::is_same_v<T, Char16>) {
    x = text[0];
    return true;
  } else if constexpr (std::is_same_v<T, CIMObject> || std::is_same_v<T, CIMInstance>) {
    return false;
  } else {
    x = T(text);
    return true;
  }
}

}  // namespace

CIMKeyBinding::CIMKeyBinding(const CIMName& name, const CIMValue& value)
    : CIMKeyBinding(name, value.isArray() ? String() : value.toString(), keyTypeOf(value)) {}

Boolean CIMKeyBinding::equal(CIMValue value) {
  CIMValue own;
  try {
    if (keyTypeOf(value) != type_) return false;
    const bool parsed = visitCimType(value.getType(), [&](auto tag) {
      typename decltype(tag)::Type x{};
      if (!parseKey(value_, x)) return false;
      own = CIMValue(x);
      return true;
    });
    if (!parsed) return false;
  } catch (const Exception&) {
    // The text is no date, no path, or the type is none of a key.
    return false;
  }
  return own == value;
}

PEGASUS_NAMESPACE_END
