#include "cimhost/ValueArgument.h"

#include "cimhost/CimTypes.h"
#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

#include <strings.h>
#include <charconv>
#include <limits>
#include <system_error>

namespace cimhost {

using namespace Pegasus;

namespace {

constexpr std::size_t kMaximumShown = 60;

std::string quoted(const std::string& text) {
  return '"' + fitToWidth(displayText(text), kMaximumShown) + '"';
}

[[noreturn]] void fail(const std::string& text, const std::string& reason) {
  throw ValueArgumentError(quoted(text) + " is " + reason);
}

// One text as one value of a type; T is a C++ type of the CIM API.
class ElementParser {
 public:
  explicit ElementParser(const std::string& text) : text_(text) {}

  template <class T>
  T parse() const {
    if constexpr (std::is_same_v<T, Boolean>) {
      return toBoolean();
    } else if constexpr (std::is_integral_v<T>) {
      return toInteger<T>();
    } else if constexpr (std::is_floating_point_v<T>) {
      return toReal<T>();
    } else if constexpr (std::is_same_v<T, Char16>) {
      return toCharacter();
    } else if constexpr (std::is_same_v<T, String>) {
      return toText();
    } else if constexpr (std::is_same_v<T, CIMDateTime>) {
      return construct<T>("not a datetime of 25 characters, as in 20260131235959.000000+060");
    } else if constexpr (std::is_same_v<T, CIMObjectPath>) {
      return construct<T>("not an object path");
    } else {
      throw ValueArgumentError("values of this type cannot be given here");
    }
  }

 private:
  bool toBoolean() const {
    if (strcasecmp(text_.c_str(), "true") == 0) return true;
    if (strcasecmp(text_.c_str(), "false") == 0) return false;
    fail(text_, "neither true nor false");
  }

  template <class T>
  T toInteger() const {
    const bool negative = !text_.empty() && text_[0] == '-';
    std::size_t start = negative || (!text_.empty() && text_[0] == '+') ? 1 : 0;
    int base = 10;
    if (text_.compare(start, 2, "0x") == 0 || text_.compare(start, 2, "0X") == 0) {
      base = 16;
      start += 2;
    }
    std::uint64_t magnitude = 0;
    const char* const end = text_.data() + text_.size();
    const auto read = std::from_chars(text_.data() + start, end, magnitude, base);
    if (read.ec == std::errc::invalid_argument || read.ptr != end) fail(text_, "not an integer");
    using Limits = std::numeric_limits<T>;
    const std::uint64_t largest = static_cast<std::uint64_t>(Limits::max());
    const std::uint64_t limit = !negative ? largest : Limits::is_signed ? largest + 1 : 0;
    if (read.ec != std::errc() || magnitude > limit) {
      fail(text_, "out of range, " + std::to_string(Limits::min()) + " to " +
                      std::to_string(Limits::max()));
    }
    if (!negative || magnitude == 0) return static_cast<T>(magnitude);
    // The lowest value has no positive counterpart, so the sign is applied to one less.
    return static_cast<T>(-static_cast<std::int64_t>(magnitude - 1) - 1);
  }

  template <class T>
  T toReal() const {
    const std::size_t start = text_.size() > 1 && text_[0] == '+' && text_[1] != '-' ? 1 : 0;
    T number = 0;
    const char* const end = text_.data() + text_.size();
    const auto read = std::from_chars(text_.data() + start, end, number);
    if (read.ec == std::errc::invalid_argument || read.ptr != end) fail(text_, "not a number");
    if (read.ec != std::errc()) fail(text_, "out of range");
    return number;
  }

  Char16 toCharacter() const {
    const String text = toText();
    if (text.size() == 1) return text[0];
    fail(text_, "not one character of 16 bits");
  }

  String toText() const { return construct<String>("not valid UTF-8"); }

  template <class T>
  T construct(const char* otherwise) const {
    try {
      return T(fromUtf8(text_));
    } catch (const Exception&) {
      fail(text_, otherwise);
    }
  }

  const std::string& text_;
};

bool isEscape(const std::string& text, std::size_t position) {
  if (text[position] != '\\' || position + 1 == text.size()) return false;
  const char next = text[position + 1];
  return next == ',' || next == '\\' || next == '[';
}

void appendElements(const std::string& text, std::vector<std::string>& elements) {
  if (text == "[]") return;
  if (text[0] == '[') fail(text, "not a list: write a,b without brackets, or \\[ for a bracket");
  elements.emplace_back();
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == ',') {
      elements.emplace_back();
      continue;
    }
    if (isEscape(text, i)) ++i;
    elements.back() += text[i];
  }
}

template <class T>
CIMValue makeArray(const DeclaredType& declared, const std::vector<std::string>& elements) {
  if (declared.arraySize != 0 && declared.arraySize != elements.size()) {
    throw ValueArgumentError(std::to_string(declared.arraySize) + " elements expected, found " +
                             std::to_string(elements.size()));
  }
  Array<T> array;
  for (const std::string& element : elements) array.append(ElementParser(element).parse<T>());
  return CIMValue(array);
}

}  // namespace

ValueArgument splitValueArgument(const std::string& argument) {
  const std::size_t equals = argument.find('=');
  if (equals == std::string::npos) return {argument, std::nullopt};
  return {argument.substr(0, equals), argument.substr(equals + 1)};
}

std::string DeclaredType::toString() const {
  std::string text = cimTypeToString(type);
  if (isArray) text += arraySize == 0 ? "[]" : "[" + std::to_string(arraySize) + "]";
  return text;
}

CIMValue parseValue(const DeclaredType& declared,
                    const std::vector<std::optional<std::string>>& texts) {
  if (texts.size() == 1 && !texts[0]) {
    return CIMValue(declared.type, declared.isArray, declared.arraySize);
  }
  std::vector<std::string> elements;
  for (const auto& text : texts) {
    if (!text) throw ValueArgumentError("null and a value are both given");
    if (declared.isArray) appendElements(*text, elements);
  }
  if (!declared.isArray && texts.size() > 1) throw ValueArgumentError("more than one value given");
  if (!declared.isArray) elements.push_back(*texts.front());
  return parseElements(declared, elements);
}

CIMValue parseElements(const DeclaredType& declared, const std::vector<std::string>& texts) {
  if (!declared.isArray && texts.size() != 1) throw ValueArgumentError("one value expected");
  return visitCimType(declared.type, [&](auto tag) {
    using T = typename decltype(tag)::Type;
    if (declared.isArray) return makeArray<T>(declared, texts);
    return CIMValue(ElementParser(texts.front()).parse<T>());
  });
}

}  // namespace cimhost
