// Reference counting behind the handle classes of the embedded API.
#pragma once

#include <Pegasus/Common/Config.h>

#include <atomic>
#include <cstddef>
#include <utility>

PEGASUS_NAMESPACE_BEGIN

/// Base of what handles and copy-on-write values refer to. Counting is thread-safe, nothing else
/// is.
class PEGASUS_COMMON_LINKAGE Shareable {
 public:
  Shareable() noexcept {}
  /// A copy starts without any reference of its own.
  Shareable(const Shareable&) noexcept {}
  Shareable& operator=(const Shareable&) = delete;
  virtual ~Shareable();

  void retain() const noexcept { references_.fetch_add(1, std::memory_order_relaxed); }
  void release() const noexcept {
    // The only reference cannot be copied by anybody else: no locked instruction is needed.
    if (isOnlyReference() || references_.fetch_sub(1, std::memory_order_acq_rel) == 1) delete this;
  }
  /// True when the asking reference is the only one; what others did before is then visible.
  bool isOnlyReference() const noexcept { return references_.load(std::memory_order_acquire) == 1; }

 private:
  mutable std::atomic<Uint32> references_{0};
};

/// A counted reference to a T derived from Shareable, which may be incomplete until it is used.
template <class T>
class Ref {
 public:
  Ref() noexcept = default;
  explicit Ref(T* object) noexcept : object_(object) {
    if (object_) object_->retain();
  }
  Ref(const Ref& other) noexcept : object_(other.object_) {
    if (object_) object_->retain();
  }
  Ref(Ref&& other) noexcept : object_(std::exchange(other.object_, nullptr)) {}
  template <class Derived>
  Ref(const Ref<Derived>& other) noexcept : Ref(other.get()) {}
  template <class Derived>
  Ref(Ref<Derived>&& other) noexcept : object_(other.get()) {
    other.object_ = nullptr;
  }
  ~Ref() {
    if (object_) object_->release();
  }
  Ref& operator=(Ref other) noexcept {
    std::swap(object_, other.object_);
    return *this;
  }

  T* get() const noexcept { return static_cast<T*>(object_); }
  T* operator->() const noexcept { return get(); }
  T& operator*() const noexcept { return *get(); }
  explicit operator bool() const noexcept { return object_ != nullptr; }
  bool isOnlyReference() const noexcept { return object_->isOnlyReference(); }

 private:
  template <class Other>
  friend class Ref;

  // Held as the base so that copying and destroying need no complete T.
  Shareable* object_ = nullptr;
};

PEGASUS_NAMESPACE_END
