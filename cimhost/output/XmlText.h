#pragma once

#include "cimhost/output/XmlBuffer.h"

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/CIMQualifier.h>

namespace cimhost {

// CIM objects as elements of CIM-XML (DSP0201). Elements that hold others have start and end tags
// even when they are empty, and null is the absence of a value element: some clients read nothing
// else. Objects within objects are written to a depth of 16, then left out.

/// VALUE, VALUE.ARRAY, VALUE.REFERENCE or VALUE.REFARRAY; nothing for null.
void appendValue(XmlBuffer& out, const Pegasus::CIMValue& value);

/// INSTANCE, without its path.
void appendInstance(XmlBuffer& out, const Pegasus::CIMConstInstance& instance);

/// INSTANCENAME, without host and namespace.
void appendInstanceName(XmlBuffer& out, const Pegasus::CIMObjectPath& path);

/// INSTANCEPATH or CLASSPATH, as far as host and namespace are known: LOCALINSTANCEPATH,
/// INSTANCENAME, LOCALCLASSPATH, CLASSNAME. Without keys it is the path of a class.
void appendObjectPath(XmlBuffer& out, const Pegasus::CIMObjectPath& path);

/// INSTANCEPATH; the path has a host and a namespace.
void appendInstancePath(XmlBuffer& out, const Pegasus::CIMObjectPath& path);

/// CLASSNAME.
void appendClassName(XmlBuffer& out, const Pegasus::CIMName& name);

/// CLASS, without its path.
void appendClass(XmlBuffer& out, const Pegasus::CIMConstClass& declaration);

/// QUALIFIER.
void appendQualifier(XmlBuffer& out, const Pegasus::CIMConstQualifier& qualifier);

/// QUALIFIER.DECLARATION; `scope` has the bits of QualifierScope.
void appendQualifierDeclaration(XmlBuffer& out, const Pegasus::CIMConstQualifier& declaration,
                                unsigned scope);

/// RETURNVALUE; nothing for null.
void appendReturnValue(XmlBuffer& out, const Pegasus::CIMValue& value);

/// PARAMVALUE, as in a method's result.
void appendParamValue(XmlBuffer& out, const Pegasus::CIMParamValue& parameter);

}  // namespace cimhost
