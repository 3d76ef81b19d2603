#include "cimhost/mof/MofValue.h"

#include "cimhost/CimTypes.h"
#include "cimhost/Text.h"
#include "cimhost/mof/Printable.h"

#include <limits>
#include <type_traits>

namespace cimhost {
namespace {

using Pegasus::CIMType;
using Pegasus::CIMValue;
using Kind = MofLiteral::Kind;

const char* describe(Kind kind) {
  switch (kind) {
    case Kind::null:
      return "null";
    case Kind::boolean:
      return "a boolean";
    case Kind::integer:
      return "an integer";
    case Kind::real:
      return "a real";
    case Kind::character:
      return "a character";
    case Kind::string:
      return "a string";
    case Kind::alias:
      return "an alias";
  }
  return "?";
}

/// Converts single constants; see makeMofValue.
class LiteralConverter {
 public:
  LiteralConverter(const MofSource& source, const MofLiteral& literal, CIMType type)
      : source_(source), literal_(literal), type_(type) {}

  template <class T>
  T convert() const {
    if constexpr (std::is_same_v<T, bool>) {
      require(Kind::boolean);
      return literal_.boolean;
    } else if constexpr (std::is_integral_v<T>) {
      return toInteger<T>();
    } else if constexpr (std::is_floating_point_v<T>) {
      return toReal<T>();
    } else if constexpr (std::is_same_v<T, Pegasus::Char16>) {
      require(Kind::character);
      return Pegasus::Char16(literal_.unit);
    } else if constexpr (std::is_same_v<T, Pegasus::String>) {
      require(Kind::string);
      return fromUtf8(literal_.text);
    } else if constexpr (std::is_same_v<T, Pegasus::CIMDateTime> ||
                         std::is_same_v<T, Pegasus::CIMObjectPath>) {
      return parse<T>();
    } else {
      fail("a value of this type cannot be written");
    }
  }

 private:
  [[noreturn]] void fail(const std::string& message) const {
    throw MofError(source_, literal_.offset, message);
  }

  [[noreturn]] void failKind() const {
    fail(std::string("expected a ") + cimTypeToString(type_) + " value, found " +
         describe(literal_.kind));
  }

  [[noreturn]] void failRange() const {
    fail(std::string("the value is out of range for ") + cimTypeToString(type_));
  }

  void require(Kind kind) const {
    if (literal_.kind != kind) failKind();
  }

  template <class T>
  T toInteger() const {
    require(Kind::integer);
    using Limits = std::numeric_limits<T>;
    const auto largest = static_cast<std::uint64_t>(Limits::max());
    const std::uint64_t magnitude = literal_.magnitude;
    if (!literal_.negative) {
      if (magnitude > largest) failRange();
      return static_cast<T>(magnitude);
    }
    const std::uint64_t lowest = Limits::is_signed ? largest + 1 : 0;
    if (magnitude > lowest) failRange();
    // The lowest value has no positive counterpart, so the sign is applied to one less.
    if (magnitude == 0) return 0;
    return static_cast<T>(-static_cast<std::int64_t>(magnitude - 1) - 1);
  }

  template <class T>
  T toReal() const {
    if (literal_.kind != Kind::integer) require(Kind::real);
    double value = literal_.real;
    if (literal_.kind == Kind::integer) {
      value = static_cast<double>(literal_.magnitude);
      if (literal_.negative) value = -value;
    }
    constexpr auto largest = static_cast<double>(std::numeric_limits<T>::max());
    if (value > largest || value < -largest) failRange();
    return static_cast<T>(value);
  }

  template <class T>
  T parse() const {
    require(Kind::string);
    try {
      return T(fromUtf8(literal_.text));
    } catch (const Pegasus::Exception&) {
      const bool isDateTime = std::is_same_v<T, Pegasus::CIMDateTime>;
      fail('"' + shortened(literal_.text, 60) +
           (isDateTime ? "\" is not a datetime" : "\" is not an object path"));
    }
  }

  const MofSource& source_;
  const MofLiteral& literal_;
  CIMType type_;
};

template <class T>
CIMValue makeArray(const MofSource& source, const MofInitializer& initializer, CIMType type) {
  Pegasus::Array<T> elements;
  elements.reserveCapacity(static_cast<Pegasus::Uint32>(initializer.literals.size()));
  for (const MofLiteral& literal : initializer.literals) {
    elements.append(LiteralConverter(source, literal, type).convert<T>());
  }
  return CIMValue(elements);
}

void checkShape(const MofSource& source, const MofInitializer& initializer,
                const MofElement& element) {
  const std::size_t count = initializer.literals.size();
  if (element.isArray != initializer.isArray) {
    throw MofError(source, initializer.offset,
                   element.isArray ? "expected a list of values in braces"
                                   : "expected one value, found a list");
  }
  if (element.arraySize != 0 && element.arraySize != count) {
    throw MofError(source, initializer.offset,
                   "expected " + std::to_string(element.arraySize) + " values, found " +
                       std::to_string(count));
  }
}

}  // namespace

CIMValue makeMofValue(const MofSource& source, const MofInitializer& initializer,
                      const MofElement& element) {
  if (!initializer.isArray && initializer.literals.front().kind == Kind::null) {
    return makeNullValue(element);
  }
  checkShape(source, initializer, element);
  return visitCimType(element.type, [&](auto tag) {
    using T = typename decltype(tag)::Type;
    if (element.isArray) return makeArray<T>(source, initializer, element.type);
    return CIMValue(
        LiteralConverter(source, initializer.literals.front(), element.type).convert<T>());
  });
}

CIMValue makeNullValue(const MofElement& element) {
  return CIMValue(element.type, element.isArray, element.arraySize);
}

Pegasus::CIMName toCimName(const MofName& name) {
  return Pegasus::CIMName(fromUtf8(name.text));
}

}  // namespace cimhost
