#include "platform/StringConverters.h"

namespace Vaneth {
namespace {

constexpr unsigned long kReplacement = 0xFFFD;

void appendUtf8(std::string& out, unsigned long code) {
  if (code > 0x10FFFF) code = kReplacement;
  const auto put = [&out](unsigned long byte) { out.push_back(static_cast<char>(byte)); };
  if (code < 0x80) {
    put(code);
  } else if (code < 0x800) {
    put(0xC0 | (code >> 6));
    put(0x80 | (code & 0x3F));
  } else if (code < 0x10000) {
    put(0xE0 | (code >> 12));
    put(0x80 | ((code >> 6) & 0x3F));
    put(0x80 | (code & 0x3F));
  } else {
    put(0xF0 | (code >> 18));
    put(0x80 | ((code >> 12) & 0x3F));
    put(0x80 | ((code >> 6) & 0x3F));
    put(0x80 | (code & 0x3F));
  }
}

// How many bytes the sequence that starts with `lead` has; 0 for a byte that starts none.
size_t sequenceLength(unsigned char lead) {
  if (lead < 0x80) return 1;
  if (lead >= 0xC2 && lead < 0xE0) return 2;
  if (lead >= 0xE0 && lead < 0xF0) return 3;
  if (lead >= 0xF0 && lead < 0xF5) return 4;
  return 0;
}

// Decodes the sequence at `position` and moves past it; false when it is not valid UTF-8.
bool decodeUtf8(const std::string& text, size_t& position, unsigned long& code) {
  const unsigned char lead = static_cast<unsigned char>(text[position]);
  const size_t length = sequenceLength(lead);
  if (length == 0 || text.size() - position < length) return false;
  static const unsigned char kLeadMask[] = {0, 0x7F, 0x1F, 0x0F, 0x07};
  static const unsigned long kSmallest[] = {0, 0, 0x80, 0x800, 0x10000};
  code = lead & kLeadMask[length];
  for (size_t i = 1; i < length; ++i) {
    const unsigned char next = static_cast<unsigned char>(text[position + i]);
    if ((next & 0xC0) != 0x80) return false;
    code = (code << 6) | (next & 0x3Fu);
  }
  position += length;
  return code >= kSmallest[length] && code <= 0x10FFFF;
}

}  // namespace

std::wstring make_wstring(const std::string& text) {
  std::wstring wide;
  wide.reserve(text.size());
  unsigned long code = 0;
  for (size_t position = 0; position < text.size();) {
    if (!decodeUtf8(text, position, code)) {
      wide.clear();
      for (const char c : text) wide.push_back(static_cast<unsigned char>(c));
      return wide;
    }
    wide.push_back(static_cast<wchar_t>(code));
  }
  return wide;
}

std::string make_string(const std::wstring& text) {
  std::string narrow;
  narrow.reserve(text.size());
  for (const wchar_t c : text) appendUtf8(narrow, static_cast<unsigned long>(c));
  return narrow;
}

std::string make_string(const Pegasus::String& text) {
  const Pegasus::Uint32 size = text.size();
  const Pegasus::Char16* units = text.getChar16Data();
  std::string narrow;
  narrow.reserve(size);
  for (Pegasus::Uint32 i = 0; i < size; ++i) {
    unsigned long code = Pegasus::Uint16(units[i]);
    if (code >= 0xD800 && code < 0xDC00 && i + 1 < size) {
      const unsigned long low = Pegasus::Uint16(units[i + 1]);
      if (low >= 0xDC00 && low < 0xE000) {
        code = 0x10000 + ((code - 0xD800) << 10) + (low - 0xDC00);
        ++i;
      }
    }
    appendUtf8(narrow, code);
  }
  return narrow;
}

Pegasus::String make_String(const std::string& text) {
  return Pegasus::String(text.data(), static_cast<Pegasus::Uint32>(text.size()));
}

}  // namespace Vaneth
