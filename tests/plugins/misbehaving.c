/* Functions that break the contract, or stand at its very edge. A buffer has 1024 bytes. */

#include <string.h>

static int putWord(char* position, int word) {
  memcpy(position, &word, sizeof word);
  return (int)sizeof word;
}

/* getSi, getAIi, getASi, setAIi, setASi, execBi: `count` bytes of 'x' from the start on */
int fill(char* buffer, int count) {
  memset(buffer, 'x', (size_t)count);
  return 0;
}

/* getSi: one byte at `offset` */
int poke(char* out, int offset) {
  out[offset] = 'x';
  return 0;
}

/* getIv, execAv: one byte too many in the extra argument's buffer */
int fillExtra(char* extra) {
  return fill(extra, 1025);
}

/* execCi */
int fillOutputs(const void* in, char* out, int count) {
  (void)in;
  return fill(out, count);
}
int fillInputs(char* in, void* out, int count) {
  (void)out;
  return fill(in, count);
}

/* getAIi, getASi: an array that says it has `count` elements; those that fit are integers 1 */
int countIntegers(char* out, int count) {
  int i;
  putWord(out, 2);
  putWord(out + 4, count);
  for (i = 1; i < 128; i++) putWord(out + 8 * i + 4, 1);
  return 0;
}
int countStrings(char* out, int count) {
  putWord(out, 3);
  putWord(out + 4, count);
  return 0;
}

/* getASi: two strings, the first of `length` bytes */
int longString(char* out, int length) {
  countStrings(out, 2);
  memset(out + 16, 'x', (size_t)length);
  return 0;
}

/* getS */
int latin1Text(char* out) {
  strcpy(out, "caf\xe9 \xff\xfe");
  return 0;
}
int formatText(char* out) {
  strcpy(out, "%n%s%s%s%100000d");
  return 0;
}

/* execC: an integer, then an item with an unknown tag */
int unknownTag(const void* in, char* out) {
  (void)in;
  out += putWord(out, 0);
  out += putWord(out, 5);
  putWord(out, 77);
  return 1;
}

/* execC: integers to the end of the buffer, and no end mark */
int noEndMark(const void* in, char* out) {
  (void)in;
  memset(out, 0, 1024);
  return 1;
}
