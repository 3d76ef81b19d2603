#include <Pegasus/Common/CIMName.h>

PEGASUS_NAMESPACE_BEGIN

namespace {

bool startsName(Uint16 unit) {
  return (unit >= 'A' && unit <= 'Z') || (unit >= 'a' && unit <= 'z') || unit == '_' ||
         (unit >= 0x80 && unit <= 0xFFEF);
}

bool isLegalName(const Char16* units, Uint32 size) {
  if (size == 0 || !startsName(units[0])) return false;
  for (Uint32 i = 1; i < size; ++i) {
    const Uint16 unit = units[i];
    if (!startsName(unit) && (unit < '0' || unit > '9')) return false;
  }
  return true;
}

const String& checkedName(const String& name) {
  if (!CIMName::legal(name)) throw InvalidNameException(name);
  return name;
}

String checkedNamespace(const String& name) {
  if (!CIMNamespaceName::legal(name)) throw InvalidNamespaceNameException(name);
  return name.getChar16Data()[0] == '/' ? name.subString(1) : name;
}

}  // namespace

CIMName::CIMName() = default;
CIMName::CIMName(const String& name) : name_(checkedName(name)) {}
CIMName::CIMName(const char* name) : name_(name) {
  checkedName(name_);
}

CIMName& CIMName::operator=(const String& name) {
  name_ = checkedName(name);
  return *this;
}

const String& CIMName::getString() const {
  return name_;
}
Boolean CIMName::isNull() const {
  return name_.size() == 0;
}
void CIMName::clear() {
  name_.clear();
}
Boolean CIMName::equal(const CIMName& name) const {
  return String::equalNoCase(name_, name.name_);
}

Boolean CIMName::legal(const String& name) {
  return isLegalName(name.getChar16Data(), name.size());
}

bool operator==(const CIMName& name1, const CIMName& name2) {
  return name1.equal(name2);
}
bool operator!=(const CIMName& name1, const CIMName& name2) {
  return !name1.equal(name2);
}

CIMNamespaceName::CIMNamespaceName() = default;
CIMNamespaceName::CIMNamespaceName(const String& name) : name_(checkedNamespace(name)) {}
CIMNamespaceName::CIMNamespaceName(const char* name) : CIMNamespaceName(String(name)) {}

CIMNamespaceName& CIMNamespaceName::operator=(const String& name) {
  name_ = checkedNamespace(name);
  return *this;
}

const String& CIMNamespaceName::getString() const {
  return name_;
}
Boolean CIMNamespaceName::isNull() const {
  return name_.size() == 0;
}
void CIMNamespaceName::clear() {
  name_.clear();
}
Boolean CIMNamespaceName::equal(const CIMNamespaceName& name) const {
  return String::equalNoCase(name_, name.name_);
}

Boolean CIMNamespaceName::legal(const String& name) {
  const Char16* const units = name.getChar16Data();
  Uint32 start = units[0] == '/' ? 1 : 0;
  for (Uint32 i = start; i < name.size(); ++i) {
    if (units[i] != '/') continue;
    if (!isLegalName(units + start, i - start)) return false;
    start = i + 1;
  }
  return isLegalName(units + start, name.size() - start);
}

bool operator==(const CIMNamespaceName& name1, const CIMNamespaceName& name2) {
  return name1.equal(name2);
}

bool operator!=(const CIMNamespaceName& name1, const CIMNamespaceName& name2) {
  return !name1.equal(name2);
}

PEGASUS_NAMESPACE_END
