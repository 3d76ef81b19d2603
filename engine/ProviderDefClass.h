#pragma once

#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefMethod.h"
#include "engine/ProviderDefProperty.h"

#include <string>
#include <string_view>
#include <vector>

class ElementReader;

/// A CIM class that the provider serves: its instances, properties and methods.
class ProviderDefClass {
 public:
  /// Builds the class from its `class` element; see ProviderDefModule for the arguments.
  ProviderDefClass(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefClass(ElementReader& reader, ProviderDefModule* module);

  const std::string& getName() const { return name_; }
  const std::string& getNamespace() const { return namespace_; }
  const std::vector<ProviderDefProperty>& getProperties() const { return properties_; }
  const std::vector<ProviderDefMethod>& getMethods() const { return methods_; }

  /// The first property or method of exactly this name, case-sensitive; nullptr without one.
  const ProviderDefProperty* getProperty(std::string_view name) const;
  const ProviderDefMethod* getMethod(std::string_view name) const;

  /// From the instance-count call, or the constant. May be negative: a plug-in said so.
  int getNumberOfInstances() const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  void read(ElementReader& reader, ProviderDefModule* module);
  void readInstances(ElementReader& reader, ProviderDefModule* module);

  std::string name_;
  std::string namespace_;
  std::vector<ProviderDefProperty> properties_;
  std::vector<ProviderDefMethod> methods_;
  ProviderDefFunctionCall instancesCall_;
  bool instancesFromFunction_ = false;
  int numberOfInstances_ = 0;
};

/// The most instances of one class that are walked. A larger count is a plug-in gone wrong.
inline constexpr int kMaxInstances = 1000000;

/// getNumberOfInstances(), at most kMaxInstances; noted at level 1 where that cuts.
int boundedNumberOfInstances(const ProviderDefClass& definition);

/// Finds a registered class by its name, ignoring letter case; the first one wins, nullptr without
/// one. The definition registries implement it.
const ProviderDefClass* getProviderDefClass(const std::string& name);
