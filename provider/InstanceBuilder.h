#pragma once

#include "engine/ProviderDefClass.h"

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>

namespace Vaneth {

/// Builds one instance of a defined class.
///
/// `cimClass` is a freshly fetched class: the values are set on its properties, whose declared
/// types and qualifiers decide the conversion. The instance has the properties that both the class
/// and the definition have, and a path of `classPath`'s namespace and class with a key binding for
/// each property whose "key" qualifier is true.
///
/// Throws ProviderDefError, and Pegasus::Exception for a value that does not fit the declared type
/// or a defined property without a "key" qualifier.
Pegasus::CIMInstance buildInstance(const ProviderDefClass& definition, Pegasus::CIMClass& cimClass,
                                   const Pegasus::CIMObjectPath& classPath, int index);

}  // namespace Vaneth
