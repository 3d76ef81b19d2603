#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/Exception.h>

#include <algorithm>
#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>

// Definitions of Array's members. Not installed: one source file per group of element types
// includes it and instantiates them with PEGASUS_INSTANTIATE_ARRAY, so that other types do not
// link.

PEGASUS_NAMESPACE_BEGIN

/// In front of the elements, in the same block.
struct alignas(std::max_align_t) ArrayRepHeader {
  explicit ArrayRepHeader(Uint32 n) : references(1), size(0), capacity(n) {}

  bool shared() const { return references.load(std::memory_order_acquire) != 1; }

  std::atomic<Uint32> references;
  Uint32 size;  // elements that are constructed
  Uint32 capacity;
};

template <class T>
T* Array<T>::elements(ArrayRepHeader* rep) {
  static_assert(alignof(T) <= alignof(ArrayRepHeader), "elements follow the header directly");
  return reinterpret_cast<T*>(rep + 1);
}

template <class T>
ArrayRepHeader* Array<T>::allocate(Uint32 capacity) {
  constexpr std::size_t kMaxBytes = std::size_t(-1) / 2 - sizeof(ArrayRepHeader);
  if (capacity > kMaxBytes / sizeof(T)) throw std::bad_alloc();
  void* block = ::operator new(sizeof(ArrayRepHeader) + capacity * sizeof(T));
  return new (block) ArrayRepHeader(capacity);
}

template <class T>
void Array<T>::release(ArrayRepHeader* rep) {
  if (!rep || rep->references.fetch_sub(1, std::memory_order_acq_rel) != 1) return;
  std::destroy_n(elements(rep), rep->size);
  ::operator delete(rep);
}

// Leaves rep_ unshared with room for `capacity` elements in all; nothing changes when it throws.
template <class T>
void Array<T>::makeUnique(Uint32 capacity) {
  if (rep_ && !rep_->shared() && rep_->capacity >= capacity) return;
  Array fresh;
  fresh.rep_ = allocate(std::max(capacity, size()));
  if (rep_) {
    T* const from = elements(rep_);
    if (rep_->shared() || !std::is_nothrow_move_constructible_v<T>) {
      std::uninitialized_copy_n(from, rep_->size, elements(fresh.rep_));
    } else {
      std::uninitialized_move_n(from, rep_->size, elements(fresh.rep_));
    }
    fresh.rep_->size = rep_->size;
  }
  std::swap(rep_, fresh.rep_);
}

// The capacity to ask for when `n` elements are appended: at least doubles when the room is used
// up.
template <class T>
Uint32 Array<T>::capacityToAdd(Uint32 n) const {
  const Uint32 used = size();
  if (n > Uint32(-1) - used) throw std::bad_alloc();
  if (used + n <= getCapacity()) return used + n;
  const Uint32 doubled = getCapacity() > Uint32(-1) / 2 ? Uint32(-1) : 2 * getCapacity();
  return std::max({used + n, doubled, Uint32(4)});
}

template <class T>
Array<T>::Array() : rep_(nullptr) {}

template <class T>
Array<T>::Array(const Array& x) : rep_(x.rep_) {
  if (rep_) rep_->references.fetch_add(1, std::memory_order_relaxed);
}

template <class T>
Array<T>::Array(Array&& x) noexcept : rep_(std::exchange(x.rep_, nullptr)) {}

template <class T>
Array<T>::Array(Uint32 size) : Array() {
  makeUnique(size);
  std::uninitialized_value_construct_n(elements(rep_), size);
  rep_->size = size;
}

template <class T>
Array<T>::Array(Uint32 size, const T& x) : Array() {
  grow(size, x);
}

template <class T>
Array<T>::Array(const T* items, Uint32 size) : Array() {
  append(items, size);
}

template <class T>
Array<T>::~Array() {
  release(rep_);
}

template <class T>
Array<T>& Array<T>::operator=(const Array& x) {
  Array copy(x);
  swap(copy);
  return *this;
}

