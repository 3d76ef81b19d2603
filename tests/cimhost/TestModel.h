#pragma once

#include "cimhost/EmbeddedCimom.h"
#include "cimhost/Operations.h"
#include "cimhost/Text.h"

#include <string>
#include <vector>

namespace cimhost::test {

/// Collects the names of what is delivered: the property Name of instances, the text of paths, the
/// out-parameters of a method.
class RecordingSink : public InstanceSink,
                      public ObjectPathSink,
                      public ClassSink,
                      public ClassNameSink,
                      public MethodResultSink {
 public:
  bool deliverInstance(const Pegasus::CIMInstance& instance) override {
    Pegasus::String name;
    const Pegasus::Uint32 position = instance.findProperty(Pegasus::CIMName("Name"));
    if (position != Pegasus::PEG_NOT_FOUND) instance.getProperty(position).getValue().get(name);
    instances.push_back(instance);
    return note(name);
  }
  bool deliverPath(const Pegasus::CIMObjectPath& path) override { return note(path.toString()); }
  bool deliverClass(const Pegasus::CIMClass& declaration) override {
    return note(declaration.getClassName().getString());
  }
  bool deliverClassName(const Pegasus::CIMName& name) override { return note(name.getString()); }
  bool deliverMethodResult(const Pegasus::CIMValue& returned,
                           const Pegasus::Array<Pegasus::CIMParamValue>& parameters) override {
    returnValue = returned.isNull() ? "null" : toUtf8(returned.toString());
    for (Pegasus::Uint32 i = 0; i < parameters.size(); ++i) {
      note(parameters[i].getParameterName() + "=" + parameters[i].getValue().toString());
    }
    return true;
  }

  std::vector<std::string> names;
  std::vector<Pegasus::CIMInstance> instances;
  std::string returnValue = "not delivered";

 private:
  bool note(const Pegasus::String& text) {
    names.push_back(toUtf8(text));
    return true;
  }
};

/// A repository with the classes of the test provider in root/test, that provider loaded, and the
/// operations over both.
class TestHost {
 public:
  explicit TestHost(const std::string& providerName = "CommonProvider");
  ~TestHost();
  TestHost(const TestHost&) = delete;
  TestHost& operator=(const TestHost&) = delete;

  ClassRepository repository;
  ServedClasses served;
  ProviderLibrary provider;
  Operations operations{repository, served, provider};
  EmbeddedCimom cimom{repository, operations};

 private:
  void serve(const char* name, bool association = false, bool methods = false);

  Pegasus::CIMOMHandle* handle_;
};

inline const Pegasus::CIMNamespaceName kNamespace("root/test");

/// The class `name` as `mof` declares it.
Pegasus::CIMClass readClass(const std::string& mof, const char* name);

/// The object with the key Name="a" of a class.
inline Pegasus::CIMObjectPath pathOf(const std::string& className) {
  return Pegasus::CIMObjectPath((className + ".Name=\"a\"").c_str());
}

inline Pegasus::CIMPropertyList listOf(const std::vector<const char*>& names) {
  Pegasus::Array<Pegasus::CIMName> list;
  for (const char* name : names) list.append(Pegasus::CIMName(name));
  return Pegasus::CIMPropertyList(list);
}

/// The code and the message: "2 not for you"; "0 " for success.
inline std::string textOf(const OperationStatus& status) {
  return std::to_string(static_cast<int>(status.code)) + " " + status.message;
}

}  // namespace cimhost::test
