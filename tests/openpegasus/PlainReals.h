#pragma once

#include <regex>
#include <string>

/// The text with its real numbers in one form: servers write 1, 1.0 and 1.0000000e+00 for the same.
inline std::string plainReals(const std::string& text) {
  static const std::regex real("-?[0-9]+\\.[0-9]+(e[-+][0-9]+)?");
  std::string plain;
  auto rest = text.begin();
  for (std::sregex_iterator match(text.begin(), text.end(), real), end; match != end; ++match) {
    plain.append(rest, text.begin() + match->position());
    plain += std::to_string(std::stod(match->str()));
    rest = text.begin() + match->position() + match->length();
  }
  return plain.append(rest, text.end());
}
