#pragma once

#include <stddef.h>
#include <stdint.h>
#include <stdio.h>

// Reading of small kernel files. Paths start with /proc or /sys; the environment variable
// HOSTINFO_ROOT, where it is set, goes before them.

enum { kPathSize = 4608 };

/// The path to open for `path`; false when it does not fit.
int hostPath(char to[kPathSize], const char* path);

/// Opens a file for reading; NULL when that fails.
FILE* hostOpen(const char* path);

/// Reads one line without its newline. A line that does not fit is passed over as a whole. False at
/// the end of the file; a last line without a newline is unfinished and does not count.
int hostReadLine(FILE* file, char* line, size_t size);

/// The first line of a file as clean text (see textClean), cut to fit; "" when there is none.
void hostReadText(const char* path, char* to, size_t size);

/// The number at the start of a file, decimal or with 0x hexadecimal; false, and 0, without one. A
/// number out of range becomes the nearest one in it.
int hostReadNumber(const char* path, int64_t* value);

/// `value`, or the largest int where it does not fit.
int saturateToInt(uint64_t value);
