#pragma once

#include <Pegasus/Common/Exception.h>

#include <exception>
#include <string>

namespace cimhost {

/// How a CIM operation ended: a status code of DSP0200 and the description a client gets with it.
struct OperationStatus {
  Pegasus::CIMStatusCode code = Pegasus::CIM_ERR_SUCCESS;
  std::string message;  ///< UTF-8, without the code's name; may be empty.

  bool ok() const { return code == Pegasus::CIM_ERR_SUCCESS; }
  /// "CIM_ERR_NOT_FOUND"; the bare number for a code without a name.
  std::string name() const;
  /// "CIM_ERR_NOT_FOUND (6): message".
  std::string toString() const;
};

/// The status of the exception that is being handled; call it in a catch block only.
///
/// CIMException: its code and message (code 0 becomes CIM_ERR_FAILED). Any other Pegasus::Exception
/// or std::exception: CIM_ERR_FAILED and its message. Anything else: CIM_ERR_FAILED, "Unknown
/// error."
OperationStatus currentExceptionStatus() noexcept;

/// Runs `body` and turns what leaves it into a status. Nothing of the exception object survives.
template <class Body>
OperationStatus runOperation(Body body) {
  try {
    body();
    return {};
  } catch (...) {
    return currentExceptionStatus();
  }
}

}  // namespace cimhost
