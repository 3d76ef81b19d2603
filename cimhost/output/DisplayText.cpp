#include "cimhost/output/DisplayText.h"

#include "cimhost/Text.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <iterator>

namespace cimhost {

namespace {

struct Range {
  std::int32_t first;
  std::int32_t last;
};

// C1 controls, soft hyphen, zero-width and bidirectional controls, separators, byte order mark,
// tags.
constexpr Range kUnsafe[] = {{0x7F, 0x9F},     {0xAD, 0xAD},     {0x61C, 0x61C},
                             {0x200B, 0x200F}, {0x2028, 0x202E}, {0x2060, 0x206F},
                             {0xFEFF, 0xFEFF}, {0xFFF9, 0xFFFB}, {0xE0000, 0xE007F}};

// Combining marks (the common blocks) and variation selectors.
constexpr Range kZeroWidth[] = {
    {0x300, 0x36F},   {0x483, 0x489},   {0x591, 0x5BD},   {0x610, 0x61A},   {0x64B, 0x65F},
    {0x900, 0x902},   {0xE31, 0xE31},   {0xE34, 0xE3A},   {0xE47, 0xE4E},   {0x1AB0, 0x1AFF},
    {0x1DC0, 0x1DFF}, {0x20D0, 0x20FF}, {0xFE00, 0xFE0F}, {0xFE20, 0xFE2F}, {0xE0100, 0xE01EF}};

// East Asian wide and fullwidth characters, emoji (Unicode Standard Annex 11).
constexpr Range kWide[] = {{0x1100, 0x115F},   {0x231A, 0x231B},   {0x2E80, 0x303E},
                           {0x3041, 0x33FF},   {0x3400, 0x4DBF},   {0x4E00, 0x9FFF},
                           {0xA000, 0xA4CF},   {0xA960, 0xA97F},   {0xAC00, 0xD7A3},
                           {0xF900, 0xFAFF},   {0xFE30, 0xFE6F},   {0xFF00, 0xFF60},
                           {0xFFE0, 0xFFE6},   {0x1F300, 0x1F64F}, {0x1F680, 0x1F6FF},
                           {0x1F900, 0x1F9FF}, {0x1FA70, 0x1FAFF}, {0x20000, 0x3FFFD}};

template <std::size_t Size>
bool isIn(const Range (&ranges)[Size], std::int32_t codePoint) {
  return std::any_of(std::begin(ranges), std::end(ranges), [codePoint](const Range& range) {
    return codePoint >= range.first && codePoint <= range.last;
  });
}

std::string escape(const char* format, unsigned value) {
  char buffer[16];
  std::snprintf(buffer, sizeof buffer, format, value);
  return buffer;
}

std::string escapeControl(std::int32_t codePoint) {
  if (codePoint == '\n') return "\\n";
  if (codePoint == '\t') return "\\t";
  if (codePoint == '\r') return "\\r";
  return escape(codePoint < 0x80 ? "\\x%02x" : "\\u%04x", static_cast<unsigned>(codePoint));
}

std::size_t widthOf(std::int32_t codePoint) {
  if (isIn(kZeroWidth, codePoint)) return 0;
  return isIn(kWide, codePoint) ? 2 : 1;
}

}  // namespace

std::string displayText(const std::string& text) {
  std::string result;
  for (std::size_t position = 0; position < text.size();) {
    const std::size_t start = position;
    const std::int32_t codePoint = nextCodePoint(text, position);
    if (codePoint < 0) {
      result += escape("\\x%02x", static_cast<unsigned char>(text[start]));
    } else if (codePoint < 0x20 || isIn(kUnsafe, codePoint)) {
      result += escapeControl(codePoint);
    } else {
      result.append(text, start, position - start);
    }
  }
  return result;
}

std::size_t displayWidth(const std::string& text) {
  std::size_t width = 0;
  for (std::size_t position = 0; position < text.size();) {
    width += widthOf(nextCodePoint(text, position));
  }
  return width;
}

std::string fitToWidth(const std::string& text, std::size_t width) {
  if (displayWidth(text) <= width) return text;
  std::size_t used = 1;  // The ellipsis.
  std::size_t position = 0;
  while (position < text.size()) {
    std::size_t next = position;
    used += widthOf(nextCodePoint(text, next));
    if (used > width) break;
    position = next;
  }
  return text.substr(0, position) + "\u2026";
}

}  // namespace cimhost
