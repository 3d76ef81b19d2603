#pragma once

#include "cimhost/DeliveryBuffer.h"

#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/Exception.h>
#include <Pegasus/Common/ResponseHandler.h>

#include <optional>

namespace cimhost {

// The handlers that operations give to a provider. Each lives for one provider call. Delivering an
// uninitialized object throws UninitializedObjectException into the provider.

inline void requireInitialized(const Pegasus::CIMObjectPath&) {}
template <class Handle>
void requireInitialized(const Handle& object) {
  if (object.isUninitialized()) throw Pegasus::UninitializedObjectException();
}

/// Of the operations with many results: `Base` is the response handler's interface, `Object` what
/// it takes. What the client does not want is dropped.
template <class Base, class Object>
class BufferingHandler final : public Base {
 public:
  using Wants = std::function<bool(const Object&)>;

  explicit BufferingHandler(DeliveryBuffer<Object>& buffer, Wants wants = nullptr)
      : buffer_(buffer), wants_(std::move(wants)) {}

  void processing() override {}
  void complete() override { buffer_.complete(); }

  void deliver(const Object& object) override {
    requireInitialized(object);
    if (wants_ == nullptr || wants_(object)) buffer_.deliver(object);
  }

  void deliver(const Pegasus::Array<Object>& objects) override {
    for (Pegasus::Uint32 i = 0; i < objects.size(); ++i) deliver(objects[i]);
  }

 private:
  DeliveryBuffer<Object>& buffer_;
  Wants wants_;
};

using EnumeratedInstances =
    BufferingHandler<Pegasus::InstanceResponseHandler, Pegasus::CIMInstance>;
using EnumeratedPaths =
    BufferingHandler<Pegasus::ObjectPathResponseHandler, Pegasus::CIMObjectPath>;
using AssociatedObjects = BufferingHandler<Pegasus::ObjectResponseHandler, Pegasus::CIMObject>;

/// Of getInstance and createInstance: exactly one object. It throws CIM_ERR_FAILED into the
/// provider: `Too few objects delivered.` from complete(), `Too many objects delivered.` from a
/// second deliver().
template <class Base, class Object>
class SingleObjectHandler final : public Base {
 public:
  void processing() override {}
  void complete() override {
    if (!object_) fail("Too few objects delivered.");
    completed_ = true;
  }

  void deliver(const Object& object) override {
    if (object_) fail("Too many objects delivered.");
    requireInitialized(object);
    object_ = object;
  }
  void deliver(const Pegasus::Array<Object>& objects) override {
    for (Pegasus::Uint32 i = 0; i < objects.size(); ++i) deliver(objects[i]);
  }

  /// What was delivered and completed. Throws CIM_ERR_FAILED when the provider did neither.
  const Object& result() const {
    if (!completed_) fail("The provider did not complete the operation.");
    return *object_;
  }

 private:
  [[noreturn]] static void fail(const char* message) {
    throw Pegasus::CIMException(Pegasus::CIM_ERR_FAILED, message);
  }

  std::optional<Object> object_;
  bool completed_ = false;
};

using SingleInstance = SingleObjectHandler<Pegasus::InstanceResponseHandler, Pegasus::CIMInstance>;
using SinglePath = SingleObjectHandler<Pegasus::ObjectPathResponseHandler, Pegasus::CIMObjectPath>;

/// Of the operations that deliver nothing. Whether the provider completes makes no difference.
class EmptyHandler final : public Pegasus::ResponseHandler {
 public:
  void processing() override {}
  void complete() override {}
};

/// Of invokeMethod. What is not completed is lost: the return value stays null, and there are no
/// out-parameters.
class MethodResultHandler final : public Pegasus::MethodResultResponseHandler {
 public:
  void processing() override {}
  void complete() override;
  void deliverParamValue(const Pegasus::CIMParamValue& value) override;
  void deliverParamValue(const Pegasus::Array<Pegasus::CIMParamValue>& values) override;
  void deliver(const Pegasus::CIMValue& value) override { pending_.returnValue = value; }

  const Pegasus::CIMValue& returnValue() const { return completed_.returnValue; }
  const Pegasus::Array<Pegasus::CIMParamValue>& parameters() const { return completed_.parameters; }

 private:
  struct Result {
    Pegasus::CIMValue returnValue;
    Pegasus::Array<Pegasus::CIMParamValue> parameters;
  };

  Result pending_;
  Result completed_;
};

}  // namespace cimhost
