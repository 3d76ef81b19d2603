#pragma once

#include <Pegasus/Common/CIMName.h>

PEGASUS_NAMESPACE_BEGIN

/// Compares one name with many, ignoring the case of A-Z. Must not outlive its name.
class NameMatcher {
 public:
  explicit NameMatcher(const CIMName& name)
      : units_(name.getString().getChar16Data()), size_(name.getString().size()) {}

  bool matches(const CIMName& name) const {
    const String& text = name.getString();
    if (text.size() != size_) return false;
    const Char16* const units = text.getChar16Data();
    if (units == units_) return true;
    // Backwards: names that belong together often begin alike.
    for (Uint32 i = size_; i-- > 0;) {
      if (!sameLetter(units[i], units_[i])) return false;
    }
    return true;
  }

 private:
  static bool sameLetter(Uint16 x, Uint16 y) {
    if (x == y) return true;
    const Uint16 lower = x | 0x20;
    return lower == (y | 0x20) && lower >= 'a' && lower <= 'z';
  }

  const Char16* units_;
  Uint32 size_;
};

PEGASUS_NAMESPACE_END
