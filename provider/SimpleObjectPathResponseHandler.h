#pragma once

#include <Pegasus/Common/ResponseHandler.h>

namespace Vaneth {

/// Collects the delivered object paths, for an operation that needs another one's result.
class SimpleObjectPathResponseHandler : public Pegasus::ObjectPathResponseHandler {
 public:
  void processing() override {}
  void complete() override {}
  void deliver(const Pegasus::CIMObjectPath& object) override { paths.append(object); }
  void deliver(const Pegasus::Array<Pegasus::CIMObjectPath>& objects) override {
    paths.appendArray(objects);
  }

  /// What was delivered, in order.
  Pegasus::Array<Pegasus::CIMObjectPath> paths;
};

}  // namespace Vaneth
