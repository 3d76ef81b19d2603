#pragma once

#include "engine/ProviderDefError.h"
#include "engine/Registry.h"
#include "tests/engine/ValueText.h"
#include "tests/support/TemporaryTree.h"

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <string>

inline std::string pluginFile(const std::string& name) {
  return std::string(TEST_PLUGIN_FOLDER) + "/lib" + name + ".so";
}

inline bool isOpen(const std::string& plugin) {
  void* handle = dlopen(pluginFile(plugin).c_str(), RTLD_NOW | RTLD_NOLOAD);
  if (handle != nullptr) dlclose(handle);
  return handle != nullptr;
}

/// The message of the ProviderDefError that `action` throws; empty when it throws none.
template <class Action>
std::string errorOf(Action action) {
  try {
    action();
  } catch (const ProviderDefError& error) {
    return error.getMessage();
  }
  return "";
}

/// A temporary home whose lib/ holds the plug-ins of tests/plugins, and registries that are emptied
/// at the end, which closes the plug-ins.
class PluginTest : public testing::Test {
 protected:
  PluginTest() {
    for (const char* name :
         {"alltypes", "lifecycle", "pair_a", "pair_b", "misbehaving", "broken"}) {
      tree_.addPlugin(name, pluginFile(name));
    }
  }
  ~PluginTest() override { release(); }

  static void release() {
    releaseFunctions();
    releaseModules();
  }

  static ProviderDefModule& module(const std::string& name) {
    ProviderDefModule* known = getModule(name);
    return *(known != nullptr ? known
                              : registerModule(std::make_unique<ProviderDefModule>(name, true)));
  }

  /// A function of the plug-in `module`, called as the type of that name.
  static ProviderDefFunction& function(const std::string& module, const std::string& name,
                                       const std::string& type) {
    return *registerFunction(std::make_unique<ProviderDefFunction>(name, functionTypeCode(type),
                                                                   &PluginTest::module(module)));
  }

  /// Builds an object from its element.
  template <class T>
  static T fromText(const std::string& text) {
    int consumed = 0;
    T object(text.c_str(), static_cast<int>(text.size()), &consumed, nullptr);
    EXPECT_EQ(consumed, static_cast<int>(text.size()));
    return object;
  }

  /// The element that calls a plug-in function with `arguments` (elements, too).
  static std::string callText(const std::string& module, const std::string& name,
                              const std::string& type, const std::string& arguments = "") {
    return "<functioncall><function name=\"" + name + "\" type=\"" + type + "\"><module name=\"" +
           module + "\" path=\"short\"/></function>" + arguments + "</functioncall>";
  }

  /// Gives a module an initialisation call that its definition has.
  static void setInit(const std::string& module, const std::string& call) {
    PluginTest::module(module).setInit(keepInitCall(
        std::make_unique<ProviderDefFunctionCall>(fromText<ProviderDefFunctionCall>(call))));
  }

  const TemporaryTree tree_;
};
