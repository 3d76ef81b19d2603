#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMParamValue.h>

namespace cimhost {

// Where an operation puts its results, one object at a time, in order, on the thread that called
// the operation. `false` asks for no more: the rest is dropped and the operation ends well. An
// exception does the same and becomes the operation's status. A sink never sees a provider's stack
// fail: what it throws does not pass through provider code.

class InstanceSink {
 public:
  virtual ~InstanceSink() = default;
  /// The object may be shared with the provider: read it, or clone it; do not change it.
  virtual bool deliverInstance(const Pegasus::CIMInstance& instance) = 0;
};

class ObjectPathSink {
 public:
  virtual ~ObjectPathSink() = default;
  virtual bool deliverPath(const Pegasus::CIMObjectPath& path) = 0;
};

class ClassSink {
 public:
  virtual ~ClassSink() = default;
  virtual bool deliverClass(const Pegasus::CIMClass& declaration) = 0;
};

class ClassNameSink {
 public:
  virtual ~ClassNameSink() = default;
  virtual bool deliverClassName(const Pegasus::CIMName& name) = 0;
};

class MethodResultSink {
 public:
  virtual ~MethodResultSink() = default;
  /// Called once; `returnValue` is null when the provider delivered none. There is no more to ask
  /// for: what it returns makes no difference.
  virtual bool deliverMethodResult(const Pegasus::CIMValue& returnValue,
                                   const Pegasus::Array<Pegasus::CIMParamValue>& parameters) = 0;
};

}  // namespace cimhost
