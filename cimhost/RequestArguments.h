#pragma once

#include "cimhost/Requests.h"
#include "cimhost/ValueArgument.h"

#include <Pegasus/Common/CIMClass.h>

#include <string>
#include <vector>

namespace cimhost {

// What `modify` and `invoke` ask for, with NAME=VALUE texts turned into what the class declares.
// Names ignore letter case and are sent as declared; a name that is given more than once adds
// elements to an array. Both throw ValueArgumentError: a name that is not declared, a value that
// does not fit the declared type.

/// Exactly the given properties; the property list names them, so that no other one changes.
ModifyInstanceRequest makeModifyRequest(const Pegasus::CIMClass& declaration,
                                        const Pegasus::CIMObjectPath& target,
                                        const std::vector<std::string>& arguments);

/// In-parameters in the order of their declaration. One that says [In(false)] cannot be given; one
/// that is left out is not sent.
InvokeMethodRequest makeInvokeRequest(const Pegasus::CIMClass& declaration,
                                      const Pegasus::CIMObjectPath& target,
                                      const std::string& method,
                                      const std::vector<std::string>& arguments);

}  // namespace cimhost
