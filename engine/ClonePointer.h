#pragma once

#include <memory>
#include <utility>

/// An owning pointer whose copy owns a copy of the object. May be empty.
template <class T>
class ClonePointer {
 public:
  ClonePointer() = default;
  ClonePointer(std::unique_ptr<T> object) : object_(std::move(object)) {}
  ClonePointer(const ClonePointer& other)
      : object_(other.object_ ? std::make_unique<T>(*other.object_) : nullptr) {}
  ClonePointer(ClonePointer&&) noexcept = default;
  ClonePointer& operator=(ClonePointer other) noexcept {
    object_ = std::move(other.object_);
    return *this;
  }
  ~ClonePointer() = default;

  T* get() const { return object_.get(); }
  T* operator->() const { return object_.get(); }
  T& operator*() const { return *object_; }
  explicit operator bool() const { return object_ != nullptr; }

 private:
  std::unique_ptr<T> object_;
};
