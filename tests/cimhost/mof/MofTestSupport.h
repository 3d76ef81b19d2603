#pragma once

#include "cimhost/mof/MofReader.h"
#include "tests/support/TemporaryTree.h"

#include <gtest/gtest.h>

#include <string>

namespace cimhost_test {

inline const Pegasus::CIMNamespaceName kNamespace("root/test");

inline std::string text(const Pegasus::String& s) {
  return {(const char*)s.getCString()};
}

/// The qualifiers as "[Key=TRUE Description^=abc]"; ^ marks propagated ones, "null" null values.
template <class Element>
std::string qualifiersText(const Element& element) {
  std::string result;
  for (Pegasus::Uint32 i = 0; i < element.getQualifierCount(); ++i) {
    const Pegasus::CIMConstQualifier qualifier = element.getQualifier(i);
    result += (i == 0 ? "[" : " ") + text(qualifier.getName().getString());
    result += qualifier.getPropagated() != 0 ? "^=" : "=";
    result += qualifier.getValue().isNull() ? "null" : text(qualifier.getValue().toString());
  }
  return result.empty() ? "" : result + "] ";
}

template <class Element>
std::string typeText(const Element& element) {
  std::string result = Pegasus::cimTypeToString(element.getType());
  const Pegasus::CIMName& target = element.getReferenceClassName();
  if (!target.isNull()) result += " to " + text(target.getString());
  if (!element.isArray()) return result;
  return result + '[' + (element.getArraySize() ? std::to_string(element.getArraySize()) : "") +
         ']';
}

template <class Feature>
std::string originText(const Feature& feature) {
  return " (" + text(feature.getClassOrigin().getString()) + (feature.getPropagated() ? "^)" : ")");
}

/// One line: "[qualifiers] type name = value (origin)", after the origin ^ when propagated.
inline std::string propertyText(const Pegasus::CIMConstProperty& property) {
  const Pegasus::CIMValue& value = property.getValue();
  return qualifiersText(property) + typeText(property) + ' ' +
         text(property.getName().getString()) +
         (value.isNull() ? "" : " = " + text(value.toString())) + originText(property);
}

/// "[qualifiers] type name([qualifiers] type name, ...) (origin)".
inline std::string methodText(const Pegasus::CIMConstMethod& method) {
  std::string result = qualifiersText(method) + Pegasus::cimTypeToString(method.getType()) + ' ' +
                       text(method.getName().getString()) + '(';
  for (Pegasus::Uint32 i = 0; i < method.getParameterCount(); ++i) {
    const Pegasus::CIMConstParameter parameter = method.getParameter(i);
    result += (i == 0 ? "" : ", ") + qualifiersText(parameter) + typeText(parameter) + ' ' +
              text(parameter.getName().getString());
  }
  return result + ')' + originText(method);
}

/// A line for the class, then one for each property and method.
inline std::string classText(const Pegasus::CIMConstClass& c) {
  std::string result = qualifiersText(c) + text(c.getClassName().getString());
  if (!c.getSuperClassName().isNull()) result += " : " + text(c.getSuperClassName().getString());
  result += '\n';
  for (Pegasus::Uint32 i = 0; i < c.getPropertyCount(); ++i) {
    result += propertyText(c.getProperty(i)) + '\n';
  }
  for (Pegasus::Uint32 i = 0; i < c.getMethodCount(); ++i) {
    result += methodText(c.getMethod(i)) + '\n';
  }
  return result;
}

/// A repository and a reader that fills it.
struct Mof {
  cimhost::ClassRepository repository;
  cimhost::MofReader reader{repository};

  bool read(const std::string& mof) { return reader.readText(mof, "t.mof", kNamespace); }

  /// All diagnostics, each ended by a newline.
  std::string diagnostics() const {
    std::string result;
    for (const auto& diagnostic : reader.diagnostics()) result += diagnostic.toString() + '\n';
    return result;
  }

  /// The first line of the first diagnostic, without "error: ".
  std::string firstLine() const {
    std::string all = diagnostics();
    all = all.substr(0, all.find('\n'));
    const std::size_t word = all.find("error: ");
    return word == std::string::npos ? all : all.erase(word, 7);
  }

  Pegasus::CIMClass get(const char* name, const Pegasus::CIMNamespaceName& ns = kNamespace) const {
    return repository.getClass(ns, name, false, true, true, Pegasus::CIMPropertyList());
  }

  /// The class as classText() writes it, or the diagnostics when there are any.
  std::string classAsText(const char* name) const {
    const std::string problems = diagnostics();
    return problems.empty() ? classText(get(name)) : problems;
  }
};

/// A file below the folder that a TemporaryTree makes the current one.
inline void write(const std::string& file, const std::string& text) {
  TemporaryTree::write(file, text);
}

}  // namespace cimhost_test
