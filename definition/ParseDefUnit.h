#pragma once

#include <string>
#include <utility>
#include <vector>

/// White space of definition texts: every byte up to and including 0x20, 0x7F to 0xA0, and 0xFF.
bool isSpace(unsigned char character);

/// One unit of definition text: a tag, or the text up to the next tag.
///
/// The format knows start tags, end tags, empty-element tags, attributes and text, and nothing
/// else: no declaration, comment, entity or CDATA section. Odd text gives odd units, never an
/// error; what reads the units decides. A unit copies what it keeps; the text may go afterwards.
class ParseDefUnit {
 public:
  enum Kind { kText = 0, kTag = 1 };
  using Attributes = std::vector<std::pair<std::string, std::string>>;

  /// The empty unit: a text without characters.
  ParseDefUnit() = default;

  /// Reads the unit at the start of `text`, of which `length` characters are left. A unit that the
  /// text's end cuts off keeps what was collected.
  ParseDefUnit(const char* text, int length);

  int getKind() const { return kind_; }
  /// A tag's element name; a text without the white space around it.
  const std::string& getName() const { return name_; }
  /// In document order, duplicates kept.
  const Attributes& getAttributes() const { return attributes_; }
  /// An opening or empty-element tag.
  bool isStart() const { return isStart_; }
  /// A closing or empty-element tag.
  bool isEnd() const { return isEnd_; }
  /// Characters consumed: a tag with its ">", a text without the "<" that ends it.
  int getLength() const { return length_; }

 private:
  friend class ElementReader;
  template <bool kTracing>
  friend class UnitScanner;

  /// Becomes the unit at the start of `text`; reuses the memory that it holds.
  void parse(const char* text, int length);

  int kind_ = kText;
  std::string name_;
  Attributes attributes_;
  bool isStart_ = false;
  bool isEnd_ = false;
  int length_ = 0;
};
