#pragma once

#include "engine/ProviderDefValue.h"

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/CIMValue.h>

#include <string>
#include <vector>

namespace Vaneth {

/// Turns a definition value into a CIM value of the declared type.
///
/// Numbers come from the integer field (64-bit integers from the long field of a long, arrays from
/// the integer array), cut to the type's width; reals are whole numbers. Texts come from the string
/// field, datetimes and references are parsed from them: Pegasus::Exception for a text that is
/// none, or is not UTF-8.
Pegasus::CIMValue toCimValue(const ProviderDefValue& value, Pegasus::CIMType type, bool isArray);

/// Turns a CIM value into a definition value, read as the type given.
///
/// Booleans are 1 or 0, 64-bit integers keep their low 32 bits, reals are truncated towards zero
/// and saturate at the range of int (NaN is 0); datetimes and references give their text form. A
/// null value reads as 0 or "". TypeMismatchException when the value is of another type.
ProviderDefValue fromCimValue(const Pegasus::CIMValue& value, Pegasus::CIMType type, bool isArray);

/// The key binding type of a property's CIM type.
Pegasus::CIMKeyBinding::Type keyBindingType(Pegasus::CIMType type);

/// Reads a property by its declared type.
ProviderDefValue getPropertyValue(Pegasus::CIMProperty property);

/// Reads the named properties of an instance: one value for each name, in the order of the names;
/// the empty value for a property that the instance does not have.
std::vector<ProviderDefValue> getPropertyValues(Pegasus::CIMInstance& instance,
                                                const std::vector<std::string>& names);

}  // namespace Vaneth
