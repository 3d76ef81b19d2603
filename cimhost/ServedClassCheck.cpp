#include "cimhost/ServedClassCheck.h"

#include "cimhost/Text.h"
#include "cimhost/repository/NameHash.h"

#include <unordered_map>

namespace cimhost {

using namespace Pegasus;

namespace {

class Checker {
 public:
  Checker(const ClassRepository& repository, std::vector<Diagnostic>& warnings)
      : repository_(repository), warnings_(warnings) {}

  void check(const ServedClass& served) {
    warnRepeated(served);
    const std::vector<CIMNamespaceName> spaces = declaringNamespaces(served);
    if (spaces.empty()) warnUndeclared(served);
    for (const CIMNamespaceName& space : spaces) checkProperties(served, space);
  }

 private:
  std::vector<CIMNamespaceName> declaringNamespaces(const ServedClass& served) const {
    std::vector<CIMNamespaceName> found;
    for (const CIMNamespaceName& space : repository_.namespaces()) {
      const bool wanted = served.nameSpace.isNull() || served.nameSpace == space;
      if (wanted && repository_.hasClass(space, served.className)) found.push_back(space);
    }
    return found;
  }

  void checkProperties(const ServedClass& served, const CIMNamespaceName& space) {
    const CIMClass declaration =
        repository_.getClass(space, served.className, false, true, true, CIMPropertyList());
    for (const std::string& name : served.properties) {
      const Uint32 position = findProperty(declaration, name);
      const std::string problem = problemOf(declaration, name, position);
      if (problem.empty()) continue;
      warn(served, "property " + name + " of class " + className(served) + " is " + problem);
    }
  }

  // Empty when there is none. The provider looks definitions up by the declared name, exactly.
  static std::string problemOf(const CIMClass& declaration, const std::string& name,
                               Uint32 position) {
    if (position == PEG_NOT_FOUND) return "defined, but not declared; it is left out";
    const CIMConstProperty property = declaration.getProperty(position);
    const std::string declared = toUtf8(property.getName().getString());
    if (declared != name)
      return "declared as " + declared + ": letter case differs; it is left out";
    if (property.findQualifier(CIMName("Key")) == PEG_NOT_FOUND) {
      return "declared without [Key] or [Key(false)]; "
             "the provider delivers no instance of the class";
    }
    if (property.getType() == CIMTYPE_REFERENCE && !declaration.isAssociation()) {
      return "a reference in a class that is no association; OpenPegasus refuses the declaration";
    }
    return {};
  }

  static Uint32 findProperty(const CIMClass& declaration, const std::string& name) {
    try {
      return declaration.findProperty(CIMName(fromUtf8(name)));
    } catch (const Exception&) {
      return PEG_NOT_FOUND;  // Not a CIM name, or not even UTF-8.
    }
  }

  static std::string className(const ServedClass& served) {
    return toUtf8(served.className.getString());
  }

  // The provider finds a definition by its name alone, whatever the namespace.
  void warnRepeated(const ServedClass& served) {
    auto& [asClass, asAssociation] = seen_[served.className];
    const ServedClass*& same = served.association ? asAssociation : asClass;
    const ServedClass* other = served.association ? asClass : asAssociation;
    if (same != nullptr) {
      warn(served, "class " + className(served) + " is already defined in " + same->file +
                       ", which serves it in every namespace");
    } else if (other != nullptr) {
      warn(served, "class " + className(served) + " is defined as a class and as an association; " +
                       "clients see only the instances of the association");
    }
    if (same == nullptr) same = &served;
  }

  void warnUndeclared(const ServedClass& served) {
    std::string text = "class " + className(served) + " is defined, but not declared";
    if (!served.nameSpace.isNull()) {
      text += " in namespace " + toUtf8(served.nameSpace.getString());
    }
    warn(served, text + "; no client can reach it");
  }

  void warn(const ServedClass& served, const std::string& message) {
    warnings_.push_back({Diagnostic::Severity::warning, served.file, 0, 0, message, {}});
  }

  struct Definitions {
    const ServedClass* asClass = nullptr;
    const ServedClass* asAssociation = nullptr;
  };

  const ClassRepository& repository_;
  std::vector<Diagnostic>& warnings_;
  // The first of each name; they outlive the checker.
  std::unordered_map<CIMName, Definitions, NameHash, NameEqual> seen_;
};

}  // namespace

std::vector<Diagnostic> checkServedClasses(const ServedClasses& served,
                                           const ClassRepository& repository) {
  std::vector<Diagnostic> warnings;
  Checker checker(repository, warnings);
  for (const ServedClass& each : served.all()) checker.check(each);
  return warnings;
}

}  // namespace cimhost
