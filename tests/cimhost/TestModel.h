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
  bool deliverInstance(const Pegasus::CIMInstance& instance) override;
  bool deliverPath(const Pegasus::CIMObjectPath& path) override;
  bool deliverClass(const Pegasus::CIMClass& declaration) override;
  bool deliverClassName(const Pegasus::CIMName& name) override;
  bool deliverMethodResult(const Pegasus::CIMValue& returned,
                           const Pegasus::Array<Pegasus::CIMParamValue>& parameters) override;

  std::vector<std::string> names;
  std::vector<Pegasus::CIMInstance> instances;
  std::vector<Pegasus::CIMClass> classes;
  std::string returnValue = "not delivered";
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
Pegasus::CIMObjectPath pathOf(const std::string& className);

Pegasus::CIMPropertyList listOf(const std::vector<const char*>& names);

/// The code and the message: "2 not for you"; "0 " for success.
std::string textOf(const OperationStatus& status);

}  // namespace cimhost::test
