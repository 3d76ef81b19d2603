#pragma once

#include <gtest/gtest.h>

#include <string>

#include "definition/DefinitionFile.h"
#include "definition/ProviderDefXMLError.h"
#include "engine/Registry.h"

/// Names a table's cases by their member `name`.
inline const auto kCaseName = [](const auto& row) { return row.param.name; };

/// Tests that register definitions: every one begins and ends with empty registries.
class Registered : public testing::Test {
 protected:
  Registered() { release(); }
  ~Registered() override { release(); }

  static void release() {
    releaseFunctions();
    releaseModules();
  }
};

/// Registers what `text` declares; the whole message of the error that ended it, or "".
inline std::string errorOfReading(const std::string& text) {
  try {
    definition::readText(text);
  } catch (const ProviderDefXMLError& error) {
    return error.getMessage();
  }
  return std::string();
}

/// Builds one element of type T from `text`, all of which it must consume.
template <class T>
T element(const std::string& text, ProviderDefModule* module = nullptr) {
  int used = 0;
  // What stands behind an element is none of its business.
  const std::string padded = text + "behind<b/>";
  T built(padded.data(), static_cast<int>(padded.size()), &used, module);
  EXPECT_EQ(used, static_cast<int>(text.size())) << text;
  return built;
}

// Beginnings of definition texts.
inline const std::string kModule = "<plugin><module name='m'/>";
inline const std::string kClass = kModule + "<class name='C' namespace='n'>";
inline const std::string kOneInstance = "<instances><constant type='int'>1</constant></instances>";
inline const std::string kClassBody = kClass + kOneInstance;
