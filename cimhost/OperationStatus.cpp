#include "cimhost/OperationStatus.h"

#include <string_view>

#include "cimhost/Text.h"

namespace cimhost {

using Pegasus::CIM_ERR_FAILED;
using Pegasus::CIM_ERR_SUCCESS;

std::string OperationStatus::name() const {
  return Pegasus::cimStatusCodeToString(code);
}

std::string OperationStatus::toString() const {
  std::string text = name() + " (" + std::to_string(static_cast<int>(code)) + ")";
  if (!message.empty()) text += ": " + message;
  return text;
}

namespace {

// A provider may throw any number; what a client gets, and an exit code, needs one of the standard.
Pegasus::CIMStatusCode failureCode(Pegasus::CIMStatusCode thrown) {
  // Codes without a name have a text in place of one.
  const bool known =
      thrown != CIM_ERR_SUCCESS &&
      std::string_view(Pegasus::cimStatusCodeToString(thrown)).substr(0, 4) == "CIM_";
  return known ? thrown : CIM_ERR_FAILED;
}

}  // namespace

OperationStatus currentExceptionStatus() noexcept {
  try {
    try {
      throw;
    } catch (const Pegasus::CIMException& error) {
      return {failureCode(error.getCode()), toUtf8(error.getMessage())};
    } catch (const Pegasus::Exception& error) {
      return {CIM_ERR_FAILED, toUtf8(error.getMessage())};
    } catch (const std::exception& error) {
      return {CIM_ERR_FAILED, toValidUtf8(error.what())};
    } catch (...) {
      return {CIM_ERR_FAILED, "Unknown error."};
    }
  } catch (...) {
    return {CIM_ERR_FAILED, {}};  // No memory for the message.
  }
}

}  // namespace cimhost
