#pragma once

#include "cimhost/ValueArgument.h"
#include "cimhost/xml/XmlElement.h"

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>

#include <string>

namespace cimhost {

// Elements of a request as CIM objects. What does not fit throws ValueArgumentError or
// Pegasus::Exception with the reason; elements that are missing throw HttpError. Texts are kept as
// the client wrote them, key types too.

/// "root/cimv2" of LOCALNAMESPACEPATH, unchecked.
std::string namespaceText(const XmlElement& localNamespacePath);

/// Any of the elements that name a class or an instance, VALUE.REFERENCE included.
Pegasus::CIMObjectPath readObjectPath(const XmlElement& element);

/// The type that an attribute names, in any case; throws request-not-valid for what is none.
Pegasus::CIMType readType(const std::string& name);

/// The type of the values in PROPERTY, PARAMVALUE and the like: `type` or, with the attribute
/// EmbeddedObject, an object or an instance.
Pegasus::CIMType embeddedType(const XmlElement& holder, Pegasus::CIMType type);

/// VALUE, VALUE.ARRAY, VALUE.REFERENCE or VALUE.REFARRAY as a value of the declared type; nullptr
/// is null. Embedded instances may hold others, to a depth of 8.
Pegasus::CIMValue readValue(const DeclaredType& declared, const XmlElement* value);

/// INSTANCE. Its path is the class's.
Pegasus::CIMInstance readInstance(const XmlElement& instance);

}  // namespace cimhost
