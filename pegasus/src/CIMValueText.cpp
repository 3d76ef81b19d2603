// CIMValue::toString
#include <algorithm>
#include <charconv>
#include <cstdio>

#include "CIMValueAccess.h"
#include "Utf8.h"

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

constexpr Uint16 kReplacement = 0xFFFD;

// Appends up to the first unit 0; false when there is one. A surrogate takes the next unit with it,
// whether it is its partner or not.
bool appendText(String& out, const String& text) {
  const Char16* const units = text.getChar16Data();
  const Uint32 size = text.size();
  Uint32 run = 0;
  for (Uint32 i = 0; i < size; ++i) {
    const Uint16 unit = units[i];
    if (unit != 0 && isCharacter(unit)) continue;
    const bool surrogate = isHighSurrogate(unit) || isLowSurrogate(unit);
    const Uint32 next = surrogate ? std::min(i + 2, size) : i + 1;
    if (isHighSurrogate(unit) && next == i + 2 && isLowSurrogate(units[i + 1])) {
      i = next - 1;
      continue;
    }
    out.append(units + run, i - run);
    if (unit == 0) return false;
    out.append(Char16(kReplacement));
    run = next;
    i = next - 1;
  }
  out.append(units + run, size - run);
  return true;
}

// False when the text of the whole value ends here.
template <class T>
bool appendElement(String& out, const T& x) {
  if constexpr (std::is_same_v<T, Boolean>) {
    appendAscii(out, x ? "TRUE" : "FALSE", x ? 4 : 5);
  } else if constexpr (std::is_integral_v<T>) {
    appendInteger(out, x);
  } else if constexpr (std::is_floating_point_v<T>) {
    appendReal(out, static_cast<double>(x));
  } else if constexpr (std::is_same_v<T, Char16>) {
    const Uint16 unit = x;
    if (unit == 0 || isHighSurrogate(unit)) return false;
    out.append(isCharacter(unit) ? x : Char16(kReplacement));
  } else if constexpr (std::is_same_v<T, String>) {
    return appendText(out, x);
  } else if constexpr (std::is_same_v<T, CIMInstance>) {
    out.append(CIMObject(x).toString());
  } else {
    out.append(x.toString());
  }
  return true;
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
      if (!appendElement<T>(out, elements[i])) return;
      out.append(Char16(' '));
    }
  });
  return out;
}

PEGASUS_NAMESPACE_END
