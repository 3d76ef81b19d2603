#pragma once

#include "cimhost/DeliveryBuffer.h"
#include "cimhost/OperationStatus.h"
#include "cimhost/Text.h"

namespace cimhost {

/// Runs one of the provider calls that answer a request together, and whose results go to `buffer`.
///
/// Not-supported alone counts as an empty answer: the server's own empty answer stands beside each
/// provider's. Any other exception takes back what is still held and leaves as a CIMException.
template <class Object, class Call>
void callProvider(DeliveryBuffer<Object>& buffer, Call call) {
  const OperationStatus status = runOperation(call);
  if (status.code == Pegasus::CIM_ERR_NOT_SUPPORTED) {
    buffer.abandonCall();
    return;
  }
  if (!status.ok()) {
    buffer.discard();
    throw Pegasus::CIMException(status.code, fromUtf8(status.message));
  }
  buffer.endCall();
}

}  // namespace cimhost
