/* A plug-in that answers at once: what is measured is the way to it. */
#include <stdio.h>
#include <string.h>

int benchNumber(int index);
long benchLong(int index);
int benchText(void* out, int index);
int benchTexts(void* out, int index);
int benchNumbers(void* out, int index);
int benchCount(void);
int benchManyCount(void);

int benchNumber(int index) {
  return index + 1;
}

long benchLong(int index) {
  return index + 1000000L;
}

int benchText(void* out, int index) {
  char* text = out;
  int digit;
  memcpy(text, "item 00000", 11);
  for (digit = 9; digit > 4; --digit, index /= 10) text[digit] = (char)('0' + index % 10);
  return 0;
}

static char* putWord(char* position, int word) {
  memcpy(position, &word, 4);
  return position + 4;
}

int benchTexts(void* out, int index) {
  char* position = out;
  int i;
  (void)index;
  position = putWord(putWord(position, 3), 3);
  for (i = 0; i < 3; ++i) {
    memcpy(putWord(putWord(position, 1), 5), "alpha", 6);
    position += 33 + 5;
  }
  return 0;
}

int benchNumbers(void* out, int index) {
  char* position = out;
  int i;
  position = putWord(putWord(position, 2), 4);
  for (i = 0; i < 4; ++i) position = putWord(putWord(position, 0), index + i);
  return 0;
}

int benchCount(void) {
  return 1000;
}

int benchManyCount(void) {
  return 10000;
}
