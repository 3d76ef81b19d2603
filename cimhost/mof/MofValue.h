#pragma once

#include "cimhost/mof/MofDeclarations.h"
#include "cimhost/mof/MofSource.h"

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMValue.h>

#include <string>

namespace cimhost {

/// The constants of `initializer`, which stands in `source`, as a value of the declared type.
///
/// `element` gives type, array flag and fixed size; its name and own initializer do not matter.
/// Throws MofError at the constant that does not fit: another kind, out of range, no datetime or
/// object path, null inside an array, another number of elements than the fixed size.
Pegasus::CIMValue makeMofValue(const MofSource& source, const MofInitializer& initializer,
                               const MofElement& element);

/// Null, of the element's type.
Pegasus::CIMValue makeNullValue(const MofElement& element);

Pegasus::CIMName toCimName(const MofName& name);

}  // namespace cimhost
