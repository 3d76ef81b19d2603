#include "hostfiles.h"

#include "text.h"

#include <limits.h>
#include <stdlib.h>
#include <string.h>

int hostPath(char to[kPathSize], const char* path) {
  const char* root = getenv("HOSTINFO_ROOT");
  const int length = snprintf(to, kPathSize, "%s%s", root != NULL ? root : "", path);
  return length > 0 && length < kPathSize;
}

FILE* hostOpen(const char* path) {
  char full[kPathSize];
  return hostPath(full, path) ? fopen(full, "re") : NULL;
}

int hostReadLine(FILE* file, char* line, size_t size) {
  size_t length = 0;
  for (int byte = getc(file); byte != EOF; byte = getc(file)) {
    if (byte == '\n' && length < size) {
      line[length] = '\0';
      return 1;
    }
    if (length < size) {
      line[length] = (char)byte;
    }
    length = byte == '\n' ? 0 : length + 1;
  }
  return 0;
}

void hostReadText(const char* path, char* to, size_t size) {
  char line[256] = "";
  FILE* file = hostOpen(path);
  if (file != NULL) {
    line[fread(line, 1, sizeof line - 1, file)] = '\0';
    fclose(file);
  }
  line[strcspn(line, "\n")] = '\0';
  textClean(to, size, line);
}

int hostReadNumber(const char* path, int64_t* value) {
  char text[64];
  char* end = text;
  hostReadText(path, text, sizeof text);
  *value = strtoll(text, &end, strncmp(text, "0x", 2) == 0 ? 16 : 10);
  return end != text;
}

int saturateToInt(uint64_t value) {
  return value > INT_MAX ? INT_MAX : (int)value;
}
