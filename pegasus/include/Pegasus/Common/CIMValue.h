// A CIM value: any of the CIM types, scalar or array, or null.
#pragma once

#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Common/CIMObject.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/Char16.h>
#include <Pegasus/Common/Exception.h>
#include <Pegasus/Common/String.h>
#include <Pegasus/Embedded/Shareable.h>

PEGASUS_NAMESPACE_BEGIN

class CIMObject;
class CIMInstance;
struct CIMValueAccess;

/// A value class: a copy is independent of its source and cheap, whatever the value holds.
///
/// Objects and instances are cloned in and cloned out. There is no constructor from const char*:
/// CIMValue("abc") is the Boolean true.
class PEGASUS_COMMON_LINKAGE CIMValue {
 public:
  /// A null Boolean.
  CIMValue();
  /// A null value; `arraySize` is the declared size of a fixed array.
  CIMValue(CIMType type, Boolean isArray, Uint32 arraySize = 0);
  CIMValue(const CIMValue& x) = default;
  CIMValue(CIMValue&& x) noexcept;
  CIMValue(Boolean x);
  CIMValue(Uint8 x);
  CIMValue(Sint8 x);
  CIMValue(Uint16 x);
  CIMValue(Sint16 x);
  CIMValue(Uint32 x);
  CIMValue(Sint32 x);
  CIMValue(Uint64 x);
  CIMValue(Sint64 x);
  CIMValue(Real32 x);
  CIMValue(Real64 x);
  CIMValue(const Char16& x);
  CIMValue(const String& x);
  CIMValue(const CIMDateTime& x);
  CIMValue(const CIMObjectPath& x);
  CIMValue(const CIMObject& x);
  CIMValue(const CIMInstance& x);
  CIMValue(const Array<Boolean>& x);
  CIMValue(const Array<Uint8>& x);
  CIMValue(const Array<Sint8>& x);
  CIMValue(const Array<Uint16>& x);
  CIMValue(const Array<Sint16>& x);
  CIMValue(const Array<Uint32>& x);
  CIMValue(const Array<Sint32>& x);
  CIMValue(const Array<Uint64>& x);
  CIMValue(const Array<Sint64>& x);
  CIMValue(const Array<Real32>& x);
  CIMValue(const Array<Real64>& x);
  CIMValue(const Array<Char16>& x);
  CIMValue(const Array<String>& x);
  CIMValue(const Array<CIMDateTime>& x);
  CIMValue(const Array<CIMObjectPath>& x);
  CIMValue(const Array<CIMObject>& x);
  CIMValue(const Array<CIMInstance>& x);

  CIMValue& operator=(const CIMValue& x) = default;
  CIMValue& operator=(CIMValue&& x) noexcept;

  void assign(const CIMValue& value);
  /// Leaves what CIMValue() constructs.
  void clear();
  /// The same type and array flag.
  Boolean typeCompatible(const CIMValue& value) const;
  Boolean isArray() const;
  Boolean isNull() const;
  /// The number of elements, the declared size of a null array, 0 for a scalar.
  Uint32 getArraySize() const;
  CIMType getType() const;
  void setNullValue(CIMType type, Boolean isArray, Uint32 arraySize = 0);

  /// Each may change the type.
  void set(Boolean x);
  void set(Uint8 x);
  void set(Sint8 x);
  void set(Uint16 x);
  void set(Sint16 x);
  void set(Uint32 x);
  void set(Sint32 x);
  void set(Uint64 x);
  void set(Sint64 x);
  void set(Real32 x);
  void set(Real64 x);
  void set(const Char16& x);
  void set(const String& x);
  void set(const CIMDateTime& x);
  void set(const CIMObjectPath& x);
  void set(const CIMObject& x);
  void set(const CIMInstance& x);
  void set(const Array<Boolean>& x);
  void set(const Array<Uint8>& x);
  void set(const Array<Sint8>& x);
  void set(const Array<Uint16>& x);
  void set(const Array<Sint16>& x);
  void set(const Array<Uint32>& x);
  void set(const Array<Sint32>& x);
  void set(const Array<Uint64>& x);
  void set(const Array<Sint64>& x);
  void set(const Array<Real32>& x);
  void set(const Array<Real64>& x);
  void set(const Array<Char16>& x);
  void set(const Array<String>& x);
  void set(const Array<CIMDateTime>& x);
  void set(const Array<CIMObjectPath>& x);
  void set(const Array<CIMObject>& x);
  void set(const Array<CIMInstance>& x);

  /// Each throws TypeMismatchException unless type and array flag are the value's own (nothing is
  /// widened), and leaves `x` unchanged when the value is null.
  void get(Boolean& x) const;
  void get(Uint8& x) const;
  void get(Sint8& x) const;
  void get(Uint16& x) const;
  void get(Sint16& x) const;
  void get(Uint32& x) const;
  void get(Sint32& x) const;
  void get(Uint64& x) const;
  void get(Sint64& x) const;
  void get(Real32& x) const;
  void get(Real64& x) const;
  void get(Char16& x) const;
  void get(String& x) const;
  void get(CIMDateTime& x) const;
  void get(CIMObjectPath& x) const;
  void get(CIMObject& x) const;
  void get(CIMInstance& x) const;
  void get(Array<Boolean>& x) const;
  void get(Array<Uint8>& x) const;
  void get(Array<Sint8>& x) const;
  void get(Array<Uint16>& x) const;
  void get(Array<Sint16>& x) const;
  void get(Array<Uint32>& x) const;
  void get(Array<Sint32>& x) const;
  void get(Array<Uint64>& x) const;
  void get(Array<Sint64>& x) const;
  void get(Array<Real32>& x) const;
  void get(Array<Real64>& x) const;
  void get(Array<Char16>& x) const;
  void get(Array<String>& x) const;
  void get(Array<CIMDateTime>& x) const;
  void get(Array<CIMObjectPath>& x) const;
  void get(Array<CIMObject>& x) const;
  void get(Array<CIMInstance>& x) const;

  /// Type, array flag, null flag and value; NaN differs from itself.
  Boolean equal(const CIMValue& value) const;
  /// The value as text, "" for null; every element of an array is followed by one blank.
  String toString() const;

 private:
  friend struct CIMValueAccess;

  CIMType type_ = CIMTYPE_BOOLEAN;
  Boolean isArray_ = false;
  Boolean isNull_ = true;
  // A number, Boolean or Char16 lies in the eight bytes (in the first of them); so does the
  // declared size of a null array. Everything else is in a block that copies share.
  alignas(8) unsigned char scalar_[8] = {};
  Ref<Shareable> shared_;
};

PEGASUS_COMMON_LINKAGE Boolean operator==(const CIMValue& x, const CIMValue& y);
PEGASUS_COMMON_LINKAGE Boolean operator!=(const CIMValue& x, const CIMValue& y);

PEGASUS_NAMESPACE_END
