// Qualifier flavors (DSP0004, 5.6.1.2) as a set of bits.
#pragma once

#include <Pegasus/Common/Config.h>
#include <Pegasus/Common/String.h>

PEGASUS_NAMESPACE_BEGIN

/// The set of flavors of one qualifier. A plain value.
class PEGASUS_COMMON_LINKAGE CIMFlavor {
 public:
  static const CIMFlavor NONE;
  static const CIMFlavor OVERRIDABLE;
  static const CIMFlavor ENABLEOVERRIDE;  ///< the same as OVERRIDABLE
  static const CIMFlavor TOSUBCLASS;
  static const CIMFlavor TOSUBELEMENTS;  ///< the same as TOSUBCLASS
  static const CIMFlavor TOINSTANCE;
  static const CIMFlavor TRANSLATABLE;
  static const CIMFlavor DISABLEOVERRIDE;
  static const CIMFlavor RESTRICTED;
  static const CIMFlavor DEFAULTS;  ///< OVERRIDABLE and TOSUBCLASS

  constexpr CIMFlavor() noexcept = default;

  void addFlavor(const CIMFlavor& flavor);
  void removeFlavor(const CIMFlavor& flavor);
  /// True when every flavor of `flavor` is set here.
  Boolean hasFlavor(const CIMFlavor& flavor) const;
  Boolean equal(const CIMFlavor& flavor) const;
  CIMFlavor operator+(const CIMFlavor& flavor) const;
  /// The names of the flavors that are set, each followed by a blank.
  String toString() const;

 private:
  explicit constexpr CIMFlavor(Uint32 bits) noexcept : bits_(bits) {}

  Uint32 bits_ = 0;
};

PEGASUS_NAMESPACE_END
