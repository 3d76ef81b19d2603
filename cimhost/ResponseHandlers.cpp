#include "cimhost/ResponseHandlers.h"

namespace cimhost {

using Pegasus::CIM_ERR_FAILED;
using Pegasus::CIMException;

void SingleInstanceHandler::complete() {
  if (instance_.isUninitialized()) {
    throw CIMException(CIM_ERR_FAILED, "Too few objects delivered.");
  }
  completed_ = true;
}

void SingleInstanceHandler::deliver(const Pegasus::CIMInstance& instance) {
  if (!instance_.isUninitialized()) {
    throw CIMException(CIM_ERR_FAILED, "Too many objects delivered.");
  }
  if (instance.isUninitialized()) throw Pegasus::UninitializedObjectException();
  instance_ = instance;
}

void SingleInstanceHandler::deliver(const Pegasus::Array<Pegasus::CIMInstance>& instances) {
  for (Pegasus::Uint32 i = 0; i < instances.size(); ++i) deliver(instances[i]);
}

const Pegasus::CIMInstance& SingleInstanceHandler::result() const {
  if (!completed_) {
    throw CIMException(CIM_ERR_FAILED, "The provider did not complete the operation.");
  }
  return instance_;
}

}  // namespace cimhost
