#include "engine/ciEqual.h"

#include <algorithm>

bool ci_equal(std::string_view a, std::string_view b) {
  const auto same = [](unsigned char x, unsigned char y) {
    return std::tolower(x) == std::tolower(y);
  };
  return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), same);
}
