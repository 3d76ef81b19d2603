#pragma once

#include <Pegasus/Common/CIMType.h>

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace cimhost {

// What the parser found, before any name has been looked up. Offsets are places in the source.

struct MofName {
  std::string text;  ///< UTF-8; a legal CIM name. Empty: not written.
  std::size_t offset = 0;
};

/// One constant. Which of the value fields holds something follows from the kind.
struct MofLiteral {
  enum class Kind { null, boolean, integer, real, character, string, alias };
  Kind kind = Kind::null;
  std::size_t offset = 0;
  bool boolean = false;
  bool negative = false;        ///< integer.
  std::uint64_t magnitude = 0;  ///< integer.
  double real = 0;
  std::uint16_t unit = 0;  ///< character: a UTF-16 code unit.
  std::string text;        ///< string: adjacent literals joined; alias: without the '$'.
};

struct MofInitializer {
  std::size_t offset = 0;
  bool isArray = false;              ///< Written in braces.
  std::vector<MofLiteral> literals;  ///< Exactly one unless isArray.
};

enum class MofFlavor {
  enableOverride,
  disableOverride,
  toSubclass,
  restricted,
  translatable,
  toInstance
};

struct MofQualifier {
  MofName name;
  std::optional<MofInitializer> value;
  std::vector<MofFlavor> flavors;  ///< Without contradictions.
};

/// What properties, parameters, methods and qualifier declarations have in common.
struct MofElement {
  std::vector<MofQualifier> qualifiers;
  Pegasus::CIMType type = Pegasus::CIMTYPE_BOOLEAN;
  MofName referenceClass;  ///< With type reference only.
  MofName name;
  bool isArray = false;
  std::uint32_t arraySize = 0;  ///< 0: variable.
  std::optional<MofInitializer> value;
};

struct MofFeature : MofElement {
  bool isMethod = false;
  std::vector<MofElement> parameters;
};

struct MofClassDeclaration {
  std::vector<MofQualifier> qualifiers;
  MofName name;
  MofName superclass;
  std::vector<MofFeature> features;
};

struct MofQualifierDeclaration {
  MofElement element;
  unsigned scope = 0;  ///< QualifierScope bits.
  std::vector<MofFlavor> flavors;
};

/// A compiler directive; those that concern only the reader of one file are left to it.
struct MofPragma {
  MofName name;
  MofName parameter;  ///< The first one, as written, without quotes; empty text when there is none.
};

using MofDeclaration = std::variant<MofPragma, MofQualifierDeclaration, MofClassDeclaration>;

}  // namespace cimhost
