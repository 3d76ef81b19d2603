#include <Pegasus/Common/Exception.h>
#include <Pegasus/Common/String.h>

#include <algorithm>
#include <atomic>
#include <cstdio>
#include <cstring>
#include <functional>
#include <memory>
#include <new>
#include <string>
#include <utility>

#include "Utf8.h"

PEGASUS_NAMESPACE_BEGIN

/// In front of the units and the terminating unit 0, in the same block.
struct String::Rep {
  constexpr explicit Rep(Uint32 n) : references(1), size(0), capacity(n) {}

  bool shared() const;
  Char16* units() { return reinterpret_cast<Char16*>(this + 1); }
  void setSize(Uint32 n) {
    size = n;
    units()[n] = Uint16(0);
  }

  std::atomic<Uint32> references;
  Uint32 size;
  Uint32 capacity;  // units without the terminator
};

struct EmptyString {
  String::Rep rep{0};
  Char16 terminator;

  // Shared by every empty text and never counted, so that threads do not contend for it.
  static EmptyString instance;
};

EmptyString EmptyString::instance;

bool String::Rep::shared() const {
  return this == &EmptyString::instance.rep || references.load(std::memory_order_acquire) != 1;
}

const String String::EMPTY;

namespace {

Uint16 lower(Char16 c) {
  const Uint16 unit = c;
  return unit >= 'A' && unit <= 'Z' ? Uint16(unit + ('a' - 'A')) : unit;
}

template <class T>
const T* notNull(const T* text) {
  if (!text) throw Exception("null pointer");
  return text;
}

Uint32 length(const Char16* units) {
  Uint32 n = 0;
  while (Uint16(notNull(units)[n]) != 0) ++n;
  return n;
}

// Shows the text before and the bytes from `index` on. Where a character is cut, the text before is
// malformed in its turn, and that is reported.
[[noreturn]] void throwMalformed(const char* text, size_t size, size_t index) {
  constexpr size_t kBefore = 40;
  constexpr size_t kBytes = 11;
  char part[32];
  std::snprintf(part, sizeof part, "%zu", index);
  String message("The byte sequence starting at index ");
  message.append(String(part)).append(String(" is not valid UTF-8 encoding: "));
  const size_t shown = std::min(index, kBefore);
  message.append(String(text + index - shown, Uint32(shown)));
  for (size_t i = index; i < std::min(size, index + kBytes); ++i) {
    std::snprintf(part, sizeof part, " 0x%02X", unsigned(static_cast<unsigned char>(text[i])));
    message.append(String(part));
  }
  throw Exception(message);
}

template <class Fold>
int compareUnits(const Char16* a, Uint32 aSize, const Char16* b, Uint32 bSize, Fold fold) {
  const Uint32 common = std::min(aSize, bSize);
  for (Uint32 i = 0; i < common; ++i) {
    const int difference = int(fold(a[i])) - int(fold(b[i]));
    if (difference != 0) return difference;
  }
  return aSize == bSize ? 0 : aSize < bSize ? -1 : 1;
}

}  // namespace

CString::CString() : text_(nullptr) {}

CString::CString(const CString& other) : text_(nullptr) {
  if (!other.text_) return;
  const size_t size = std::strlen(other.text_) + 1;
  text_ = new char[size];
  std::memcpy(text_, other.text_, size);
}

CString::CString(CString&& other) noexcept : text_(std::exchange(other.text_, nullptr)) {}

CString::~CString() {
  delete[] text_;
}

CString& CString::operator=(const CString& other) {
  CString copy(other);
  std::swap(text_, copy.text_);
  return *this;
}

String::Rep* String::allocate(Uint32 capacity) {
  constexpr Uint32 kMaxUnits = 0x3FFFFFFF;  // 2 GiB, within a 32-bit address space
  if (capacity > kMaxUnits) throw std::bad_alloc();
  return new (::operator new(sizeof(Rep) + (size_t(capacity) + 1) * sizeof(Char16))) Rep(capacity);
}

String::Rep* String::copyOf(const Char16* units, Uint32 size, Uint32 capacity) {
  if (size == 0 && capacity == 0) return &EmptyString::instance.rep;
  Rep* const rep = allocate(std::max(size, capacity));
  std::uninitialized_copy_n(units, size, rep->units());
  rep->setSize(size);
  return rep;
}

String::Rep* String::decode(const char* text, size_t size) {
  if (size == 0) return &EmptyString::instance.rep;
  if (size > PEG_NOT_FOUND) throw std::bad_alloc();
  Rep* const rep = allocate(Uint32(size));
  const Utf8Decoded decoded = decodeUtf8(text, size, rep->units());
  if (decoded.end != size) {
    release(rep);
    throwMalformed(text, size, decoded.end);
  }
  rep->setSize(Uint32(decoded.units));
  return rep;
}

void String::release(Rep* rep) {
  if (rep == &EmptyString::instance.rep) return;
  if (rep->references.fetch_sub(1, std::memory_order_acq_rel) != 1) return;
  ::operator delete(rep);
}

