#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <cctype>
#include <initializer_list>

/// Which qualifier "Key" a property has.
enum class Key { kNo, kYes, kUnqualified };

inline Pegasus::CIMQualifier flag(const char* name, bool value) {
  return Pegasus::CIMQualifier(Pegasus::CIMName(name), Pegasus::CIMValue(Pegasus::Boolean(value)));
}

/// The class that references of this type refer to.
inline Pegasus::CIMName referredClass(Pegasus::CIMType type) {
  return type == Pegasus::CIMTYPE_REFERENCE ? Pegasus::CIMName("T_Any") : Pegasus::CIMName();
}

/// A null property of a class.
inline Pegasus::CIMProperty declared(const char* name, Pegasus::CIMType type, Key key = Key::kNo,
                                     bool isArray = false, Pegasus::Uint32 arraySize = 0) {
  Pegasus::CIMProperty property(Pegasus::CIMName(name), Pegasus::CIMValue(type, isArray, arraySize),
                                arraySize, referredClass(type));
  if (key != Key::kUnqualified) property.addQualifier(flag("Key", key == Key::kYes));
  return property;
}

/// A parameter with a qualifier for each of the `letters`: I and i are In, O and o are Out, true
/// where they are upper-case.
inline Pegasus::CIMParameter parameter(const char* name, Pegasus::CIMType type, const char* letters,
                                       bool isArray = false) {
  Pegasus::CIMParameter declaration(Pegasus::CIMName(name), type, isArray, 0, referredClass(type));
  for (; *letters != '\0'; ++letters) {
    declaration.addQualifier(
        flag(std::tolower(*letters) == 'i' ? "In" : "Out", std::isupper(*letters) != 0));
  }
  return declaration;
}

/// A method with a qualifier "Static" of that value.
inline Pegasus::CIMMethod method(const char* name, bool isStatic,
                                 std::initializer_list<Pegasus::CIMParameter> parameters = {}) {
  Pegasus::CIMMethod declaration(Pegasus::CIMName(name), Pegasus::CIMTYPE_SINT32);
  declaration.addQualifier(flag("Static", isStatic));
  for (const Pegasus::CIMParameter& each : parameters) declaration.addParameter(each);
  return declaration;
}

inline Pegasus::CIMClass makeClass(const char* name,
                                   std::initializer_list<Pegasus::CIMProperty> properties,
                                   std::initializer_list<Pegasus::CIMMethod> methods = {}) {
  Pegasus::CIMClass cimClass{Pegasus::CIMName(name)};
  for (const Pegasus::CIMProperty& property : properties) cimClass.addProperty(property);
  for (const Pegasus::CIMMethod& each : methods) cimClass.addMethod(each);
  return cimClass;
}
