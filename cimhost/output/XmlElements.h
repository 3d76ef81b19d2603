#pragma once

#include "cimhost/output/XmlText.h"

namespace cimhost {

// Parts of elements that XmlText is made of.

inline void appendStartTag(XmlBuffer& out, std::string_view element) {
  out.append("<");
  out.append(element);
  out.append(">");
}

inline void appendEndTag(XmlBuffer& out, std::string_view element) {
  out.append("</");
  out.append(element);
  out.append(">");
}

inline void appendNameAttribute(XmlBuffer& out, const Pegasus::CIMName& name) {
  out.append(" NAME=\"");
  out.appendText(name.getString());
  out.append("\"");
}

/// `start` is ` NAME="`. Nothing for a null name.
inline void appendOptionalAttribute(XmlBuffer& out, std::string_view start,
                                    const Pegasus::CIMName& value) {
  if (value.isNull()) return;
  out.append(start);
  out.appendText(value.getString());
  out.append("\"");
}

/// `TYPE` is "PARAMTYPE" or "TYPE": TYPE="uint8", and for objects TYPE="string"
/// EmbeddedObject="instance". With a blank in front.
void appendTypeAttributes(XmlBuffer& out, std::string_view attribute, Pegasus::CIMType type);

void appendArraySize(XmlBuffer& out, Pegasus::Uint32 size);

/// PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE.
void appendProperty(XmlBuffer& out, const Pegasus::CIMConstProperty& property);

/// Key(false), which means the same as no Key: some clients take any Key for a true one.
bool isFalseKey(const Pegasus::CIMConstQualifier& qualifier);

/// The qualifiers of an object or one of its parts, but for Key(false).
template <class Element>
void appendQualifiers(XmlBuffer& out, const Element& element) {
  for (Pegasus::Uint32 i = 0; i < element.getQualifierCount(); ++i) {
    const Pegasus::CIMConstQualifier qualifier = element.getQualifier(i);
    if (!isFalseKey(qualifier)) appendQualifier(out, qualifier);
  }
}

}  // namespace cimhost
