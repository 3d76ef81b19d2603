#pragma once

#include <stddef.h>

/// Undoes the octal escapes of /proc/self/mounts (\040 for a blank; see proc(5)) in place. A
/// backslash that no three octal digits follow stays; \000 stays too, as no name holds a NUL.
void textUnescape(char* text);

/// Copies `from` as text that every CIM client can be sent: UTF-8, and only characters that XML 1.0
/// allows. Each byte that is neither becomes U+FFFD. False, with the text that fits in `to`, when
/// `size` bytes cannot hold all of it and its NUL.
int textClean(char* to, size_t size, const char* from);
