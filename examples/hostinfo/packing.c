#include "packing.h"

#include "text.h"

#include <stdint.h>
#include <string.h>

enum {
  kTagInt = 0,
  kTagString = 1,
  kTagIntArray = 2,
  kTagStringArray = 3,
  kHeader = 8,  // tag word and second word
  // From one string's NUL to the next element of a string array: the provider reads elements
  // 33 bytes plus the string's length apart, not end to end.
  kGapInStringArray = 24
};

static void putHeader(unsigned char* at, int32_t tag, int32_t second) {
  memcpy(at, &tag, sizeof tag);
  memcpy(at + sizeof tag, &second, sizeof second);
}

void packText(void* out, const char* text) {
  const size_t length = textFit(text, strlen(text), kBufferSize - 1);
  memcpy(out, text, length);
  ((char*)out)[length] = '\0';
}

void packIntArray(void* out, const int* values, int count) {
  const int limit = (kBufferSize - kHeader) / kHeader;
  const int fitting = count < limit ? count : limit;
  unsigned char* at = out;
  putHeader(at, kTagIntArray, fitting);
  for (int i = 0; i < fitting; ++i) {
    at += kHeader;
    putHeader(at, kTagInt, values[i]);
  }
}

int textArrayAdd(struct TextArray* array, const char* text, size_t length) {
  const size_t start = array->count == 0 ? (size_t)kHeader : array->end + kGapInStringArray;
  const size_t room = start + kHeader + 1;
  if (room > kBufferSize || length > kBufferSize - room) {
    return 0;
  }
  putHeader(array->bytes + start, kTagString, (int32_t)length);
  memcpy(array->bytes + start + kHeader, text, length);
  array->bytes[start + kHeader + length] = '\0';
  array->end = room + length;
  ++array->count;
  return 1;
}

void packTextArray(void* out, const struct TextArray* array) {
  memcpy(out, array->bytes, array->end);
  putHeader(out, kTagStringArray, array->count);
}
