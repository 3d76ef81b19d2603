#pragma once

#include <string>
#include <utility>
#include <vector>

/// One value on its way between a definition, a plug-in function and the CIM side.
///
/// A plain value: a copy shares nothing with its source. No accessor checks the type code; each
/// reads its own field, which is zero or empty unless a constructor set it. Strings are bytes
/// without an assumed encoding. Throws only std::bad_alloc. Concurrent reads are safe.
class ProviderDefValue {
 public:
  /// Type codes, as getType() gives them.
  enum Type {
    kInteger = 0,
    kString = 1,
    kIntArray = 2,
    kStringArray = 3,
    kIndexString = 4,  ///< A text to which the instance index is appended.
    kBoolean = 5,
    kLong = 6
  };

  /// The empty value: integer 0.
  ProviderDefValue() = default;
  // Implicit on purpose: these are the values' own literals.
  ProviderDefValue(int value) : type_(kInteger), intValue_(value) {}
  ProviderDefValue(long value) : type_(kLong), longValue_(value) {}
  ProviderDefValue(bool value) : type_(kBoolean), boolValue_(value) {}
  ProviderDefValue(std::string value);
  /// Without it a literal would become a boolean.
  ProviderDefValue(const char* value) : ProviderDefValue(std::string(value)) {}
  ProviderDefValue(std::vector<int> values) : type_(kIntArray), intArray_(std::move(values)) {}
  ProviderDefValue(std::vector<std::string> values)
      : type_(kStringArray), stringArray_(std::move(values)) {}

  int getType() const { return type_; }
  int getIntValue() const { return intValue_; }
  /// The long of a long, else the integer field: an integer reads as a long by itself.
  long getLongValue() const { return type_ == kLong ? longValue_ : intValue_; }
  bool getBoolValue() const { return boolValue_; }

  // A temporary gives its field away; a named value shows it without a copy.
  const std::string& getStringValue() const& { return stringValue_; }
  std::string getStringValue() && { return std::move(stringValue_); }
  const std::vector<int>& getIntArray() const& { return intArray_; }
  std::vector<int> getIntArray() && { return std::move(intArray_); }
  const std::vector<std::string>& getStringArray() const& { return stringArray_; }
  std::vector<std::string> getStringArray() && { return std::move(stringArray_); }

  /// Turns a string into an index string; the text stays.
  void setIndexStringType() { type_ = kIndexString; }

  /// True for two strings, integers, integer arrays or string arrays with the same content. Index
  /// strings, booleans and longs never compare equal, not even to themselves.
  bool equal(const ProviderDefValue& other) const;

  /// True when this value is part of `other`:
  /// - two strings: unless the first occurrence in `other` is at position 0; not found is true too;
  /// - an integer, or every integer of an array, occurs in the integer array `other`;
  /// - a string occurs in the string array `other`;
  /// - an integer array is part of every string array;
  /// - anything else is false.
  bool partof(const ProviderDefValue& other) const;

  /// The mirror of partof: `a.include(b)` is `b.partof(a)`.
  bool include(const ProviderDefValue& other) const { return other.partof(*this); }

  /// Prints the object on standard output, for diagnosis; the objects that it refers to as well.
  void dump() const;

 private:
  int type_ = kInteger;
  std::string stringValue_;
  std::vector<std::string> stringArray_;
  int intValue_ = 0;
  long longValue_ = 0;
  std::vector<int> intArray_;
  bool boolValue_ = false;
};
