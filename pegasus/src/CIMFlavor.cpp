#include <Pegasus/Common/CIMFlavor.h>

PEGASUS_NAMESPACE_BEGIN

// Constant-initialized: other files' static objects may use them.
const CIMFlavor CIMFlavor::NONE(0);
const CIMFlavor CIMFlavor::OVERRIDABLE(1);
const CIMFlavor CIMFlavor::ENABLEOVERRIDE(1);
const CIMFlavor CIMFlavor::TOSUBCLASS(2);
const CIMFlavor CIMFlavor::TOSUBELEMENTS(2);
const CIMFlavor CIMFlavor::TOINSTANCE(4);
const CIMFlavor CIMFlavor::TRANSLATABLE(8);
const CIMFlavor CIMFlavor::DISABLEOVERRIDE(16);
const CIMFlavor CIMFlavor::RESTRICTED(32);
const CIMFlavor CIMFlavor::DEFAULTS(1 | 2);

void CIMFlavor::addFlavor(const CIMFlavor& flavor) {
  bits_ |= flavor.bits_;
}

void CIMFlavor::removeFlavor(const CIMFlavor& flavor) {
  bits_ &= ~flavor.bits_;
}

Boolean CIMFlavor::hasFlavor(const CIMFlavor& flavor) const {
  return (bits_ & flavor.bits_) == flavor.bits_;
}

Boolean CIMFlavor::equal(const CIMFlavor& flavor) const {
  return bits_ == flavor.bits_;
}

CIMFlavor CIMFlavor::operator+(const CIMFlavor& flavor) const {
  return CIMFlavor(bits_ | flavor.bits_);
}

String CIMFlavor::toString() const {
  static constexpr const char* kNames[] = {"OVERRIDABLE",  "TOSUBCLASS",      "TOINSTANCE",
                                           "TRANSLATABLE", "DISABLEOVERRIDE", "RESTRICTED"};
  String out;
  Uint32 bit = 1;
  for (const char* name : kNames) {
    if (bits_ & bit) {
      if (out.size() > 0) out.append(Char16(' '));
      out.append(String(name));
    }
    bit <<= 1;
  }
  return out;
}

PEGASUS_NAMESPACE_END
