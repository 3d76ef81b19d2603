// CIMValue::toString
#include <charconv>
#include <cstdio>

#include "CIMValueAccess.h"

PEGASUS_NAMESPACE_BEGIN

namespace {

void appendAscii(String& out, const char* text, std::size_t size) {
  for (std::size_t i = 0; i < size; ++i) {
    out.append(Char16(static_cast<Uint16>(static_cast<unsigned char>(text[i]))));
  }
}

template <class T>
void appendInteger(String& out, T x) {
  char text[24];
  const auto end = std::to_chars(text, text + sizeof(text), x).ptr;
  appendAscii(out, text, static_cast<std::size_t>(end - text));
}

void appendReal(String& out, double x) {
  char text[40];
  const int size = std::snprintf(text, sizeof(text), "%.16e", x);
  appendAscii(out, text, static_cast<std::size_t>(size));
}

bool isSurrogate(Uint16 unit) {
  return unit >= 0xD800 && unit <= 0xDFFF;
}

template <class T>
void appendElement(String& out, const T& x) {
  if constexpr (std::is_same_v<T, Boolean>) {
    appendAscii(out, x ? "TRUE" : "FALSE", x ? 4 : 5);
  } else if constexpr (std::is_integral_v<T>) {
    appendInteger(out, x);
  } else if constexpr (std::is_floating_point_v<T>) {
    appendReal(out, static_cast<double>(x));
  } else if constexpr (std::is_same_v<T, Char16>) {
    // Neither the terminator nor half a character is text.
    const Uint16 unit = x;
    if (unit != 0 && !isSurrogate(unit)) out.append(x);
  } else if constexpr (std::is_same_v<T, String>) {
    const Uint32 end = x.find(Char16(0));
    out.append(x.getChar16Data(), end == PEG_NOT_FOUND ? x.size() : end);
  } else if constexpr (std::is_same_v<T, CIMInstance>) {
    out.append(CIMObject(x).toString());
  } else {
    out.append(x.toString());
  }
}

}  // namespace

String CIMValue::toString() const {
  String out;
  if (isNull_) return out;
  visitCimType(type_, [&](auto tag) {
    using T = typename decltype(tag)::Type;
    if (!isArray_) {
      appendElement<T>(out, CIMValueAccess::scalar<T>(*this));
      return;
    }
    const Array<T>& elements = CIMValueAccess::held<Array<T>>(*this);
    for (Uint32 i = 0; i < elements.size(); ++i) {
      appendElement<T>(out, elements[i]);
      out.append(Char16(' '));
    }
  });
  return out;
}

PEGASUS_NAMESPACE_END
