#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Embedded/Shareable.h>

#include <atomic>

PEGASUS_NAMESPACE_BEGIN

/// What handles of qualifiers, properties, parameters and methods refer to: something with a name
/// that lies in containers.
///
/// Frozen elements belong to several containers that were cloned from each other. Nobody changes a
/// frozen element: a container replaces it by a copy of its own before it hands it out for change.
/// Only an element to which no handle exists is ever frozen, so no change can come in from outside.
class Element : public Shareable {
 public:
  explicit Element(const CIMName& name) : name_(name) {
    if (name.isNull()) throw UninitializedObjectException();
  }
  /// The copy is in no container and not frozen.
  Element(const Element& other) : Shareable(other), name_(other.name_) {}

  const CIMName& name() const { return name_; }

  /// `kind` is what the message calls it.
  void rename(const CIMName& name, const char* kind) {
    if (name.isNull()) throw UninitializedObjectException();
    if (containers_.load(std::memory_order_relaxed) != 0 && name_ != name) {
      throw Exception(String("Attempted to change the name of a ") + String(kind) +
                      String(" already in a container."));
    }
    name_ = name;
  }

  void enterContainer() const { containers_.fetch_add(1, std::memory_order_relaxed); }
  void leaveContainer() const { containers_.fetch_sub(1, std::memory_order_relaxed); }

  bool isFrozen() const { return frozen_.load(std::memory_order_acquire); }
  // Const and atomic: several threads may clone the same container at once.
  void freeze() const { frozen_.store(true, std::memory_order_release); }
  void thaw() { frozen_.store(false, std::memory_order_relaxed); }

 private:
  CIMName name_;
  mutable std::atomic<Uint32> containers_{0};
  mutable std::atomic<bool> frozen_{false};
};

PEGASUS_NAMESPACE_END
