#pragma once

#include "definition/ParseDefUnit.h"
#include "definition/ProviderDefXMLError.h"
#include "diagnostics/debug.h"
#include "engine/ProviderDefValue.h"

#include <string>
#include <string_view>

/// Walks over the units of a definition text: the current unit, and how far the text is consumed.
///
/// Works in place on the caller's text, which must outlive it. One reader walks a whole file: an
/// element's constructor takes it at the element's start tag and leaves it at the end tag. At the
/// text's end the current unit is the empty one, which no element accepts: every walk ends.
class ElementReader {
 public:
  /// Starts at the first unit of `text`: for an element constructor its own start tag.
  ElementReader(const char* text, int length) : text_(text), length_(length), unit_(text, length) {}

  const ParseDefUnit& unit() const { return unit_; }
  bool isStart(std::string_view name) const { return isTag(name) && unit_.isStart(); }
  bool isEnd(std::string_view name) const {
    return isTag(name) && !unit_.isStart() && unit_.isEnd();
  }
  bool isText() const { return unit_.getKind() == ParseDefUnit::kText; }
  bool isEmptyElement() const { return unit_.isStart() && unit_.isEnd(); }

  /// The text from the current unit on, and how many characters that are.
  const char* rest() const { return text_ + position_; }
  int restLength() const { return length_ - position_; }

  /// Characters up to and including the current unit.
  int consumed() const { return position_ + unit_.getLength(); }

  /// Goes on to the unit behind the current one.
  void advance();

  /// Reads the current unit once more for the trace alone: an element reads its own start tag
  /// again.
  void retrace() const {
    if (debugEnabled(9)) ParseDefUnit(rest(), restLength());
  }

  /// Throws ProviderDefXMLError with `text` and the current unit's name.
  [[noreturn]] void fail(const char* text) const { failAt(text + unit_.getName()); }

  /// Throws ProviderDefXMLError with `message`, found at the current unit.
  [[noreturn]] void failAt(const std::string& message) const;

  /// fail(text) unless the current unit is the start tag, or the closing tag, `name`.
  void expectStart(std::string_view name, const char* text) const {
    if (!isStart(name)) fail(text);
  }
  void expectEnd(std::string_view name, const char* text) const {
    if (!isEnd(name)) fail(text);
  }

  /// Goes past a start tag that has content; fail(text) on any other unit, and behind an
  /// empty-element tag, at the unit that stands where its content is missed.
  void enter(const char* text);

  /// Goes past an element that has no content: an empty-element tag, or a start tag and its end
  /// tag.
  void skipEmpty(std::string_view name, const char* text);

  /// Where in the text the last error of this thread was found; nullptr before the first.
  static const char* lastErrorPosition();

 private:
  bool isTag(std::string_view name) const {
    return unit_.getKind() == ParseDefUnit::kTag && unit_.getName() == name;
  }

  const char* text_;
  int length_;
  int position_ = 0;
  ParseDefUnit unit_;
};

/// Counts the calls and conditions that stand inside each other; more than 500 is an error, so that
/// no text can exhaust the stack.
class NestingGuard {
 public:
  static constexpr int kMaxDepth = 500;

  explicit NestingGuard(const ElementReader& reader);
  ~NestingGuard();
  NestingGuard(const NestingGuard&) = delete;
  NestingGuard& operator=(const NestingGuard&) = delete;
};

/// Reads the `constant` element that is the current unit and goes past it.
///
/// Its type decides: "int" (decimal, up to the first other character, within the range of int),
/// "string", "indexstring", "boolean" (true for exactly "true"). Any other type gives the empty
/// value.
ProviderDefValue readConstant(ElementReader& reader);

/// The value of the attribute `name` of the current unit, the last one of that name; "" without it.
std::string attribute(const ElementReader& reader, std::string_view name);

/// The number that `text` begins with, base 10; 0 without one; within the range of int.
int decimalInteger(const std::string& text);
