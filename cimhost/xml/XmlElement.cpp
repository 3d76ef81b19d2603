#include "cimhost/xml/XmlElement.h"

#include "cimhost/xml/HttpError.h"

#include <algorithm>
#include <iterator>

namespace cimhost {

namespace {

#define ANY_PATH "CLASSPATH LOCALCLASSPATH CLASSNAME INSTANCEPATH LOCALINSTANCEPATH INSTANCENAME"
#define ANY_PROPERTY "PROPERTY PROPERTY.ARRAY PROPERTY.REFERENCE"
#define ANY_PARAMETER "PARAMETER PARAMETER.REFERENCE PARAMETER.ARRAY PARAMETER.REFARRAY"
#define ANY_OBJECT "CLASS INSTANCE VALUE.NAMEDINSTANCE"

// DSP0201, 5.2: what requests are made of, sorted by name.
constexpr ElementRule kRules[] = {
    {"CIM", "MESSAGE", "CIMVERSION DTDVERSION"},
    {"CLASS", "QUALIFIER METHOD " ANY_PROPERTY, "NAME"},
    {"CLASSNAME", "", "NAME"},
    {"CLASSPATH", "NAMESPACEPATH CLASSNAME", ""},
    {"CORRELATOR", "VALUE", "NAME TYPE"},
    {"EXPMETHODCALL", "EXPPARAMVALUE", "NAME"},
    {"EXPPARAMVALUE", "INSTANCE", "NAME"},
    {"HOST", "#", ""},
    {"IMETHODCALL", "LOCALNAMESPACEPATH IPARAMVALUE", "NAME"},
    {"INSTANCE", "QUALIFIER " ANY_PROPERTY, "CLASSNAME"},
    {"INSTANCENAME", "KEYBINDING KEYVALUE VALUE.REFERENCE", "CLASSNAME"},
    {"INSTANCEPATH", "NAMESPACEPATH INSTANCENAME", ""},
    {"IPARAMVALUE",
     "VALUE VALUE.ARRAY VALUE.REFERENCE CLASSNAME INSTANCENAME QUALIFIER.DECLARATION " ANY_OBJECT,
     "NAME"},
    {"KEYBINDING", "KEYVALUE VALUE.REFERENCE", "NAME"},
    {"KEYVALUE", "#", ""},
    {"LOCALCLASSPATH", "LOCALNAMESPACEPATH CLASSNAME", ""},
    {"LOCALINSTANCEPATH", "LOCALNAMESPACEPATH INSTANCENAME", ""},
    {"LOCALNAMESPACEPATH", "NAMESPACE", ""},
    {"MESSAGE", "SIMPLEREQ MULTIREQ SIMPLEEXPREQ MULTIEXPREQ", "ID PROTOCOLVERSION"},
    {"METHOD", "QUALIFIER " ANY_PARAMETER, "NAME"},
    {"METHODCALL", "LOCALCLASSPATH LOCALINSTANCEPATH PARAMVALUE", "NAME"},
    {"MULTIEXPREQ", "SIMPLEEXPREQ", ""},
    {"MULTIREQ", "SIMPLEREQ", ""},
    {"NAMESPACE", "", "NAME"},
    {"NAMESPACEPATH", "HOST LOCALNAMESPACEPATH", ""},
    {"PARAMETER", "QUALIFIER", "NAME TYPE"},
    {"PARAMETER.ARRAY", "QUALIFIER", "NAME TYPE"},
    {"PARAMETER.REFARRAY", "QUALIFIER", "NAME"},
    {"PARAMETER.REFERENCE", "QUALIFIER", "NAME"},
    {"PARAMVALUE",
     "VALUE VALUE.ARRAY VALUE.REFERENCE VALUE.REFARRAY CLASSNAME INSTANCENAME " ANY_OBJECT, "NAME"},
    {"PROPERTY", "QUALIFIER VALUE", "NAME TYPE"},
    {"PROPERTY.ARRAY", "QUALIFIER VALUE.ARRAY", "NAME TYPE"},
    {"PROPERTY.REFERENCE", "QUALIFIER VALUE.REFERENCE", "NAME"},
    {"QUALIFIER", "VALUE VALUE.ARRAY", "NAME TYPE"},
    {"QUALIFIER.DECLARATION", "SCOPE VALUE VALUE.ARRAY", "NAME TYPE"},
    {"SCOPE", "", ""},
    {"SIMPLEEXPREQ", "CORRELATOR EXPMETHODCALL", ""},
    {"SIMPLEREQ", "CORRELATOR IMETHODCALL METHODCALL", ""},
    {"VALUE", "#", ""},
    {"VALUE.ARRAY", "VALUE VALUE.NULL", ""},
    {"VALUE.NAMEDINSTANCE", "INSTANCENAME INSTANCE", ""},
    {"VALUE.NULL", "", ""},
    {"VALUE.REFARRAY", "VALUE.REFERENCE VALUE.NULL", ""},
    {"VALUE.REFERENCE", ANY_PATH, ""},
};

}  // namespace

bool hasWord(std::string_view list, std::string_view word) {
  bool found = false;
  forEachWord(list, [&](std::string_view each) { found = found || each == word; });
  return found;
}

const ElementRule* findElementRule(std::string_view name) {
  const auto* const found = std::lower_bound(
      std::begin(kRules), std::end(kRules), name,
      [](const ElementRule& rule, std::string_view wanted) { return rule.name < wanted; });
  return found != std::end(kRules) && found->name == name ? found : nullptr;
}

std::string_view XmlElement::name() const {
  return rule->name;
}

const std::string* XmlElement::findAttribute(std::string_view attribute) const {
  for (const auto& each : attributes) {
    if (each.first == attribute) return &each.second;
  }
  return nullptr;
}

const std::string& XmlElement::attribute(std::string_view attribute) const {
  const std::string* const found = findAttribute(attribute);
  if (found == nullptr) {
    throwNotValid(std::string(name()) + " without " + std::string(attribute));
  }
  return *found;
}

const XmlElement& XmlElement::onlyChild() const {
  if (children.size() != 1) throwNotValid(std::string(name()) + " must hold one element");
  return children.front();
}

}  // namespace cimhost