// Leaves rep_ unshared with room for `capacity` units and for those that it holds.
void String::makeUnique(Uint32 capacity) {
  if (!rep_->shared() && rep_->capacity >= capacity) return;
  Rep* const fresh = copyOf(rep_->units(), rep_->size, std::max(capacity, Uint32(1)));
  release(std::exchange(rep_, fresh));
}

String::String() noexcept : rep_(&EmptyString::instance.rep) {}

String::String(const String& str) noexcept : rep_(str.rep_) {
  if (rep_ != &EmptyString::instance.rep) {
    rep_->references.fetch_add(1, std::memory_order_relaxed);
  }
}

String::String(String&& str) noexcept : rep_(std::exchange(str.rep_, &EmptyString::instance.rep)) {}

String::String(const String& str, Uint32 n) : String() {
  if (n > str.size()) throw IndexOutOfBoundsException();
  rep_ = copyOf(str.rep_->units(), n, n);
}

String::String(const Char16* str) : String(str, length(str)) {}

String::String(const Char16* str, Uint32 n) : rep_(copyOf(notNull(str), n, n)) {}

String::String(const char* str) : rep_(decode(str, std::strlen(notNull(str)))) {}

String::String(const char* str, Uint32 n) : rep_(decode(notNull(str), n)) {}

String::~String() {
  release(rep_);
}

String& String::operator=(const String& str) noexcept {
  String copy(str);
  std::swap(rep_, copy.rep_);
  return *this;
}

String& String::operator=(String&& str) noexcept {
  std::swap(rep_, str.rep_);
  return *this;
}

String& String::assign(const String& str) {
  return *this = str;
}
String& String::assign(const Char16* str) {
  return *this = String(str);
}
String& String::assign(const Char16* str, Uint32 n) {
  return *this = String(str, n);
}
String& String::assign(const char* str) {
  return *this = String(str);
}
String& String::assign(const char* str, Uint32 n) {
  return *this = String(str, n);
}

void String::clear() {
  if (rep_->shared()) {
    release(std::exchange(rep_, &EmptyString::instance.rep));
  } else {
    rep_->setSize(0);
  }
}

void String::reserveCapacity(Uint32 capacity) {
  if (capacity > rep_->capacity) makeUnique(capacity);
}

Uint32 String::size() const {
  return rep_->size;
}

const Char16* String::getChar16Data() const {
  return rep_->units();
}

CString String::getCString() const {
  const size_t units = encodableUnits(rep_->units(), rep_->size);
  const size_t bytes = utf8Size(rep_->units(), units);
  char* const text = new char[bytes + 1];
  if (bytes == units) {
    for (size_t i = 0; i < bytes; ++i) text[i] = static_cast<char>(Uint16(rep_->units()[i]));
  } else {
    encodeUtf8(rep_->units(), units, text);
  }
  text[bytes] = '\0';
  return CString(text);
}

Char16& String::operator[](Uint32 index) {
  if (index > rep_->size) throw IndexOutOfBoundsException();
  makeUnique(rep_->size);
  return rep_->units()[index];
}

const Char16 String::operator[](Uint32 index) const {
  if (index > rep_->size) throw IndexOutOfBoundsException();
  return rep_->units()[index];
}

String& String::append(const Char16& c) {
  const Char16 copy = c;  // c may be a unit of this text
  return append(&copy, 1);
}

String& String::append(const Char16* str, Uint32 n) {
  notNull(str);
  if (n == 0) return *this;
  if (n > PEG_NOT_FOUND - rep_->size) throw std::bad_alloc();
  const Char16* const own = rep_->units();
  const bool inside =
      !std::less<const Char16*>()(str, own) && std::less<const Char16*>()(str, own + rep_->size);
  const String keep(inside ? *this : EMPTY);  // keeps `str` alive until it is copied
  const Uint32 newSize = rep_->size + n;
  makeUnique(newSize <= rep_->capacity ? newSize : std::max(newSize, newSize / 2 * 3));
  std::copy_n(str, n, rep_->units() + rep_->size);
  rep_->setSize(newSize);
  return *this;
}

String& String::append(const String& str) {
  if (rep_->capacity == 0) return *this = str;
  return append(str.getChar16Data(), str.size());
}

void String::remove(Uint32 index, Uint32 size) {
  const Uint32 oldSize = rep_->size;
  if (index > oldSize) throw IndexOutOfBoundsException();
  const Uint32 n = size == PEG_NOT_FOUND ? oldSize - index : size;
  if (n > oldSize - index) throw IndexOutOfBoundsException();
  if (n == 0) return;
  makeUnique(oldSize);
  Char16* const units = rep_->units();
  std::copy(units + index + n, units + oldSize, units + index);
  rep_->setSize(oldSize - n);
}

