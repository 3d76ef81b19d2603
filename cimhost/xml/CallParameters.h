#pragma once

#include "cimhost/ValueArgument.h"
#include "cimhost/xml/RequestValues.h"
#include "cimhost/xml/XmlElement.h"

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMPropertyList.h>
#include <Pegasus/Common/Exception.h>

#include <string_view>

namespace cimhost {

/// Runs `read` and makes CIM errors of what does not fit: CIM_ERR_INVALID_PARAMETER, or
/// CIM_ERR_TYPE_MISMATCH where the caller says so, with `what` in front of the reason.
[[noreturn]] void throwParameterError(const std::string& what, Pegasus::CIMStatusCode code);

template <class Read>
auto readParameter(const std::string& what, Read read,
                   Pegasus::CIMStatusCode code = Pegasus::CIM_ERR_INVALID_PARAMETER) {
  try {
    return read();
  } catch (...) {
    throwParameterError(what, code);
  }
}

/// The parameters of an intrinsic operation. Names ignore letter case; one that is null is like one
/// that is absent. What does not fit throws CIM_ERR_INVALID_PARAMETER.
class CallParameters {
 public:
  /// `known`: the names that the operation has, separated by blanks. `call` must outlive this.
  CallParameters(const XmlElement& call, std::string_view known);

  bool boolean(std::string_view name, bool otherwise) const;
  Pegasus::String text(std::string_view name) const;
  Pegasus::CIMName name(std::string_view name) const;  ///< From a text; required.
  Pegasus::CIMName className(std::string_view name) const;
  Pegasus::CIMName requiredClassName(std::string_view name) const;
  Pegasus::CIMObjectPath instanceName(std::string_view name) const;  ///< Required.
  Pegasus::CIMObjectPath objectName(std::string_view name) const;    ///< Or a class; required.
  Pegasus::CIMPropertyList propertyList(std::string_view name) const;
  /// The value element, or nullptr.
  const XmlElement* find(std::string_view name) const;
  const XmlElement& require(std::string_view name, std::string_view element) const;

 private:
  const XmlElement& call_;
};

}  // namespace cimhost
