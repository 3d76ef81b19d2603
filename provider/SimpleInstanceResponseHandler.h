#pragma once

#include <Pegasus/Common/ResponseHandler.h>

namespace Vaneth {

/// Collects the delivered instances, for an operation that needs another one's result.
class SimpleInstanceResponseHandler : public Pegasus::InstanceResponseHandler {
 public:
  void processing() override {}
  void complete() override {}
  void deliver(const Pegasus::CIMInstance& object) override { instances.append(object); }
  void deliver(const Pegasus::Array<Pegasus::CIMInstance>& objects) override {
    instances.appendArray(objects);
  }

  /// What was delivered, in order.
  Pegasus::Array<Pegasus::CIMInstance> instances;
};

}  // namespace Vaneth
