#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <regex>
#include <string>

#include "Deployment.h"

/// A test that is skipped where no server is installed.
template <class Base>
class WithServer : public Base {
 protected:
  void SetUp() override {
    const std::string reason = CimServer::whyUnavailable();
    if (!reason.empty()) GTEST_SKIP() << "No server to compare with: " << reason;
  }
};

/// Names the cases of a table by their `name`.
inline constexpr auto kByName = [](const auto& given) { return given.param.name; };

/// The text with its real numbers in one form: servers write 1, 1.0 and 1.0000000e+00 for the same.
inline std::string plainReals(const std::string& text) {
  static const std::regex real("-?[0-9]+\\.[0-9]+(e[-+][0-9]+)?");
  std::string plain, rest = text;
  for (std::smatch match; std::regex_search(rest, match, real); rest = match.suffix()) {
    plain += match.prefix().str() + std::to_string(std::stod(match.str()));
  }
  return plain + rest;
}
