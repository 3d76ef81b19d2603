// Values, instances and paths; declarations: XmlDeclarations.cpp.

#include "cimhost/output/XmlText.h"

#include "cimhost/CimTypes.h"
#include "cimhost/output/XmlElements.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace cimhost {

using namespace Pegasus;

namespace {

constexpr int kMaximumNesting = 16;

template <class T>
void appendNumber(XmlBuffer& out, T number) {
  std::array<char, 40> text;
  const auto end = std::to_chars(text.data(), text.data() + text.size(), number).ptr;
  out.append({text.data(), static_cast<std::size_t>(end - text.data())});
}

// DSP0201 wants a decimal point with a digit behind it.
template <class T>
void appendReal(XmlBuffer& out, T number) {
  if (std::isnan(number)) return out.append("NaN");
  if (std::isinf(number)) return out.append(number > 0 ? "INF" : "-INF");
  std::array<char, 40> text;
  const auto end = std::to_chars(text.data(), text.data() + text.size(), number).ptr;
  const std::string_view shortest(text.data(), static_cast<std::size_t>(end - text.data()));
  const std::size_t exponent = std::min(shortest.find('e'), shortest.size());
  out.append(shortest.substr(0, exponent));
  if (shortest.find('.') == std::string_view::npos) out.append(".0");
  out.append(shortest.substr(exponent));
}

void appendInstanceAt(XmlBuffer& out, const CIMConstInstance& instance, int depth);

void appendEmbedded(XmlBuffer& out, const CIMInstance& instance, int depth) {
  if (instance.isUninitialized() || depth >= kMaximumNesting) return;
  XmlBuffer inner;
  appendInstanceAt(inner, instance, depth + 1);
  out.appendText(inner.view());
}

void appendEmbedded(XmlBuffer& out, const CIMObject& object, int depth) {
  if (object.isUninitialized()) return;
  if (object.isInstance()) return appendEmbedded(out, CIMInstance(object), depth);
  XmlBuffer inner;
  appendClass(inner, CIMClass(object));
  out.appendText(inner.view());
}

template <class T>
void appendScalar(XmlBuffer& out, const T& element, int depth) {
  if constexpr (std::is_same_v<T, Boolean>) {
    out.append(element ? "TRUE" : "FALSE");
  } else if constexpr (std::is_integral_v<T>) {
    appendNumber(out, element);
  } else if constexpr (std::is_floating_point_v<T>) {
    appendReal(out, element);
  } else if constexpr (std::is_same_v<T, Char16>) {
    out.appendText(String(&element, 1));
  } else if constexpr (std::is_same_v<T, String>) {
    out.appendText(element);
  } else if constexpr (std::is_same_v<T, CIMDateTime>) {
    out.appendText(element.toString());
  } else if constexpr (std::is_same_v<T, CIMObjectPath>) {
    appendObjectPath(out, element);
  } else {
    appendEmbedded(out, element, depth);
  }
}

template <class T>
void appendElement(XmlBuffer& out, const T& element, int depth) {
  constexpr bool kReference = std::is_same_v<T, CIMObjectPath>;
  out.append(kReference ? "<VALUE.REFERENCE>" : "<VALUE>");
  appendScalar(out, element, depth);
  out.append(kReference ? "</VALUE.REFERENCE>" : "</VALUE>");
}

template <class T>
void appendElement(XmlBuffer& out, const Array<T>& elements, int depth) {
  constexpr bool kReference = std::is_same_v<T, CIMObjectPath>;
  out.append(kReference ? "<VALUE.REFARRAY>" : "<VALUE.ARRAY>");
  for (Uint32 i = 0; i < elements.size(); ++i) appendElement(out, elements[i], depth);
  out.append(kReference ? "</VALUE.REFARRAY>" : "</VALUE.ARRAY>");
}

void appendValueAt(XmlBuffer& out, const CIMValue& value, int depth) {
  if (value.isNull()) return;
  visitCimValue(value, [&](const auto& any) { appendElement(out, any, depth); });
}

void appendPropertyAt(XmlBuffer& out, const CIMConstProperty& property, int depth) {
  const CIMValue& value = property.getValue();
  const bool reference = value.getType() == CIMTYPE_REFERENCE;
  const std::string_view element = reference         ? "PROPERTY.REFERENCE"
                                   : value.isArray() ? "PROPERTY.ARRAY"
                                                     : "PROPERTY";
  out.append("<");
  out.append(element);
  appendNameAttribute(out, property.getName());
  if (reference) {
    appendOptionalAttribute(out, " REFERENCECLASS=\"", property.getReferenceClassName());
  } else {
    appendTypeAttributes(out, "TYPE", value.getType());
  }
  if (property.getArraySize() != 0) appendArraySize(out, property.getArraySize());
  appendOptionalAttribute(out, " CLASSORIGIN=\"", property.getClassOrigin());
  if (property.getPropagated()) out.append(" PROPAGATED=\"true\"");
  out.append(">");
  appendQualifiers(out, property);
  appendValueAt(out, value, depth);
  appendEndTag(out, element);
}

void appendInstanceAt(XmlBuffer& out, const CIMConstInstance& instance, int depth) {
  out.append("<INSTANCE CLASSNAME=\"");
  out.appendText(instance.getClassName().getString());
  out.append("\">");
  appendQualifiers(out, instance);
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    appendPropertyAt(out, instance.getProperty(i), depth);
  }
  out.append("</INSTANCE>");
}

