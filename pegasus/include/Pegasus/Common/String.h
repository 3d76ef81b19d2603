#pragma once

#include <Pegasus/Common/Char16.h>

#include <cstdarg>
#include <iostream>

PEGASUS_NAMESPACE_BEGIN

class String;
struct EmptyString;

/// Owns a NUL-terminated UTF-8 copy of a String; null by default. The pointer that it converts to
/// lives as long as this object, which String::getCString() returns by value.
class PEGASUS_COMMON_LINKAGE CString {
 public:
  CString();
  CString(const CString& other);
  CString(CString&& other) noexcept;
  ~CString();
  CString& operator=(const CString& other);

  operator const char*() const { return text_; }

 private:
  friend class String;
  explicit CString(char* text) : text_(text) {}

  char* text_;
};

/// Text of UTF-16 code units, with a terminating unit 0 that size() does not count.
///
/// Copies share one representation until one of them is changed; different objects may be used by
/// different threads at once. A constructor from `char` text decodes UTF-8 and throws Exception
/// when it is malformed or a null pointer. An index past the end throws IndexOutOfBoundsException.
/// Case is folded for A-Z only.
class PEGASUS_COMMON_LINKAGE String {
 public:
  static const String EMPTY;

  String() noexcept;
  String(const String& str) noexcept;
  String(String&& str) noexcept;
  String(const String& str, Uint32 n);
  String(const Char16* str);
  String(const Char16* str, Uint32 n);
  String(const char* str);
  /// `n` bytes, in which a NUL is a unit like any other.
  String(const char* str, Uint32 n);
  ~String();

  String& operator=(const String& str) noexcept;
  String& operator=(String&& str) noexcept;
  String& assign(const String& str);
  String& assign(const Char16* str);
  String& assign(const Char16* str, Uint32 n);
  String& assign(const char* str);
  String& assign(const char* str, Uint32 n);

  void clear();
  void reserveCapacity(Uint32 capacity);
  Uint32 size() const;
  const Char16* getChar16Data() const;
  /// As UTF-8; an unpaired surrogate becomes the three bytes of its code.
  CString getCString() const;

  /// The reference is invalid after the next change of this object; index size() gives the
  /// terminating unit.
  Char16& operator[](Uint32 index);
  const Char16 operator[](Uint32 index) const;

  String& append(const Char16& c);
  String& append(const Char16* str, Uint32 n);
  String& append(const String& str);
  void remove(Uint32 index, Uint32 size = PEG_NOT_FOUND);
  String subString(Uint32 index, Uint32 n = PEG_NOT_FOUND) const;

  Uint32 find(Char16 c) const;
  Uint32 find(Uint32 index, Char16 c) const;
  /// PEG_NOT_FOUND for an empty text.
  Uint32 find(const String& s) const;
  Uint32 reverseFind(Char16 c) const;
  void toLower();
  void appendPrintf(const char* format, ...) __attribute__((format(printf, 2, 3)));

  /// Negative, zero or positive; the first form looks at `n` units at most.
  static int compare(const String& s1, const String& s2, Uint32 n);
  static int compare(const String& s1, const String& s2);
  static int compareNoCase(const String& s1, const String& s2);
  static Boolean equal(const String& s1, const String& s2);
  static Boolean equalNoCase(const String& s1, const String& s2);

 private:
  friend struct EmptyString;
  struct Rep;
  static Rep* allocate(Uint32 capacity);
  static Rep* copyOf(const Char16* units, Uint32 size, Uint32 capacity);
  static Rep* decode(const char* text, size_t size);
  static void release(Rep* rep);
  void makeUnique(Uint32 capacity);

  Rep* rep_;
};

PEGASUS_COMMON_LINKAGE bool operator==(const String& s1, const String& s2);
PEGASUS_COMMON_LINKAGE bool operator==(const String& s1, const char* s2);
PEGASUS_COMMON_LINKAGE bool operator==(const char* s1, const String& s2);
PEGASUS_COMMON_LINKAGE bool operator!=(const String& s1, const String& s2);
PEGASUS_COMMON_LINKAGE bool operator<(const String& s1, const String& s2);
PEGASUS_COMMON_LINKAGE bool operator<=(const String& s1, const String& s2);
PEGASUS_COMMON_LINKAGE bool operator>(const String& s1, const String& s2);
PEGASUS_COMMON_LINKAGE bool operator>=(const String& s1, const String& s2);
PEGASUS_COMMON_LINKAGE String operator+(const String& s1, const String& s2);

/// Units below 0x100 as one byte each, others as `\xHHHH`; for diagnostics, not UTF-8.
PEGASUS_COMMON_LINKAGE PEGASUS_STD(ostream) & operator<<(PEGASUS_STD(ostream) & os,
                                                         const String& str);

PEGASUS_NAMESPACE_END
