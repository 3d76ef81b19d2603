#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <initializer_list>

/// Which qualifier "Key" a property has.
enum class Key { kNo, kYes, kUnqualified };

/// A null property of a class.
inline Pegasus::CIMProperty declared(const char* name, Pegasus::CIMType type, Key key = Key::kNo,
                                     bool isArray = false, Pegasus::Uint32 arraySize = 0) {
  Pegasus::CIMProperty property(
      Pegasus::CIMName(name), Pegasus::CIMValue(type, isArray, arraySize), arraySize,
      type == Pegasus::CIMTYPE_REFERENCE ? Pegasus::CIMName("T_Any") : Pegasus::CIMName());
  if (key != Key::kUnqualified) {
    property.addQualifier(
        Pegasus::CIMQualifier(Pegasus::CIMName("Key"), Pegasus::CIMValue(key == Key::kYes)));
  }
  return property;
}

inline Pegasus::CIMClass makeClass(const char* name,
                                   std::initializer_list<Pegasus::CIMProperty> properties) {
  Pegasus::CIMClass cimClass{Pegasus::CIMName(name)};
  for (const Pegasus::CIMProperty& property : properties) cimClass.addProperty(property);
  return cimClass;
}
