#include <Pegasus/Common/CIMPropertyList.h>

PEGASUS_NAMESPACE_BEGIN

CIMPropertyList::CIMPropertyList() = default;

CIMPropertyList::CIMPropertyList(const Array<CIMName>& propertyNames) {
  set(propertyNames);
}

void CIMPropertyList::set(const Array<CIMName>& propertyNames) {
  for (Uint32 i = 0; i < propertyNames.size(); ++i) {
    if (propertyNames[i].isNull()) throw UninitializedObjectException();
  }
  names_ = propertyNames;
  isNull_ = false;
}

void CIMPropertyList::clear() {
  names_.clear();
  isNull_ = true;
}

Boolean CIMPropertyList::isNull() const {
  return isNull_;
}

Uint32 CIMPropertyList::size() const {
  return names_.size();
}

const CIMName& CIMPropertyList::operator[](Uint32 index) const {
  return names_[index];
}

Array<CIMName> CIMPropertyList::getPropertyNameArray() const {
  return names_;
}

Boolean CIMPropertyList::contains(const CIMName& name) const {
  for (Uint32 i = 0; i < names_.size(); ++i) {
    if (names_[i].equal(name)) return true;
  }
  return false;
}

Boolean CIMPropertyList::useThisProperty(const CIMName& name) const {
  return isNull_ || contains(name);
}

String CIMPropertyList::toString() const {
  if (isNull_) return String("NULL");
  if (names_.size() == 0) return String("EMPTY");
  String out;
  for (Uint32 i = 0; i < names_.size(); ++i) {
    if (i > 0) out.append(String(", "));
    out.append(names_[i].getString());
  }
  return out;
}

PEGASUS_NAMESPACE_END
