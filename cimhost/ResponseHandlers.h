#pragma once

#include "cimhost/DeliveryBuffer.h"

#include <Pegasus/Common/Exception.h>
#include <Pegasus/Common/ResponseHandler.h>

namespace cimhost {

/// The handler that an enumerating operation gives to a provider: `Base` is InstanceResponseHandler
/// or ObjectPathResponseHandler, `Object` what it takes. Lives for one provider call.
template <class Base, class Object>
class BufferingHandler final : public Base {
 public:
  explicit BufferingHandler(DeliveryBuffer<Object>& buffer) : buffer_(buffer) {}

  void processing() override {}
  void complete() override { buffer_.complete(); }

  // An uninitialized object throws UninitializedObjectException into the provider.
  void deliver(const Object& object) override {
    requireInitialized(object);
    buffer_.deliver(object);
  }

  void deliver(const Pegasus::Array<Object>& objects) override {
    for (Pegasus::Uint32 i = 0; i < objects.size(); ++i) deliver(objects[i]);
  }

 private:
  static void requireInitialized(const Pegasus::CIMObjectPath&) {}
  template <class Handle>
  static void requireInitialized(const Handle& object) {
    if (object.isUninitialized()) throw Pegasus::UninitializedObjectException();
  }

  DeliveryBuffer<Object>& buffer_;
};

using EnumeratedInstances =
    BufferingHandler<Pegasus::InstanceResponseHandler, Pegasus::CIMInstance>;
using EnumeratedPaths =
    BufferingHandler<Pegasus::ObjectPathResponseHandler, Pegasus::CIMObjectPath>;

/// The handler of getInstance: exactly one instance. It throws CIM_ERR_FAILED into the provider:
/// `Too few objects delivered.` from complete(), `Too many objects delivered.` from a second
/// deliver().
class SingleInstanceHandler final : public Pegasus::InstanceResponseHandler {
 public:
  void processing() override {}
  void complete() override;
  void deliver(const Pegasus::CIMInstance& instance) override;
  void deliver(const Pegasus::Array<Pegasus::CIMInstance>& instances) override;

  /// What was delivered and completed. Throws CIM_ERR_FAILED when the provider did neither.
  const Pegasus::CIMInstance& result() const;

 private:
  Pegasus::CIMInstance instance_;
  bool completed_ = false;
};

}  // namespace cimhost
