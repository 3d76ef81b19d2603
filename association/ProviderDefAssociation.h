#pragma once

#include "association/ProviderDefCondition.h"
#include "engine/ProviderDefValue.h"

#include <deque>
#include <string>
#include <utility>
#include <vector>

class ElementReader;
class ProviderDefModule;

/// An association class whose instances are computed: which classes it links, and for each pair of
/// classes the condition that decides which of their instances belong together.
///
/// All names ignore letter case. Concurrent use is safe.
class ProviderDefAssociation {
 public:
  using NamePair = std::pair<std::string, std::string>;
  using Values = std::vector<ProviderDefValue>;

  /// Builds the association from its `association` element; see ProviderDefModule.
  ProviderDefAssociation(const char* text, int length, int* consumed, ProviderDefModule* module);
  /// The same for the element at which `reader` stands; leaves it at the end tag.
  ProviderDefAssociation(ElementReader& reader, ProviderDefModule* module);

  const std::string& getName() const { return name_; }
  const std::string& getNamespace() const { return namespace_; }
  /// The names of the two reference properties: first class, second class.
  NamePair getPropertyNamePair() const { return {propertyName1_, propertyName2_}; }
  const std::vector<NamePair>& getClassNamePairs() const { return classNamePairs_; }
  /// One condition for each pair of classes, in the same order.
  const std::vector<ProviderDefCondition>& getConditions() const { return conditions_; }

  /// The properties that the conditions read of a class, in the order of a value vector; those of
  /// the first entry for the class, empty when it has none.
  std::vector<std::string> getClassProperties(const std::string& className) const;

  /// The other class of the first pair that contains `className`; "" when none does.
  std::string getPair(const std::string& className) const;

  /// The target instances that are linked to one source instance, by their index.
  ///
  /// `sourceIndex` and `sourceValues` are the source instance; `targetValues` holds a value vector
  /// for each target instance. A target class with a definition is walked up to its own number of
  /// instances, whatever the size of `targetValues`. Ordered by pair, then by index; a target that
  /// is linked through two pairs stands twice. Writes trace lines on standard output.
  std::vector<int> getAssociation(const std::string& sourceClass, int sourceIndex,
                                  const Values& sourceValues, const std::string& targetClass,
                                  const std::vector<Values>& targetValues) const;

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  enum class Direction { kNone, kForward, kReverse };

  struct Parser;

  void read(ElementReader& reader, ProviderDefModule* module);

  Direction direction(const NamePair& pair, const std::string& source,
                      const std::string& target) const;

  std::string name_;
  std::string namespace_;
  std::string propertyName1_;
  std::string propertyName2_;
  std::vector<NamePair> classNamePairs_;
  std::vector<ProviderDefCondition> conditions_;
  std::vector<std::pair<std::string, std::vector<std::string>>> classProperties_;
};

/// The registered associations in reading order; pointers into it stay valid until
/// releaseModules(). The definition registries implement it.
const std::deque<ProviderDefAssociation>& registeredAssociations();

/// The first registered association of this name; nullptr without one.
const ProviderDefAssociation* getProviderDefAssociation(const std::string& name);

/// The registered associations of this name that link the two classes, in either order. An empty
/// string matches anything. An association is listed once for each of its pairs that matches.
std::vector<const ProviderDefAssociation*> getProviderDefAssociation(
    const std::string& associationName, const std::string& className1,
    const std::string& className2);
