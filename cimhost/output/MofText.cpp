#include "cimhost/output/MofText.h"

#include "cimhost/CimTypes.h"
#include "cimhost/Text.h"

#include <charconv>
#include <cmath>
#include <cstdio>
#include <utility>
#include <vector>

namespace cimhost {

using namespace Pegasus;

namespace {

// An embedded object may hold others; a chain of them must not exhaust the stack.
constexpr int kMaximumNesting = 16;

struct MofFormatter {
  int depth = 0;

  std::string value(const CIMValue& cimValue) const;
  std::string instance(const CIMConstInstance& object) const;
  std::string object(const CIMObject& object) const;
};

std::string realText(double number, bool single) {
  if (!std::isfinite(number)) return "NULL";
  char buffer[64];
  const auto end = single
                       ? std::to_chars(buffer, buffer + sizeof buffer, static_cast<float>(number))
                       : std::to_chars(buffer, buffer + sizeof buffer, number);
  std::string text(buffer, end.ptr);
  // MOF wants a decimal point and a digit behind it, also before an exponent.
  if (text.find('.') == std::string::npos) {
    text.insert(std::min(text.find('e'), text.size()), ".0");
  }
  return text;
}

struct ElementText {
  const MofFormatter& formatter;

  template <class T>
  std::string operator()(const T& element) const {
    if constexpr (std::is_same_v<T, Boolean>) {
      return element ? "TRUE" : "FALSE";
    } else if constexpr (std::is_floating_point_v<T>) {
      return realText(element, std::is_same_v<T, Real32>);
    } else if constexpr (kIsNumber<T>) {
      return std::to_string(element);
    } else {
      return other(element);
    }
  }

