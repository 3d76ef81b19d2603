#include "cimhost/ResponseHandlers.h"

namespace cimhost {

using namespace Pegasus;

void MethodResultHandler::complete() {
  completed_ = pending_;
  pending_ = Result();
}

void MethodResultHandler::deliverParamValue(const CIMParamValue& value) {
  requireInitialized(value);
  pending_.parameters.append(value);
}

void MethodResultHandler::deliverParamValue(const Array<CIMParamValue>& values) {
  for (Uint32 i = 0; i < values.size(); ++i) deliverParamValue(values[i]);
}

}  // namespace cimhost
