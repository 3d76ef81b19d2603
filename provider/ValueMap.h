#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/String.h>

#include <optional>
#include <string>

namespace Vaneth {

// The mapping between numbers and texts that the "ValueMap" and "Values" qualifiers of a class
// property give (DSP0004). `property` names the property that carries them; it may be another one
// than the property that is read or written.
//
// Pegasus::Exception when there is no such property or qualifier, or the second list is too short.

/// The text for `number`: the entry of Values at the position of the first entry of ValueMap that
/// is exactly the number's decimal digits; none when there is no such entry.
std::optional<Pegasus::String> valueMapText(Pegasus::CIMClass& cimClass,
                                            const std::string& property, int number);

/// The number for `text`: the entry of ValueMap, as a decimal number, at the position of the first
/// entry of Values that is exactly the text; none when there is no such entry.
std::optional<int> valueMapNumber(Pegasus::CIMClass& cimClass, const std::string& property,
                                  const Pegasus::String& text);

}  // namespace Vaneth
