#include "association/ProviderDefAssociation.h"

#include "diagnostics/TraceLine.h"
#include "engine/ProviderDefClass.h"
#include "engine/ciEqual.h"

#include <algorithm>

std::vector<std::string> ProviderDefAssociation::getClassProperties(
    const std::string& className) const {
  for (const auto& [name, properties] : classProperties_) {
    if (ci_equal(name, className)) return properties;
  }
  return {};
}

std::string ProviderDefAssociation::getPair(const std::string& className) const {
  for (const auto& [first, second] : classNamePairs_) {
    if (ci_equal(first, className)) return second;
    if (ci_equal(second, className)) return first;
  }
  return std::string();
}

ProviderDefAssociation::Direction ProviderDefAssociation::direction(
    const NamePair& pair, const std::string& source, const std::string& target) const {
  if (ci_equal(pair.first, source) && ci_equal(pair.second, target)) return Direction::kForward;
  if (ci_equal(pair.second, source) && ci_equal(pair.first, target)) return Direction::kReverse;
  return Direction::kNone;
}

std::vector<int> ProviderDefAssociation::getAssociation(
    const std::string& sourceClass, int sourceIndex, const Values& sourceValues,
    const std::string& targetClass, const std::vector<Values>& targetValues) const {
  static const Values kNoValues;
  std::vector<int> result;
  TraceLine() << "ProviderDefAssociation::getAssociation Entry\n";
  for (size_t p = 0; p < classNamePairs_.size(); ++p) {
    const Direction way = direction(classNamePairs_[p], sourceClass, targetClass);
    if (way == Direction::kNone) continue;
    const ProviderDefClass* target = getProviderDefClass(targetClass);
    const int count = target != nullptr ? boundedNumberOfInstances(*target)
                                        : static_cast<int>(targetValues.size());
    TraceLine() << "pairs " << static_cast<int>(p) << ", numinst " << count << ", numcond "
                << static_cast<int>(conditions_.size()) << "\n";
    if (p >= conditions_.size()) continue;
    for (int t = 0; t < count; ++t) {
      const size_t position = static_cast<size_t>(t);
      const Values& values = position < targetValues.size() ? targetValues[position] : kNoValues;
      const bool linked = way == Direction::kForward
                              ? conditions_[p].getValue(sourceIndex, sourceValues, t, values)
                              : conditions_[p].getValue(t, values, sourceIndex, sourceValues);
      if (!linked) continue;
      TraceLine() << "putting associated index : " << t << "\n";
      result.push_back(t);
    }
  }
  TraceLine() << "ProviderDefAssociation::getAssociation Exit. Number of results is "
              << static_cast<int>(result.size()) << " \n";
  return result;
}

const ProviderDefAssociation* getProviderDefAssociation(const std::string& name) {
  const auto& all = registeredAssociations();
  const auto found = std::find_if(all.begin(), all.end(), [&name](const auto& association) {
    return ci_equal(association.getName(), name);
  });
  return found == all.end() ? nullptr : &*found;
}

std::vector<const ProviderDefAssociation*> getProviderDefAssociation(
    const std::string& associationName, const std::string& className1,
    const std::string& className2) {
  const auto matches = [](const std::string& wanted, const std::string& name) {
    return wanted.empty() || ci_equal(wanted, name);
  };
  std::vector<const ProviderDefAssociation*> result;
  for (const ProviderDefAssociation& association : registeredAssociations()) {
    if (!matches(associationName, association.getName())) continue;
    for (const auto& [first, second] : association.getClassNamePairs()) {
      const bool forward = matches(className1, first) && matches(className2, second);
      const bool reverse = matches(className2, first) && matches(className1, second);
      if (forward || reverse) result.push_back(&association);
    }
  }
  return result;
}
