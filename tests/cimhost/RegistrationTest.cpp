#include "cimhost/Registration.h"

#include "cimhost/Text.h"

#include <gmock/gmock.h>

#include <string>
#include <vector>

namespace {

using namespace cimhost;

enum Kind { kPlain, kAssociation, kMethods };

struct Definition {
  const char *nameSpace, *className;
  Kind kind;
};

ServedClass served(const Definition& definition) {
  ServedClass result;
  if (*definition.nameSpace != '\0')
    result.nameSpace = Pegasus::CIMNamespaceName(definition.nameSpace);
  result.className = Pegasus::CIMName(definition.className);
  result.association = definition.kind == kAssociation;
  result.hasMethods = definition.kind == kMethods;
  return result;
}

// "id: class in namespace namespace; association; methods"
std::string text(const ProviderCapability& capability) {
  std::string result =
      toUtf8(capability.id) + ": " + toUtf8(capability.className.getString()) + " in";
  for (const auto& space : capability.nameSpaces) result += " " + toUtf8(space.getString());
  if (capability.association) result += "; association";
  if (capability.methods) result += "; methods";
  return result;
}

// Class A is declared in root/x and root/y, nothing else is.
TEST(Registration, OneCapabilityForEachClassAndSetOfProviderTypes) {
  ClassRepository repository;
  for (const char* space : {"root/y", "root/x"}) {
    repository.addNamespace(space);
    repository.addClass(space, Pegasus::CIMClass("A"));
  }
  const struct {
    const char* name;
    std::vector<Definition> definitions;
    std::vector<const char*> capabilities;
    std::size_t warnings = 0;
  } cases[] = {
      {"sorted, whatever the order of the files",
       {{"root/b", "b", kPlain}, {"root/a", "B", kPlain}, {"root/a", "A", kPlain}},
       {"A: A in root/a", "b: b in root/a root/b"}},
      {"defined again, in other letter case",
       {{"root/a", "A", kPlain}, {"ROOT/A", "a", kPlain}},
       {"A: A in root/a"}},
      {"methods in one namespace of three",
       {{"root/a", "A", kPlain}, {"root/b", "A", kMethods}, {"root/c", "A", kPlain}},
       {"A: A in root/a root/c", "root/b:A: A in root/b; methods"}},
      {"class and association at once",
       {{"root/a", "L", kAssociation}, {"root/a", "L", kMethods}, {"root/a", "L", kPlain}},
       {"L: L in root/a; association; methods"}},
      {"without a namespace: where it is declared",
       {{"", "A", kMethods}},
       {"A: A in root/x root/y; methods"}},
      {"with and without",
       {{"", "A", kPlain}, {"root/z", "A", kPlain}},
       {"A: A in root/x root/y root/z"}},
      {"without a namespace and nowhere declared",
       {{"", "B", kPlain}, {"root/a", "C", kPlain}},
       {"C: C in root/a"},
       1},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.name);
    ServedClasses all;
    for (const Definition& each : row.definitions) all.add(served(each));
    const Registration registration(all, repository);
    std::vector<std::string> texts;
    for (const auto& each : registration.capabilities()) texts.push_back(text(each));
    EXPECT_THAT(texts, testing::ElementsAreArray(row.capabilities));
    EXPECT_EQ(registration.warnings().size(), row.warnings);
  }
}

}  // namespace
