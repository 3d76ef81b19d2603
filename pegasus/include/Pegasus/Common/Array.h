#pragma once

#include <Pegasus/Common/String.h>

#include <initializer_list>

PEGASUS_NAMESPACE_BEGIN

struct ArrayRepHeader;

/// A growable array with copy-on-write sharing; elements lie in one block (also for Boolean).
///
/// The members are compiled only for the CIM data types, String, Char16, char and the CIM classes;
/// any other element type fails to link. The non-const operator[] un-shares first; a reference
/// stays valid until the next change or copy of the array. An index or range past the end throws
/// IndexOutOfBoundsException. Different objects may be used by different threads at once.
template <class T>
class PEGASUS_COMMON_LINKAGE Array {
 public:
  Array();
  Array(const Array& x);
  Array(Array&& x) noexcept;
  /// `size` default elements; numbers are 0.
  Array(Uint32 size);
  Array(Uint32 size, const T& x);
  Array(const T* items, Uint32 size);
  /// Refused, so that {1, 2} is never taken for one element of value 2.
  Array(std::initializer_list<T>) = delete;
  ~Array();
  Array& operator=(const Array& x);
  Array& operator=(Array&& x) noexcept;

  void clear();
  void reserveCapacity(Uint32 capacity);
  /// Appends `n` copies of `x`.
  void grow(Uint32 n, const T& x);
  void swap(Array& x);
  Uint32 size() const;
  Uint32 getCapacity() const;
  /// Never null, but to be read only up to size().
  const T* getData() const;

  T& operator[](Uint32 index);
  const T& operator[](Uint32 index) const;

  void append(const T& x);
  void append(const T* x, Uint32 n);
  void appendArray(const Array& x);
  void prepend(const T& x);
  void prepend(const T* x, Uint32 n);
  void insert(Uint32 index, const T& x);
  void insert(Uint32 index, const T* x, Uint32 n);
  void remove(Uint32 index);
  void remove(Uint32 index, Uint32 n);

 private:
  static ArrayRepHeader* allocate(Uint32 capacity);
  static void release(ArrayRepHeader* rep);
  static T* elements(ArrayRepHeader* rep);
  void makeUnique(Uint32 capacity);
  Uint32 capacityToAdd(Uint32 n) const;
  bool owns(const T* x) const;

  ArrayRepHeader* rep_;  // null while the array is empty and nothing is reserved
};

PEGASUS_NAMESPACE_END
