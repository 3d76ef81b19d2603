#include "CIMValueAccess.h"

PEGASUS_NAMESPACE_BEGIN

namespace {

// Embedded objects are handles: a value has to hold, and to hand out, objects of its own.
template <class T>
constexpr bool kIsHandle = std::is_same_v<T, CIMObject> || std::is_same_v<T, CIMInstance>;

template <class T>
std::conditional_t<kIsHandle<T>, T, const T&> independent(const T& x) {
  if constexpr (kIsHandle<T>) {
    return x.clone();
  } else {
    return x;
  }
}

template <class T>
std::conditional_t<kIsHandle<T>, Array<T>, const Array<T>&> independent(const Array<T>& x) {
  if constexpr (kIsHandle<T>) {
    Array<T> clones;
    clones.reserveCapacity(x.size());
    for (Uint32 i = 0; i < x.size(); ++i) clones.append(x[i].clone());
    return clones;
  } else {
    return x;
  }
}

template <class T>
bool sameElement(const T& x, const T& y) {
  if constexpr (kIsHandle<T>) {
    return x.identical(y);
  } else {
    return x == y;
  }
}

template <class T>
bool sameElements(const Array<T>& x, const Array<T>& y) {
  if (x.size() != y.size()) return false;
  for (Uint32 i = 0; i < x.size(); ++i) {
    if (!sameElement(x[i], y[i])) return false;
  }
  return true;
}

// Numbers are passed by value, everything else by reference.
template <class T>
using Parameter = std::conditional_t<std::is_arithmetic_v<T>, T, const T&>;

void requireType(const CIMValue& value, CIMType type, Boolean isArray) {
  if (value.getType() != type || value.isArray() != isArray) throw TypeMismatchException();
}

}  // namespace

CIMValue::CIMValue() = default;

CIMValue::CIMValue(CIMType type, Boolean isArray, Uint32 arraySize)
    : type_(type), isArray_(isArray) {
  if (isArray) std::memcpy(scalar_, &arraySize, sizeof(arraySize));
}

CIMValue::CIMValue(CIMValue&& x) noexcept
    : type_(x.type_), isArray_(x.isArray_), isNull_(x.isNull_), shared_(std::move(x.shared_)) {
  std::memcpy(scalar_, x.scalar_, sizeof(scalar_));
  // The block is gone, so the source must not be read as if it were there.
  x.isNull_ = true;
}

CIMValue& CIMValue::operator=(CIMValue&& x) noexcept {
  if (this == &x) return *this;
  type_ = x.type_;
  isArray_ = x.isArray_;
  isNull_ = std::exchange(x.isNull_, true);
  std::memcpy(scalar_, x.scalar_, sizeof(scalar_));
  shared_ = std::move(x.shared_);
  return *this;
}

#define PEGASUS_DEFINE_MEMBERS(code, T)                                                        \
  CIMValue::CIMValue(Parameter<T> x) : CIMValue(CIMValueAccess::ofScalar(independent(x))) {}   \
  void CIMValue::set(Parameter<T> x) {                                                         \
    *this = CIMValue(x);                                                                       \
  }                                                                                            \
  void CIMValue::get(T& x) const {                                                             \
    requireType(*this, code, false);                                                           \
    if (!isNull_) x = independent(CIMValueAccess::scalar<T>(*this));                           \
  }                                                                                            \
  void CIMValue::get(Array<T>& x) const {                                                      \
    requireType(*this, code, true);                                                            \
    if (!isNull_) x = independent(CIMValueAccess::held<Array<T>>(*this));                      \
  }                                                                                            \
  CIMValue::CIMValue(const Array<T>& x) : CIMValue(CIMValueAccess::ofArray(independent(x))) {} \
  void CIMValue::set(const Array<T>& x) {                                                      \
    *this = CIMValue(x);                                                                       \
  }
PEGASUS_FOR_EACH_CIM_TYPE(PEGASUS_DEFINE_MEMBERS)
#undef PEGASUS_DEFINE_MEMBERS

void CIMValue::assign(const CIMValue& value) {
  *this = value;
}

void CIMValue::clear() {
  *this = CIMValue();
}

Boolean CIMValue::typeCompatible(const CIMValue& value) const {
  return type_ == value.type_ && isArray_ == value.isArray_;
}

Boolean CIMValue::isArray() const {
  return isArray_;
}

Boolean CIMValue::isNull() const {
  return isNull_;
}

Uint32 CIMValue::getArraySize() const {
  if (!isArray_) return 0;
  if (isNull_) {
    Uint32 declared;
    std::memcpy(&declared, scalar_, sizeof(declared));
    return declared;
  }
  return visitCimType(type_, [this](auto tag) {
    return CIMValueAccess::held<Array<typename decltype(tag)::Type>>(*this).size();
  });
}

CIMType CIMValue::getType() const {
  return type_;
}

void CIMValue::setNullValue(CIMType type, Boolean isArray, Uint32 arraySize) {
  *this = CIMValue(type, isArray, arraySize);
}

Boolean CIMValue::equal(const CIMValue& value) const {
  if (!typeCompatible(value) || isNull_ != value.isNull_) return false;
  if (isNull_) return true;
  return visitCimType(type_, [&](auto tag) {
    using T = typename decltype(tag)::Type;
    if (isArray_) {
      return sameElements(CIMValueAccess::held<Array<T>>(*this),
                          CIMValueAccess::held<Array<T>>(value));
    }
    return sameElement<T>(CIMValueAccess::scalar<T>(*this), CIMValueAccess::scalar<T>(value));
  });
}

Boolean operator==(const CIMValue& x, const CIMValue& y) {
  return x.equal(y);
}

Boolean operator!=(const CIMValue& x, const CIMValue& y) {
  return !x.equal(y);
}

PEGASUS_NAMESPACE_END
