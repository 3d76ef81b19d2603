#pragma once

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace cimhost {

struct ElementRule;

/// An element of a document that follows the rules of CIM-XML: its name is known, its required
/// attributes are there, its children are some that it may have. White space between elements is
/// not kept.
struct XmlElement {
  const ElementRule* rule = nullptr;
  std::vector<std::pair<std::string, std::string>> attributes;
  std::vector<XmlElement> children;
  std::string text;  ///< Of elements that hold text; UTF-8.

  std::string_view name() const;
  bool is(std::string_view elementName) const { return name() == elementName; }
  /// nullptr when it is absent.
  const std::string* findAttribute(std::string_view attribute) const;
  /// For attributes that the rule requires.
  const std::string& attribute(std::string_view attribute) const;
  /// Throws request-not-valid unless there is exactly one child.
  const XmlElement& onlyChild() const;
};

/// What CIM-XML (DSP0201) says of one element of a request.
struct ElementRule {
  std::string_view name;
  std::string_view children;    ///< Names, separated by blanks; "#" for text instead.
  std::string_view attributes;  ///< The required ones, separated by blanks.
  bool holdsText() const { return children == "#"; }
};

/// nullptr for what is no element of a request.
const ElementRule* findElementRule(std::string_view name);

/// Calls visit(word) for each word of a list separated by blanks.
template <class Visit>
void forEachWord(std::string_view list, Visit visit) {
  while (!list.empty()) {
    const std::size_t end = std::min(list.find(' '), list.size());
    visit(list.substr(0, end));
    list.remove_prefix(std::min(end + 1, list.size()));
  }
}

/// True when the list, separated by blanks, has the word.
bool hasWord(std::string_view list, std::string_view word);

}  // namespace cimhost