String String::subString(Uint32 index, Uint32 n) const {
  if (index >= rep_->size) return String();
  if (index == 0 && n >= rep_->size) return *this;
  return String(rep_->units() + index, std::min(n, rep_->size - index));
}

Uint32 String::find(Char16 c) const {
  return find(0, c);
}

Uint32 String::find(Uint32 index, Char16 c) const {
  if (index > rep_->size) throw IndexOutOfBoundsException();
  const Char16* const end = rep_->units() + rep_->size;
  const Char16* const at = std::find(static_cast<const Char16*>(rep_->units()) + index, end, c);
  return at == end ? PEG_NOT_FOUND : Uint32(at - rep_->units());
}

Uint32 String::find(const String& s) const {
  const Char16* const begin = rep_->units();
  const Char16* const end = begin + rep_->size;
  const Char16* const what = s.rep_->units();
  const Char16* const at = std::search(begin, end, what, what + s.size());
  return s.size() == 0 || at == end ? PEG_NOT_FOUND : Uint32(at - begin);
}

Uint32 String::reverseFind(Char16 c) const {
  for (Uint32 i = rep_->size; i-- > 0;) {
    if (rep_->units()[i] == c) return i;
  }
  return PEG_NOT_FOUND;
}

void String::toLower() {
  const Char16* const units = rep_->units();
  const auto isUpper = [](Char16 c) { return lower(c) != Uint16(c); };
  if (std::none_of(units, units + rep_->size, isUpper)) return;
  makeUnique(rep_->size);
  std::transform(rep_->units(), rep_->units() + rep_->size, rep_->units(),
                 [](Char16 c) { return Char16(lower(c)); });
}

void String::appendPrintf(const char* format, ...) {
  va_list arguments;
  va_start(arguments, format);
  va_list again;
  va_copy(again, arguments);
  const int size = std::vsnprintf(nullptr, 0, format, arguments);
  va_end(arguments);
  const size_t room = size < 0 ? 1 : size_t(size) + 1;
  const std::unique_ptr<char[]> text(new char[room]());
  std::vsnprintf(text.get(), room, format, again);
  va_end(again);
  append(String(text.get()));
}

int String::compare(const String& s1, const String& s2, Uint32 n) {
  return compareUnits(s1.getChar16Data(), std::min(n, s1.size()), s2.getChar16Data(),
                      std::min(n, s2.size()), [](Char16 c) { return Uint16(c); });
}

int String::compare(const String& s1, const String& s2) {
  return compare(s1, s2, PEG_NOT_FOUND);
}

int String::compareNoCase(const String& s1, const String& s2) {
  if (s1.rep_ == s2.rep_) return 0;
  return compareUnits(s1.getChar16Data(), s1.size(), s2.getChar16Data(), s2.size(), lower);
}

Boolean String::equal(const String& s1, const String& s2) {
  if (s1.rep_ == s2.rep_) return true;
  return s1.size() == s2.size() &&
         std::memcmp(s1.rep_->units(), s2.rep_->units(), s1.size() * sizeof(Char16)) == 0;
}

Boolean String::equalNoCase(const String& s1, const String& s2) {
  return s1.size() == s2.size() && compareNoCase(s1, s2) == 0;
}

bool operator==(const String& s1, const String& s2) {
  return String::equal(s1, s2);
}

bool operator==(const String& s1, const char* s2) {
  const Char16* const units = s1.getChar16Data();
  const Uint32 size = s1.size();
  notNull(s2);
  for (Uint32 i = 0; i < size; ++i) {
    const Uint16 unit = units[i];
    if (unit >= 0x80 || unit == 0) return String::equal(s1, String(s2));
    if (unit != static_cast<unsigned char>(s2[i])) return false;
  }
  return s2[size] == '\0';
}

bool operator==(const char* s1, const String& s2) {
  return s2 == s1;
}
bool operator!=(const String& s1, const String& s2) {
  return !String::equal(s1, s2);
}
bool operator<(const String& s1, const String& s2) {
  return String::compare(s1, s2) < 0;
}
bool operator<=(const String& s1, const String& s2) {
  return String::compare(s1, s2) <= 0;
}
bool operator>(const String& s1, const String& s2) {
  return String::compare(s1, s2) > 0;
}
bool operator>=(const String& s1, const String& s2) {
  return String::compare(s1, s2) >= 0;
}

String operator+(const String& s1, const String& s2) {
  String sum;
  sum.reserveCapacity(s1.size() + s2.size());
  return sum.append(s1).append(s2);
}

std::ostream& operator<<(std::ostream& os, const String& str) {
  std::string bytes;
  for (Uint32 i = 0; i < str.size(); ++i) {
    const Uint16 unit = str[i];
    if (unit < 0x100) {
      bytes += static_cast<char>(unit);
    } else {
      char text[8];
      std::snprintf(text, sizeof text, "\\x%04X", unsigned(unit));
      bytes += text;
    }
  }
  return os << bytes;
}

PEGASUS_NAMESPACE_END
