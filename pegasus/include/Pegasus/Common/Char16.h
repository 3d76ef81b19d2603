#pragma once

#include <Pegasus/Common/Config.h>

PEGASUS_NAMESPACE_BEGIN

/// One UTF-16 code unit.
class PEGASUS_COMMON_LINKAGE Char16 {
 public:
  constexpr Char16() : unit_(0) {}
  constexpr Char16(Uint16 x) : unit_(x) {}

  Char16& operator=(Uint16 x) {
    unit_ = x;
    return *this;
  }

  constexpr operator Uint16() const { return unit_; }

 private:
  Uint16 unit_;
};

static_assert(sizeof(Char16) == sizeof(Uint16), "text is an array of code units");

inline bool operator==(const Char16& x, const Char16& y) {
  return Uint16(x) == Uint16(y);
}
inline bool operator==(const Char16& x, char y) {
  return Uint16(x) == Uint16(y);
}
inline bool operator==(char x, const Char16& y) {
  return Uint16(x) == Uint16(y);
}
inline bool operator!=(const Char16& x, const Char16& y) {
  return Uint16(x) != Uint16(y);
}
inline bool operator!=(const Char16& x, char y) {
  return Uint16(x) != Uint16(y);
}
inline bool operator!=(char x, const Char16& y) {
  return Uint16(x) != Uint16(y);
}

PEGASUS_NAMESPACE_END
