#pragma once

#include <gtest/gtest.h>

#include <string>

#include "definition/DefinitionFile.h"
#include "definition/ProviderDefXMLError.h"
#include "engine/Registry.h"

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

inline std::string times(int count, const std::string& text) {
  std::string result;
  result.reserve(text.size() * static_cast<size_t>(count));
  for (int i = 0; i < count; ++i) result += text;
  return result;
}

// Parts of definition texts.
inline std::string instances(int count) {
  return "<instances><constant type='int'>" + std::to_string(count) + "</constant></instances>";
}
inline std::string classText(const std::string& name, int count = 1) {
  return "<class name='" + name + "'>" + instances(count) + "</class>";
}
inline const std::string kModule = "<plugin><module name='m'/>";
inline const std::string kClass = kModule + "<class name='C' namespace='n'>";
inline const std::string kOneInstance = instances(1);
inline const std::string kClassBody = kClass + kOneInstance;
