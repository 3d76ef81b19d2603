#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <cstring>

// What somebody who writes a provider for one class by hand needs: the calls of a plug-in, and a
// value set on the class's own property, as the library does it.
namespace bench {

/// A plug-in function that writes to a buffer of 1024 bytes.
using Writer = int (*)(void* out, int index);

inline Pegasus::String readText(Writer function, int index) {
  char buffer[1024];
  function(buffer, index);
  return Pegasus::String(buffer);
}

inline Pegasus::Array<Pegasus::String> readTexts(Writer function, int index) {
  char buffer[1024];
  function(buffer, index);
  Pegasus::Array<Pegasus::String> result;
  int count;
  std::memcpy(&count, buffer + 4, 4);
  const char* item = buffer + 8;
  for (int i = 0; i < count; ++i) {
    result.append(Pegasus::String(item + 8));
    item += 33 + std::strlen(item + 8);
  }
  return result;
}

/// Gives `instance` a property of the class, and `keys` its binding when it is a key.
inline void setProperty(Pegasus::CIMClass& cimClass, Pegasus::CIMInstance& instance,
                        Pegasus::Array<Pegasus::CIMKeyBinding>& keys, const char* name,
                        const Pegasus::CIMValue& value) {
  using namespace Pegasus;
  CIMProperty property = cimClass.getProperty(cimClass.findProperty(CIMName(name)));
  property.setValue(value);
  Boolean key = false;
  property.getQualifier(property.findQualifier(CIMName("key"))).getValue().get(key);
  if (key) keys.append(CIMKeyBinding(property.getName(), property.getValue()));
  instance.addProperty(CIMProperty(property.getName(), property.getValue()));
}

}  // namespace bench
