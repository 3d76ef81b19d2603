#pragma once

#include <cctype>
#include <cstddef>
#include <string>
#include <string_view>

/// Case-insensitive equality: same length, and the same bytes after tolower.
bool ci_equal(std::string_view a, std::string_view b);

/// Hash that agrees with ci_equal, for look-ups that ignore letter case.
struct CiHash {
  size_t operator()(std::string_view text) const {
    size_t hash = 14695981039346656037ull & static_cast<size_t>(-1);
    for (const char c : text) {
      hash ^= static_cast<size_t>(std::tolower(static_cast<unsigned char>(c)));
      hash *= static_cast<size_t>(1099511628211ull & static_cast<size_t>(-1));
    }
    return hash;
  }
};

struct CiEqual {
  bool operator()(std::string_view a, std::string_view b) const { return ci_equal(a, b); }
};
