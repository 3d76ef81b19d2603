#include <Pegasus/Common/CIMObjectPath.h>

#include "ObjectPathParser.h"

PEGASUS_NAMESPACE_BEGIN

namespace {

bool equalNumbers(const String& x, const String& y) {
  Uint64 xNatural;
  Uint64 yNatural;
  if (parseUnsigned(x, xNatural) && parseUnsigned(y, yNatural)) return xNatural == yNatural;
  Sint64 xSigned;
  Sint64 ySigned;
  return parseSigned(x, xSigned) && parseSigned(y, ySigned) && xSigned == ySigned;
}

bool equalReferences(const String& x, const String& y) {
  ObjectPathParts xPath;
  ObjectPathParts yPath;
  return parseObjectPath(x, xPath) && parseObjectPath(y, yPath) && identicalPaths(xPath, yPath);
}

}  // namespace

CIMKeyBinding::CIMKeyBinding() : type_(STRING) {}

CIMKeyBinding::CIMKeyBinding(const CIMName& name, const String& value, Type type)
    : name_(name), value_(value), type_(type) {}

const CIMName& CIMKeyBinding::getName() const {
  return name_;
}
void CIMKeyBinding::setName(const CIMName& name) {
  name_ = name;
}
const String& CIMKeyBinding::getValue() const {
  return value_;
}
void CIMKeyBinding::setValue(const String& value) {
  value_ = value;
}
CIMKeyBinding::Type CIMKeyBinding::getType() const {
  return type_;
}
void CIMKeyBinding::setType(Type type) {
  type_ = type;
}

bool operator==(const CIMKeyBinding& x, const CIMKeyBinding& y) {
  if (x.getType() != y.getType() || x.getName() != y.getName()) return false;
  if (x.getValue() == y.getValue()) return true;
  switch (x.getType()) {
    case CIMKeyBinding::BOOLEAN:
      return String::equalNoCase(x.getValue(), y.getValue());
    case CIMKeyBinding::NUMERIC:
      return equalNumbers(x.getValue(), y.getValue());
    case CIMKeyBinding::REFERENCE:
      return equalReferences(x.getValue(), y.getValue());
    case CIMKeyBinding::STRING:
      break;
  }
  return false;
}

PEGASUS_NAMESPACE_END