template <class T>
Array<T>& Array<T>::operator=(Array&& x) noexcept {
  std::swap(rep_, x.rep_);
  return *this;
}

// Keeps the room of an unshared array: callers refill it.
template <class T>
void Array<T>::clear() {
  if (!rep_) return;
  if (rep_->shared()) {
    release(std::exchange(rep_, nullptr));
    return;
  }
  std::destroy_n(elements(rep_), std::exchange(rep_->size, 0));
}

template <class T>
void Array<T>::reserveCapacity(Uint32 capacity) {
  if (capacity > getCapacity()) makeUnique(capacity);
}

template <class T>
void Array<T>::grow(Uint32 n, const T& x) {
  if (n == 0) return;
  const T copy(x);  // x may be an element of this array
  makeUnique(capacityToAdd(n));
  std::uninitialized_fill_n(elements(rep_) + rep_->size, n, copy);
  rep_->size += n;
}

template <class T>
void Array<T>::swap(Array& x) {
  std::swap(rep_, x.rep_);
}

template <class T>
Uint32 Array<T>::size() const {
  return rep_ ? rep_->size : 0;
}

template <class T>
Uint32 Array<T>::getCapacity() const {
  return rep_ ? rep_->capacity : 0;
}

template <class T>
const T* Array<T>::getData() const {
  alignas(T) static const unsigned char kNoElement[sizeof(T)] = {};
  return rep_ ? elements(rep_) : reinterpret_cast<const T*>(kNoElement);
}

template <class T>
T& Array<T>::operator[](Uint32 index) {
  if (index >= size()) throw IndexOutOfBoundsException();
  makeUnique(size());
  return elements(rep_)[index];
}

template <class T>
const T& Array<T>::operator[](Uint32 index) const {
  if (index >= size()) throw IndexOutOfBoundsException();
  return elements(rep_)[index];
}

template <class T>
void Array<T>::append(const T& x) {
  grow(1, x);
}

template <class T>
void Array<T>::append(const T* x, Uint32 n) {
  if (n == 0) return;
  // x may point into this array: its elements must then stay until they are copied.
  const Array keep(owns(x) ? *this : Array());
  makeUnique(capacityToAdd(n));
  std::uninitialized_copy_n(x, n, elements(rep_) + rep_->size);
  rep_->size += n;
}

template <class T>
void Array<T>::appendArray(const Array& x) {
  if (size() == 0 && getCapacity() < x.size()) {
    *this = x;
    return;
  }
  append(x.getData(), x.size());
}

template <class T>
void Array<T>::prepend(const T& x) {
  insert(0, x);
}

template <class T>
void Array<T>::prepend(const T* x, Uint32 n) {
  insert(0, x, n);
}

template <class T>
void Array<T>::insert(Uint32 index, const T& x) {
  insert(index, &x, 1);
}

template <class T>
void Array<T>::insert(Uint32 index, const T* x, Uint32 n) {
  const Uint32 oldSize = size();
  if (index > oldSize) throw IndexOutOfBoundsException();
  if (n == 0) return;
  append(x, n);
  T* const first = elements(rep_);
  std::rotate(first + index, first + oldSize, first + rep_->size);
}

template <class T>
void Array<T>::remove(Uint32 index) {
  remove(index, 1);
}

template <class T>
void Array<T>::remove(Uint32 index, Uint32 n) {
  const Uint32 oldSize = size();
  if (index > oldSize || n > oldSize - index) throw IndexOutOfBoundsException();
  if (n == 0) return;
  makeUnique(oldSize);
  T* const first = elements(rep_);
  std::move(first + index + n, first + oldSize, first + index);
  std::destroy_n(first + oldSize - n, n);
  rep_->size = oldSize - n;
}

template <class T>
bool Array<T>::owns(const T* x) const {
  const T* const first = getData();
  return !std::less<const T*>()(x, first) && std::less<const T*>()(x, first + size());
}

PEGASUS_NAMESPACE_END

/// Compiles the members of Array for one element type; use it inside the namespace Pegasus.
#define PEGASUS_INSTANTIATE_ARRAY(T) template class Array<T>
