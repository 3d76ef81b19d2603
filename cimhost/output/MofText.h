#pragma once

#include "cimhost/repository/QualifierTable.h"

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMValue.h>

#include <string>

namespace cimhost {

// CIM objects as MOF (DSP0004, Annex A). UTF-8; control characters are escaped.

/// A value initialiser: 5, "text", {1, 2}, NULL. A real that is not finite is NULL, having no form.
std::string mofValue(const Pegasus::CIMValue& value);

/// A quoted string with its escapes; `text` is UTF-8.
std::string mofString(const std::string& text);

/// "instance of X {" ... "};" and a line end.
std::string mofInstance(const Pegasus::CIMInstance& instance);

/// The class declaration with its qualifiers, and a line end.
std::string mofClass(const Pegasus::CIMClass& declaration);

/// The declaration of a qualifier, and a line end.
std::string mofQualifier(const QualifierDeclaration& declaration);

/// A property's or parameter's type and name: "uint8 Flags[3]", "Demo_Disk REF Disk".
std::string mofDeclarator(const std::string& type, const std::string& name, bool isArray,
                          Pegasus::Uint32 arraySize);

}  // namespace cimhost
