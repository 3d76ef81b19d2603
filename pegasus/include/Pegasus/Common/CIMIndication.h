// A CIM indication.
#pragma once

#include <Pegasus/Common/CIMInstance.h>

PEGASUS_NAMESPACE_BEGIN

typedef CIMInstance CIMIndication;

PEGASUS_NAMESPACE_END
