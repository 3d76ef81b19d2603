#pragma once

#include <stddef.h>

// Writing of results into the buffers that the provider hands to a plug-in function.
//
// Every `out` is such a buffer: kBufferSize bytes, owned by the provider, valid during the call.
// Whatever is written here stays inside it.

enum { kBufferSize = 1024 };

/// Text with its NUL; what does not fit is cut off between two UTF-8 characters.
void packText(void* out, const char* text);

/// One integer array item; what does not fit is left out (127 elements do).
void packIntArray(void* out, const int* values, int count);

/// A string array item that is built up step by step. Starts as {0}.
struct TextArray {
  unsigned char bytes[kBufferSize];
  size_t end;  ///< Just after the last string's NUL; 0 while the array is empty.
  int count;
};

/// Appends `length` bytes; false, and nothing changed, when they do not fit any more.
int textArrayAdd(struct TextArray* array, const char* text, size_t length);

/// The finished item.
void packTextArray(void* out, const struct TextArray* array);
