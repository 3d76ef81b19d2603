#include "cimhost/OperationStatus.h"

#include "cimhost/Text.h"

namespace cimhost {

using Pegasus::CIM_ERR_FAILED;
using Pegasus::CIM_ERR_SUCCESS;

std::string OperationStatus::name() const {
  const std::string text = Pegasus::cimStatusCodeToString(code);
  return text.empty() ? std::to_string(static_cast<int>(code)) : text;
}

std::string OperationStatus::toString() const {
  std::string text = name() + " (" + std::to_string(static_cast<int>(code)) + ")";
  if (!message.empty()) text += ": " + message;
  return text;
}

OperationStatus currentExceptionStatus() noexcept {
  try {
    try {
      throw;
    } catch (const Pegasus::CIMException& error) {
      const bool noCode = error.getCode() == CIM_ERR_SUCCESS;
      return {noCode ? CIM_ERR_FAILED : error.getCode(), toUtf8(error.getMessage())};
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
