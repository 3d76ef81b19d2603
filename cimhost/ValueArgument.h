#pragma once

#include <Pegasus/Common/CIMValue.h>

#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace cimhost {

/// A value on the command line that cannot be what its name stands for. what() is one line for the
/// user, safe for a terminal, without the program's name.
class ValueArgumentError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// NAME=VALUE, or NAME alone, which is null. UTF-8.
struct ValueArgument {
  std::string name;
  std::optional<std::string> text;
};

/// Splits at the first "="; the name may be anything.
ValueArgument splitValueArgument(const std::string& argument);

/// The type that a property or parameter is declared with.
struct DeclaredType {
  Pegasus::CIMType type = Pegasus::CIMTYPE_STRING;
  bool isArray = false;
  Pegasus::Uint32 arraySize = 0;  ///< 0: any number of elements.

  /// "uint8", "uint8[]", "uint8[3]".
  std::string toString() const;
};

/// The value that `texts`, all given for one name, have as the declared type.
///
/// A single missing text is null. A scalar takes the one text as it is: an integer in decimal or
/// hexadecimal (0x), a real in decimal, true or false, one character, a datetime of 25 characters
/// (DSP0004, 5.2.4), an object path. An array takes several texts, each with its elements separated
/// by commas; `\,`, `\\` and `\[` stand for a comma, a backslash and a bracket; `[]` is no element.
/// Throws ValueArgumentError with the reason alone.
Pegasus::CIMValue parseValue(const DeclaredType& declared,
                             const std::vector<std::optional<std::string>>& texts);

/// The same where every element stands alone: one text for a scalar, any number for an array. Texts
/// are taken as they are, without the list syntax of an argument.
Pegasus::CIMValue parseElements(const DeclaredType& declared,
                                const std::vector<std::string>& texts);

}  // namespace cimhost
