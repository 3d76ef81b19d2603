#pragma once

#include <Pegasus/Common/CIMName.h>

#include <cstddef>

namespace cimhost {

/// Hash and equality of class, qualifier and namespace names, which ignore ASCII letter case.
struct NameHash {
  template <class Name>
  std::size_t operator()(const Name& name) const {
    const Pegasus::String& text = name.getString();
    const Pegasus::Char16* unit = text.getChar16Data();
    std::size_t hash = 5381;
    for (Pegasus::Uint32 i = 0, size = text.size(); i < size; ++i) {
      const Pegasus::Uint16 c = unit[i];
      hash = hash * 33 ^ static_cast<std::size_t>(c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c);
    }
    return hash;
  }
};

struct NameEqual {
  template <class Name>
  bool operator()(const Name& a, const Name& b) const {
    return a.equal(b);
  }
};

}  // namespace cimhost
