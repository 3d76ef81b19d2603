#include "cimhost/Registration.h"

#include "cimhost/Text.h"
#include "cimhost/mof/MofKeywords.h"
#include "cimhost/output/MofText.h"

#include <Pegasus/Common/CIMInstance.h>

#include <map>
#include <string>
#include <utility>

namespace cimhost {

using namespace Pegasus;

namespace {

// What the entry point of the library is called with; it answers to no other name.
constexpr const char* kProviderName = "CommonProvider";
constexpr const char* kInterfaceVersion = "2.9.0";
constexpr Uint16 kInstanceProvider = 2;
constexpr Uint16 kAssociationProvider = 3;
constexpr Uint16 kMethodProvider = 5;

using ProviderTypes = std::pair<bool, bool>;  // association, methods

struct Place {
  CIMNamespaceName nameSpace;
  ProviderTypes types;
};

// Both kinds of name ignore letter case, so the keys are lowered.
struct ClassPlaces {
  CIMName className;
  std::map<std::string, Place> places;
};

template <class Name>
std::string keyOf(const Name& name) {
  return asciiLowered(toUtf8(name.getString()));
}

std::vector<CIMNamespaceName> nameSpacesOf(const ServedClass& served,
                                           const ClassRepository& repository) {
  if (!served.nameSpace.isNull()) return {served.nameSpace};
  std::vector<CIMNamespaceName> found;
  for (const CIMNamespaceName& space : repository.namespaces()) {
    if (repository.hasClass(space, served.className)) found.push_back(space);
  }
  return found;
}

void addPlace(ClassPlaces& entry, const ServedClass& served, const CIMNamespaceName& nameSpace) {
  entry.className = entry.className.isNull() ? served.className : entry.className;
  Place& place = entry.places.try_emplace(keyOf(nameSpace), Place{nameSpace, {}}).first->second;
  place.types.first |= served.association;
  place.types.second |= served.hasMethods;
}

// The first one has the class name as its id, others the name of a namespace in front of it.
void appendCapabilities(const ClassPlaces& entry, std::vector<ProviderCapability>& capabilities) {
  std::map<ProviderTypes, std::size_t> positions;
  for (const auto& [key, place] : entry.places) {
    const auto [found, isNew] = positions.try_emplace(place.types, capabilities.size());
    if (isNew) {
      String id = entry.className.getString();
      if (positions.size() > 1) id = place.nameSpace.getString() + String(":") + id;
      const auto [association, methods] = place.types;
      capabilities.push_back({id, entry.className, {}, association, methods});
    }
    capabilities[found->second].nameSpaces.push_back(place.nameSpace);
  }
}

void set(CIMInstance& instance, const char* name, const CIMValue& value) {
  instance.addProperty(CIMProperty(CIMName(name), value));
}

CIMInstance moduleInstance(const RegistrationOptions& options) {
  CIMInstance instance(CIMName("PG_ProviderModule"));
  set(instance, "Name", options.moduleName);
  set(instance, "Vendor", options.vendor);
  set(instance, "Version", options.moduleVersion);
  set(instance, "InterfaceType", String("C++Default"));
  set(instance, "InterfaceVersion", String(kInterfaceVersion));
  set(instance, "Location", options.location);
  return instance;
}

CIMInstance providerInstance(const String& moduleName) {
  CIMInstance instance(CIMName("PG_Provider"));
  set(instance, "ProviderModuleName", moduleName);
  set(instance, "Name", String(kProviderName));
  return instance;
}

CIMInstance capabilityInstance(const String& moduleName, const ProviderCapability& capability) {
  Array<String> nameSpaces;
  for (const CIMNamespaceName& space : capability.nameSpaces) nameSpaces.append(space.getString());
  Array<Uint16> types;
  types.append(kInstanceProvider);
  if (capability.association) types.append(kAssociationProvider);
  if (capability.methods) types.append(kMethodProvider);
  CIMInstance instance(CIMName("PG_ProviderCapabilities"));
  set(instance, "ProviderModuleName", moduleName);
  set(instance, "ProviderName", String(kProviderName));
  set(instance, "CapabilityID", capability.id);
  set(instance, "ClassName", capability.className.getString());
  set(instance, "Namespaces", nameSpaces);
  set(instance, "ProviderType", types);
  // Null: all of them.
  set(instance, "SupportedProperties", CIMValue(CIMTYPE_STRING, true));
  set(instance, "SupportedMethods", CIMValue(CIMTYPE_STRING, true));
  return instance;
}

void writeHelp(std::ostream& out, const RegistrationOptions& options) {
  const std::string module = toUtf8(options.moduleName);
  out << "// Registers lib" << toUtf8(options.location) << ".so with OpenPegasus.\n"
      << "// While the server runs, after the class declarations:\n"
      << "//   cimmof -n root/PG_InterOp FILE\n"
      << "// To take it back:\n"
      << "//   cimprovider -d -m " << module << "\n"
      << "//   cimprovider -r -m " << module << "\n";
}

}  // namespace

Registration::Registration(const ServedClasses& served, const ClassRepository& repository) {
  std::map<std::string, ClassPlaces> classes;
  for (const ServedClass& each : served.all()) {
    const std::vector<CIMNamespaceName> nameSpaces = nameSpacesOf(each, repository);
    for (const CIMNamespaceName& space : nameSpaces) {
      addPlace(classes[keyOf(each.className)], each, space);
    }
    if (!nameSpaces.empty()) continue;
    warnings_.push_back({Diagnostic::Severity::warning,
                         each.file,
                         0,
                         0,
                         "class " + toUtf8(each.className.getString()) +
                             " is not registered: its definition has no namespace, and none "
                             "declares it",
                         {}});
  }
  for (const auto& [key, entry] : classes) appendCapabilities(entry, capabilities_);
}

void Registration::write(std::ostream& out, const RegistrationOptions& options) const {
  writeHelp(out, options);
  out << '\n' << mofInstance(moduleInstance(options));
  out << '\n' << mofInstance(providerInstance(options.moduleName));
  for (const ProviderCapability& each : capabilities_) {
    out << '\n' << mofInstance(capabilityInstance(options.moduleName, each));
  }
}

}  // namespace cimhost
