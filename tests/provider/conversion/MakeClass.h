#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <cctype>
#include <initializer_list>

#include "CimText.h"

/// Which qualifier "Key" a property has.
enum class Key { kNo, kYes, kUnqualified };

inline CIMQualifier flag(const char* name, bool value) {
  return CIMQualifier(CIMName(name), CIMValue(Boolean(value)));
}

/// The class that references of this type refer to.
inline CIMName referredClass(CIMType type) {
  return type == CIMTYPE_REFERENCE ? CIMName("T_Any") : CIMName();
}

/// A null property of a class.
inline CIMProperty declared(const char* name, CIMType type, Key key = Key::kNo,
                            bool isArray = false, Uint32 arraySize = 0) {
  CIMProperty property(CIMName(name), CIMValue(type, isArray, arraySize), arraySize,
                       referredClass(type));
  if (key != Key::kUnqualified) property.addQualifier(flag("Key", key == Key::kYes));
  return property;
}

/// A parameter with a qualifier for each of the `letters`: I and i are In, O and o are Out, true
/// where they are upper-case.
inline CIMParameter parameter(const char* name, CIMType type, const char* letters,
                              bool isArray = false) {
  CIMParameter declaration(CIMName(name), type, isArray, 0, referredClass(type));
  for (; *letters != '\0'; ++letters) {
    declaration.addQualifier(
        flag(std::tolower(*letters) == 'i' ? "In" : "Out", std::isupper(*letters) != 0));
  }
  return declaration;
}

/// A method with a qualifier "Static" of that value.
inline CIMMethod method(const char* name, bool isStatic,
                        std::initializer_list<CIMParameter> parameters = {}) {
  CIMMethod declaration(CIMName(name), CIMTYPE_SINT32);
  declaration.addQualifier(flag("Static", isStatic));
  for (const CIMParameter& each : parameters) declaration.addParameter(each);
  return declaration;
}

inline CIMClass makeClass(const char* name, std::initializer_list<CIMProperty> properties,
                          std::initializer_list<CIMMethod> methods = {}) {
  CIMClass cimClass{CIMName(name)};
  for (const CIMProperty& property : properties) cimClass.addProperty(property);
  for (const CIMMethod& each : methods) cimClass.addMethod(each);
  return cimClass;
}
