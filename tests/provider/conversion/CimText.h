#pragma once

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Common/String.h>

#include <string>

using namespace Pegasus;  // of which nearly every line of these tests speaks

// CIM values and objects as short texts, for comparisons.

inline std::string textOf(const String& text) {
  return static_cast<const char*>(text.getCString());
}

inline std::string textOf(const CIMObjectPath& path) {
  return textOf(path.toString());
}

/// "uint8 5", "string[] a b ", "string null".
inline std::string textOf(const CIMValue& value) {
  return std::string(cimTypeToString(value.getType())) + (value.isArray() ? "[] " : " ") +
         (value.isNull() ? "null" : textOf(value.toString()));
}

/// `root/t:T_Item.Name="a" {Name=string a, Size=uint8 5}`.
inline std::string textOf(const CIMInstance& instance) {
  std::string text = textOf(instance.getPath()) + " {";
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    const CIMConstProperty property = instance.getProperty(i);
    text += (i == 0 ? "" : ", ") + textOf(property.getName().getString()) + "=" +
            textOf(property.getValue());
  }
  return text + "}";
}
