#pragma once

namespace cimhost {

/// Bits: the elements on which a qualifier may stand (DSP0004, metaElement).
struct QualifierScope {
  static constexpr unsigned kSchema = 1;
  static constexpr unsigned kClass = 2;
  static constexpr unsigned kAssociation = 4;
  static constexpr unsigned kIndication = 8;
  static constexpr unsigned kQualifier = 16;
  static constexpr unsigned kProperty = 32;
  static constexpr unsigned kReference = 64;
  static constexpr unsigned kMethod = 128;
  static constexpr unsigned kParameter = 256;
  static constexpr unsigned kAny = 511;
};

}  // namespace cimhost
