#include "text.h"

#include <stdint.h>
#include <string.h>

static int isContinuation(char byte) {
  return ((unsigned char)byte & 0xC0) == 0x80;
}

// The byte that \ooo stands for, or 0 when `at` starts no such escape.
static char escapedByte(const char* at) {
  unsigned value = 0;
  if (at[0] != '\\') {
    return 0;
  }
  for (int i = 1; i <= 3; ++i) {
    if (at[i] < '0' || at[i] > '7') {
      return 0;
    }
    value = value * 8 + (unsigned)(at[i] - '0');
  }
  return value <= 0xFF ? (char)value : 0;
}

void textUnescape(char* text) {
  char* to = text;
  for (const char* from = text; *from != '\0'; ++to) {
    const char byte = escapedByte(from);
    *to = byte != 0 ? byte : *from;
    from += byte != 0 ? 4 : 1;
  }
  *to = '\0';
}

// Bytes of the character that starts with `lead`; 0 when no character does.
static int sequenceLength(unsigned char lead) {
  if (lead < 0x80) return 1;
  if (lead >= 0xC2 && lead <= 0xDF) return 2;
  if (lead >= 0xE0 && lead <= 0xEF) return 3;
  if (lead >= 0xF0 && lead <= 0xF4) return 4;
  return 0;
}

// The production Char of XML 1.0, section 2.2.
static int isXmlCharacter(uint32_t code) {
  if (code < 0x20) {
    return code == '\t' || code == '\n' || code == '\r';
  }
  return code <= 0xD7FF || (code >= 0xE000 && code <= 0xFFFD) ||
         (code >= 0x10000 && code <= 0x10FFFF);
}

// Length of the valid character at `at`, 0 when there is none. RFC 3629: shortest form only.
static int characterLength(const char* at) {
  static const uint32_t smallest[] = {0, 0, 0x80, 0x800, 0x10000};
  const unsigned char lead = (unsigned char)at[0];
  const int length = sequenceLength(lead);
  uint32_t code = length > 1 ? lead & (0xFFu >> (length + 1)) : lead;
  for (int i = 1; i < length; ++i) {
    if (!isContinuation(at[i])) {
      return 0;
    }
    code = code << 6 | ((unsigned char)at[i] & 0x3F);
  }
  return length > 0 && code >= smallest[length] && isXmlCharacter(code) ? length : 0;
}

int textClean(char* to, size_t size, const char* from) {
  size_t used = 0;
  while (*from != '\0') {
    const int valid = characterLength(from);
    const char* piece = valid > 0 ? from : "\xEF\xBF\xBD";
    const size_t length = valid > 0 ? (size_t)valid : 3;
    if (length > size - 1 - used) {
      break;
    }
    memcpy(to + used, piece, length);
    used += length;
    from += valid > 0 ? valid : 1;
  }
  to[used] = '\0';
  return *from == '\0';
}
