#pragma once

#include <Pegasus/Provider/CIMOMHandle.h>
#include <dlfcn.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <optional>
#include <string>

#include "RecordingHandler.h"
#include "TestHost.h"
#include "plugins/provider_test_plugin.h"
#include "provider/CommonProvider.h"
#include "tests/support/LogLevel.h"
#include "tests/support/StdoutCapture.h"
#include "tests/support/TemporaryTree.h"

using testing::ElementsAre;
using testing::HasSubstr;

// Pieces of definition files.

inline std::string call(const std::string& function, const std::string& type,
                        const std::string& arguments = "<argument type=\"index\"/>") {
  return "<functioncall><function name=\"" + function + "\" type=\"" + type + "\"/>" + arguments +
         "</functioncall>";
}

inline std::string constant(const std::string& type, const std::string& text) {
  return "<constant type=\"" + type + "\">" + text + "</constant>";
}

inline std::string property(const std::string& name, const std::string& get,
                            const std::string& set = "") {
  return "<property name=\"" + name + "\"><get>" + get + "</get>" +
         (set.empty() ? "" : "<set>" + set + "</set>") + "</property>";
}

inline std::string definedClass(const std::string& name, const std::string& instances,
                                const std::string& body) {
  return "<class name=\"" + name + "\" namespace=\"root/t\"><instances>" + instances +
         "</instances>" + body + "</class>";
}

/// Names come from the left table of the plug-in.
inline std::string itemClass(const std::string& body = "") {
  return definedClass("T_Item", call("leftCount", "getI", ""),
                      property("Name", call("leftText", "getSi")) + body);
}

inline std::string definitionFile(const std::string& body) {
  return "<plugin><module name=\"test\" path=\"short\"/>" + body + "</plugin>";
}

inline CIMObjectPath pathOf(const char* text) {
  return CIMObjectPath(String(text));
}

/// The message of the CIM_ERR_NOT_SUPPORTED that the operation throws.
template <class Operation>
std::string refusal(Operation operation) {
  try {
    operation();
  } catch (const CIMException& error) {
    if (error.getCode() == CIM_ERR_NOT_SUPPORTED) return textOf(error.getMessage());
  }
  return "none";
}

/// A provider over the plug-in, a definition file and a host, made as a server makes it.
class ProviderTest : public testing::Test {
 public:
  ProviderTest() {
    tree.addPlugin("test", PROVIDER_TEST_PLUGIN);
    setEmbeddedHost(&host);
    handle.emplace();
    state = static_cast<TestPluginState*>(dlsym(plugin, "test_plugin_state"));
    *state = TestPluginState();
  }

  ~ProviderTest() override {
    if (provider != nullptr) stop();
    setEmbeddedHost(nullptr);
    if (plugin != nullptr) dlclose(plugin);
  }

  void start(const std::string& body) {
    TemporaryTree::write(tree.run() / "defs.xml", definitionFile(body));
    provider =
        dynamic_cast<Vaneth::CommonProvider*>(PegasusCreateProvider(String("CommonProvider")));
    provider->initialize(*handle);
  }

  void stop() {
    provider->terminate();
    provider = nullptr;
  }

  /// Puts another host behind the provider's handle.
  void use(TestHost& other) {
    setEmbeddedHost(&other);
    *handle = CIMOMHandle();
  }

  void setTable(TestTable& table, std::initializer_list<const char*> texts) {
    table.count = 0;
    for (const char* text : texts) table.texts[table.count++] = text;
  }

  // What each operation gives its handler.

  RecordingHandler enumerate(const char* path) {
    RecordingHandler handler;
    provider->enumerateInstances(context, pathOf(path), false, false, CIMPropertyList(), handler);
    return handler;
  }

  RecordingHandler instanceNames(const char* path) {
    RecordingHandler handler;
    provider->enumerateInstanceNames(context, pathOf(path), handler);
    return handler;
  }

  RecordingHandler get(const CIMObjectPath& path) {
    RecordingHandler handler;
    provider->getInstance(context, path, false, false, CIMPropertyList(), handler);
    return handler;
  }

  using Properties = std::initializer_list<std::pair<const char*, CIMValue>>;
  std::vector<std::string> modify(const char* path, Properties properties) {
    CIMInstance sent(pathOf(path).getClassName());
    for (const auto& [name, value] : properties) {
      sent.addProperty(CIMProperty(CIMName(name), value));
    }
    RecordingHandler handler;
    provider->modifyInstance(context, pathOf(path), sent, true, CIMPropertyList(), handler);
    return handler.events;
  }

  std::vector<std::string> invoke(const char* path, const char* method, Properties inputs = {}) {
    Array<CIMParamValue> sent;
    for (const auto& [name, value] : inputs) {
      sent.append(CIMParamValue(String(name), value));
    }
    RecordingHandler handler;
    provider->invokeMethod(context, pathOf(path), CIMName(method), sent, handler);
    return handler.events;
  }

  /// Empty names stand for null ones.
  std::vector<std::string> associatorNames(const char* object, const char* associationClass = "",
                                           const char* resultClass = "") {
    RecordingHandler handler;
    provider->associatorNames(context, pathOf(object), nameOrNull(associationClass),
                              nameOrNull(resultClass), String("role"), String("other"), handler);
    return handler.events;
  }

  std::vector<std::string> associators(const char* object, const char* associationClass = "",
                                       const char* resultClass = "") {
    const CIMPropertyList nothing{Array<CIMName>()};
    RecordingHandler handler;
    provider->associators(context, pathOf(object), nameOrNull(associationClass),
                          nameOrNull(resultClass), String(), String(), true, true, nothing,
                          handler);
    return handler.events;
  }

  TemporaryTree tree;
  LogLevel quiet{0};
  TestHost host;
  std::optional<CIMOMHandle> handle;
  void* plugin = dlopen(PROVIDER_TEST_PLUGIN, RTLD_NOW);
  TestPluginState* state = nullptr;
  Vaneth::CommonProvider* provider = nullptr;
  OperationContext context;

 private:
  static CIMName nameOrNull(const char* text) { return *text == '\0' ? CIMName() : CIMName(text); }
};
