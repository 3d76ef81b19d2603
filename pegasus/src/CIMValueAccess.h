#pragma once

#include <Pegasus/Common/CIMValue.h>

#include <cstring>
#include <type_traits>

#include "CIMTypeList.h"

PEGASUS_NAMESPACE_BEGIN

/// What copies of a value share; never changed once it is made.
template <class T>
class HeldValue final : public Shareable {
 public:
  explicit HeldValue(const T& value) : value_(value) {}
  const T& value() const { return value_; }

 private:
  const T value_;
};

/// How each C++ type lies in a CIMValue.
struct CIMValueAccess {
  template <class T>
  static constexpr bool kInline = std::is_trivially_copyable_v<T> && sizeof(T) <= 8;

  /// The content of a value that is not null and whose type is T (an Array for an array).
  template <class T>
  static const T& held(const CIMValue& value) {
    return static_cast<const HeldValue<T>*>(value.shared_.get())->value();
  }

  template <class T>
  static std::conditional_t<kInline<T>, T, const T&> scalar(const CIMValue& value) {
    if constexpr (kInline<T>) {
      T result;
      // Through void*, for a Char16 has constructors.
      std::memcpy(static_cast<void*>(&result), value.scalar_, sizeof(T));
      return result;
    } else {
      return held<T>(value);
    }
  }

  template <class T>
  static CIMValue ofScalar(const T& x) {
    CIMValue value(CimTypeCode<T>::value, false);
    value.isNull_ = false;
    if constexpr (kInline<T>) {
      std::memcpy(value.scalar_, &x, sizeof(T));
    } else {
      value.shared_ = Ref<Shareable>(new HeldValue<T>(x));
    }
    return value;
  }

  template <class T>
  static CIMValue ofArray(const Array<T>& x) {
    CIMValue value(CimTypeCode<T>::value, true);
    value.isNull_ = false;
    value.shared_ = Ref<Shareable>(new HeldValue<Array<T>>(x));
    return value;
  }
};

PEGASUS_NAMESPACE_END