  std::string other(const Char16& element) const {
    std::string quoted = mofString(toUtf8(String(&element, 1)));
    quoted.front() = '\'';
    quoted.back() = '\'';
    return quoted;
  }
  std::string other(const String& element) const { return mofString(toUtf8(element)); }
  std::string other(const CIMDateTime& element) const {
    return mofString(toUtf8(element.toString()));
  }
  std::string other(const CIMObjectPath& element) const {
    return mofString(toUtf8(element.toString()));
  }
  std::string other(const CIMObject& element) const { return mofString(formatter.object(element)); }
  std::string other(const CIMInstance& element) const {
    return mofString(formatter.instance(element));
  }
};

template <class T>
std::string elementOrArray(const ElementText& text, const T& element) {
  return text(element);
}

template <class T>
std::string elementOrArray(const ElementText& text, const Array<T>& elements) {
  std::string result = "{";
  for (Uint32 i = 0; i < elements.size(); ++i) {
    if (i > 0) result += ", ";
    result += text(elements[i]);
  }
  return result + "}";
}

std::string MofFormatter::value(const CIMValue& cimValue) const {
  if (cimValue.isNull()) return "NULL";
  const ElementText text{*this};
  return visitCimValue(cimValue, [&text](const auto& any) { return elementOrArray(text, any); });
}

std::string MofFormatter::instance(const CIMConstInstance& object) const {
  if (depth >= kMaximumNesting) return "NULL";
  const MofFormatter inner{depth + 1};
  std::string text = "instance of " + toUtf8(object.getClassName().getString()) + " {\n";
  for (Uint32 i = 0; i < object.getPropertyCount(); ++i) {
    const CIMConstProperty property = object.getProperty(i);
    text += "  " + toUtf8(property.getName().getString()) + " = ";
    text += inner.value(property.getValue()) + ";\n";
  }
  return text + "};\n";
}

std::string MofFormatter::object(const CIMObject& any) const {
  if (any.isUninitialized()) return {};
  return any.isInstance() ? instance(CIMInstance(any)) : mofClass(CIMClass(any));
}

std::string joined(const std::vector<std::string>& words, const std::string& separator) {
  std::string text;
  for (const std::string& word : words) text += (text.empty() ? "" : separator) + word;
  return text;
}

std::string flavorsText(const CIMFlavor& flavor, const std::string& separator) {
  std::vector<std::string> words;
  if (flavor.hasFlavor(CIMFlavor::RESTRICTED)) words.push_back("Restricted");
  if (flavor.hasFlavor(CIMFlavor::DISABLEOVERRIDE)) words.push_back("DisableOverride");
  if (flavor.hasFlavor(CIMFlavor::TRANSLATABLE)) words.push_back("Translatable");
  return joined(words, separator);
}

// Servers' compilers do not know "schema" as a scope, and nothing in MOF files is one.
std::string scopesText(unsigned scope) {
  constexpr std::pair<unsigned, const char*> kScopes[] = {
      {QualifierScope::kClass, "class"},           {QualifierScope::kAssociation, "association"},
      {QualifierScope::kIndication, "indication"}, {QualifierScope::kProperty, "property"},
      {QualifierScope::kReference, "reference"},   {QualifierScope::kMethod, "method"},
      {QualifierScope::kParameter, "parameter"}};
  std::vector<std::string> words;
  if (scope == QualifierScope::kAny) return "any";
  for (const auto& [bit, word] : kScopes) {
    if ((scope & bit) != 0) words.push_back(word);
  }
  return joined(words, ", ");
}

std::string qualifierText(const CIMConstQualifier& qualifier) {
  std::string text = toUtf8(qualifier.getName().getString());
  const CIMValue& value = qualifier.getValue();
  const std::string valueText = mofValue(value);
  if (value.isArray() && !value.isNull()) {
    text += valueText;
  } else if (valueText != "TRUE") {
    text += "(" + valueText + ")";
  }
  const std::string flavors = flavorsText(qualifier.getFlavor(), " ");
  return flavors.empty() ? text : text + " : " + flavors;
}

// Empty without qualifiers.
template <class Element>
std::string qualifierList(const Element& element, const std::string& separator) {
  std::string text;
  for (Uint32 i = 0; i < element.getQualifierCount(); ++i) {
    text += (i == 0 ? "[" : ", ") + qualifierText(element.getQualifier(i));
  }
  return text.empty() ? text : text + "]" + separator;
}

template <class Element>
std::string declarator(const Element& element) {
  std::string type = cimTypeToString(element.getType());
  if (element.getType() == CIMTYPE_REFERENCE) {
    type = toUtf8(element.getReferenceClassName().getString()) + " REF";
  }
  return mofDeclarator(type, toUtf8(element.getName().getString()), element.isArray(),
                       element.getArraySize());
}

std::string propertyText(const CIMConstProperty& property) {
  std::string text;
  const std::string qualifiers = qualifierList(property, "\n");
  if (!qualifiers.empty()) text += "  " + qualifiers;
  text += "  " + declarator(property);
  if (!property.getValue().isNull()) text += " = " + mofValue(property.getValue());
  return text + ";\n";
}

std::string methodText(const CIMConstMethod& method) {
  std::string text;
  const std::string qualifiers = qualifierList(method, "\n");
  if (!qualifiers.empty()) text += "  " + qualifiers;
  text += std::string("  ") + cimTypeToString(method.getType()) + " ";
  text += toUtf8(method.getName().getString()) + "(";
  for (Uint32 i = 0; i < method.getParameterCount(); ++i) {
    const CIMConstParameter parameter = method.getParameter(i);
    text += (i == 0 ? "\n    " : ",\n    ") + qualifierList(parameter, " ") + declarator(parameter);
  }
  return text + ");\n";
}

bool appendShortEscape(std::string& text, char character) {
  constexpr char kCharacters[] = "\b\t\n\f\r\"'\\";
  constexpr char kLetters[] = "btnfr\"'\\";
  for (int i = 0; kCharacters[i] != '\0'; ++i) {
    if (character != kCharacters[i]) continue;
    text += '\\';
    text += kLetters[i];
    return true;
  }
  return false;
}

}  // namespace

std::string mofValue(const CIMValue& value) {
  return MofFormatter{}.value(value);
}

std::string mofString(const std::string& text) {
  std::string result = "\"";
  for (std::size_t position = 0; position < text.size();) {
    const std::size_t start = position;
    const std::int32_t codePoint = nextCodePoint(text, position);
    if (codePoint < 0x80 && appendShortEscape(result, text[start])) continue;
    if (codePoint < 0x20 || (codePoint >= 0x7F && codePoint < 0xA0)) {
      char buffer[16];
      std::snprintf(buffer, sizeof buffer, "\\x%04X", static_cast<unsigned>(codePoint) & 0xFFu);
      result += buffer;
    } else {
      result.append(text, start, position - start);
    }
  }
  return result + "\"";
}

std::string mofInstance(const CIMInstance& instance) {
  return MofFormatter{}.instance(instance);
}

std::string mofClass(const CIMClass& declaration) {
  const CIMConstClass object(declaration);
  std::string text = qualifierList(object, "\n");
  text += "class " + toUtf8(object.getClassName().getString());
  if (!object.getSuperClassName().isNull()) {
    text += " : " + toUtf8(object.getSuperClassName().getString());
  }
  text += " {\n";
  for (Uint32 i = 0; i < object.getPropertyCount(); ++i) {
    text += propertyText(object.getProperty(i));
  }
  for (Uint32 i = 0; i < object.getMethodCount(); ++i) text += methodText(object.getMethod(i));
  return text + "};\n";
}

std::string mofQualifier(const QualifierDeclaration& declaration) {
  const CIMConstQualifier qualifier(declaration.qualifier);
  std::string text = "Qualifier ";
  text += mofDeclarator(toUtf8(qualifier.getName().getString()) + " :",
                        cimTypeToString(qualifier.getType()), qualifier.isArray(), 0);
  if (!qualifier.getValue().isNull()) text += " = " + mofValue(qualifier.getValue());
  text += ", Scope(" + scopesText(declaration.scope) + ")";
  const std::string flavors = flavorsText(qualifier.getFlavor(), ", ");
  if (!flavors.empty()) text += ", Flavor(" + flavors + ")";
  return text + ";\n";
}

std::string mofDeclarator(const std::string& type, const std::string& name, bool isArray,
                          Uint32 arraySize) {
  std::string text = type + " " + name;
  if (isArray) text += "[" + (arraySize > 0 ? std::to_string(arraySize) : "") + "]";
  return text;
}

}  // namespace cimhost