const char* valueTypeOf(CIMKeyBinding::Type type) {
  switch (type) {
    case CIMKeyBinding::BOOLEAN:
      return "boolean";
    case CIMKeyBinding::NUMERIC:
      return "numeric";
    default:
      return "string";
  }
}

// Empty for a text that is no path: the key is then written as the text that it is.
CIMObjectPath referencedPath(const CIMKeyBinding& key) {
  if (key.getType() != CIMKeyBinding::REFERENCE) return CIMObjectPath();
  try {
    return CIMObjectPath(key.getValue());
  } catch (const Exception&) {
    return CIMObjectPath();
  }
}

void appendKey(XmlBuffer& out, const CIMKeyBinding& key) {
  out.append("<KEYBINDING");
  appendNameAttribute(out, key.getName());
  out.append(">");
  const CIMObjectPath referenced = referencedPath(key);
  if (!referenced.getClassName().isNull()) {
    appendElement(out, referenced, 0);
  } else {
    out.append("<KEYVALUE VALUETYPE=\"");
    out.append(valueTypeOf(key.getType()));
    out.append("\">");
    out.appendText(key.getValue());
    out.append("</KEYVALUE>");
  }
  out.append("</KEYBINDING>");
}

void appendLocalNamespacePath(XmlBuffer& out, const CIMNamespaceName& nameSpace) {
  const String& text = nameSpace.getString();
  out.append("<LOCALNAMESPACEPATH>");
  for (Uint32 start = 0; start <= text.size();) {
    const Uint32 slash = std::min(text.find(start, Char16('/')), text.size());
    out.append("<NAMESPACE NAME=\"");
    out.appendText(text.subString(start, slash - start));
    out.append("\"/>");
    start = slash + 1;
  }
  out.append("</LOCALNAMESPACEPATH>");
}

void appendNamespacePath(XmlBuffer& out, const CIMObjectPath& path) {
  out.append("<NAMESPACEPATH><HOST>");
  out.appendText(path.getHost());
  out.append("</HOST>");
  appendLocalNamespacePath(out, path.getNameSpace());
  out.append("</NAMESPACEPATH>");
}

void appendName(XmlBuffer& out, const CIMObjectPath& path, bool isClass) {
  if (isClass) {
    appendClassName(out, path.getClassName());
  } else {
    appendInstanceName(out, path);
  }
}

}  // namespace

void appendValue(XmlBuffer& out, const CIMValue& value) {
  appendValueAt(out, value, 0);
}

void appendTypeAttributes(XmlBuffer& out, std::string_view attribute, CIMType type) {
  const bool embedded = type == CIMTYPE_INSTANCE || type == CIMTYPE_OBJECT;
  out.append(" ");
  out.append(attribute);
  out.append("=\"");
  out.append(embedded ? "string" : cimTypeToString(type));
  out.append("\"");
  if (!embedded) return;
  out.append(type == CIMTYPE_INSTANCE ? " EmbeddedObject=\"instance\""
                                      : " EmbeddedObject=\"object\"");
}

void appendArraySize(XmlBuffer& out, Uint32 size) {
  out.append(" ARRAYSIZE=\"");
  appendNumber(out, size);
  out.append("\"");
}

void appendProperty(XmlBuffer& out, const CIMConstProperty& property) {
  appendPropertyAt(out, property, 0);
}

void appendInstance(XmlBuffer& out, const CIMConstInstance& instance) {
  appendInstanceAt(out, instance, 0);
}

void appendInstanceName(XmlBuffer& out, const CIMObjectPath& path) {
  out.append("<INSTANCENAME CLASSNAME=\"");
  out.appendText(path.getClassName().getString());
  out.append("\">");
  const Array<CIMKeyBinding>& keys = path.getKeyBindings();
  for (Uint32 i = 0; i < keys.size(); ++i) appendKey(out, keys[i]);
  out.append("</INSTANCENAME>");
}

void appendObjectPath(XmlBuffer& out, const CIMObjectPath& path) {
  const bool isClass = path.getKeyBindings().size() == 0;
  if (path.getNameSpace().isNull()) return appendName(out, path, isClass);
  const bool local = path.getHost().size() == 0;
  const std::string_view element = local ? (isClass ? "LOCALCLASSPATH" : "LOCALINSTANCEPATH")
                                         : (isClass ? "CLASSPATH" : "INSTANCEPATH");
  appendStartTag(out, element);
  if (local) {
    appendLocalNamespacePath(out, path.getNameSpace());
  } else {
    appendNamespacePath(out, path);
  }
  appendName(out, path, isClass);
  appendEndTag(out, element);
}

void appendInstancePath(XmlBuffer& out, const CIMObjectPath& path) {
  out.append("<INSTANCEPATH>");
  appendNamespacePath(out, path);
  appendInstanceName(out, path);
  out.append("</INSTANCEPATH>");
}

void appendReturnValue(XmlBuffer& out, const CIMValue& value) {
  if (value.isNull()) return;
  out.append("<RETURNVALUE");
  appendTypeAttributes(out, "PARAMTYPE", value.getType());
  out.append(">");
  appendValue(out, value);
  out.append("</RETURNVALUE>");
}

void appendParamValue(XmlBuffer& out, const CIMParamValue& parameter) {
  const CIMValue value = parameter.getValue();
  out.append("<PARAMVALUE NAME=\"");
  out.appendText(parameter.getParameterName());
  out.append("\"");
  appendTypeAttributes(out, "PARAMTYPE", value.getType());
  out.append(">");
  appendValue(out, value);
  out.append("</PARAMVALUE>");
}

}  // namespace cimhost
