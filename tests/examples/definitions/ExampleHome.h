#pragma once

#include <gtest/gtest.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "definition/DefinitionFile.h"
#include "engine/ProviderDefClass.h"
#include "engine/Registry.h"

/// A definition file read in the working directory of its example's home, as the provider does.
class ExampleHome {
 public:
  explicit ExampleHome(const std::string& name) {
    EXPECT_EQ(chdir((std::string(EXAMPLE_HOMES) + "/" + name + "/run").c_str()), 0);
    readProviderDefXML(name + ".xml");
  }
  ~ExampleHome() {
    releaseFunctions();
    releaseModules();
  }
  ExampleHome(const ExampleHome&) = delete;
  ExampleHome& operator=(const ExampleHome&) = delete;

  static ProviderDefValue value(const std::string& className, const char* property, int index) {
    const ProviderDefClass* definition = getProviderDefClass(className);
    if (definition == nullptr || definition->getProperty(property) == nullptr) {
      ADD_FAILURE() << className << "." << property << " is not defined";
      return ProviderDefValue();
    }
    return definition->getProperty(property)->getValue(index);
  }

  /// The property of every instance, in order.
  static std::vector<ProviderDefValue> values(const std::string& className, const char* property) {
    std::vector<ProviderDefValue> result;
    const int count = getProviderDefClass(className)->getNumberOfInstances();
    for (int i = 0; i < count; ++i) result.push_back(value(className, property, i));
    return result;
  }
};
