/* A plug-in whose answers the test sets and which notes what it is given. */
#include "provider_test_plugin.h"

#include <stdio.h>
#include <string.h>

#define EXPORTED __attribute__((visibility("default")))

EXPORTED struct TestPluginState test_plugin_state;
#define state test_plugin_state

static void countCall(void) { __atomic_fetch_add(&state.calls, 1, __ATOMIC_RELAXED); }

static void putWord(char* at, int word) { memcpy(at, &word, sizeof word); }

static int getWord(const char* at) {
  int word;
  memcpy(&word, at, sizeof word);
  return word;
}

static void tableText(const struct TestTable* table, void* out, int index) {
  countCall();
  if (table->texts[index] == NULL) {
    memset(out, 'x', TEST_BUFFER);
  } else {
    strcpy((char*)out, table->texts[index]);
  }
}

EXPORTED int leftCount(void) { return state.left.count; }
EXPORTED int rightCount(void) { return state.right.count; }
EXPORTED void leftText(void* out, int index) { tableText(&state.left, out, index); }
EXPORTED void rightText(void* out, int index) { tableText(&state.right, out, index); }

EXPORTED int number(int index) {
  countCall();
  return state.numbers[index];
}

EXPORTED long wide(int index) {
  (void)index;
  countCall();
  return state.wide;
}

EXPORTED void numbers(void* out, int index) {
  char* at = (char*)out;
  int i;
  (void)index;
  countCall();
  putWord(at, 2);
  putWord(at + 4, state.numbersCount);
  for (i = 0; i < state.numbersCount; ++i) {
    putWord(at + 8 + 8 * i, 0);
    putWord(at + 12 + 8 * i, state.numbers[i]);
  }
}

/* All texts of the left table. Behind each string's NUL lie 24 bytes. */
EXPORTED void texts(void* out, int index) {
  char* at = (char*)out + 8;
  int i;
  (void)index;
  countCall();
  putWord((char*)out, 3);
  putWord((char*)out + 4, state.left.count);
  for (i = 0; i < state.left.count; ++i) {
    const size_t length = strlen(state.left.texts[i]);
    putWord(at, 1);
    putWord(at + 4, (int)length);
    strcpy(at + 8, state.left.texts[i]);
    at += 33 + length;
  }
}

static void note(const char* text) {
  strncat(state.record, text, sizeof state.record - strlen(state.record) - 1);
}

static void noteNumber(int value) {
  char text[16];
  snprintf(text, sizeof text, "%d", value);
  note(text);
}

/* Writes an item as a text and gives the position of the next one. */
static const char* noteItem(const char* item) {
  const int tag = getWord(item);
  const int word = getWord(item + 4);
  int i;
  const char* at = item + 8;
  switch (tag) {
    case 0:
      noteNumber(word);
      return at;
    case 1:
      note("'");
      note(at);
      note("'");
      return at + word + 1;
    default:
      note("[");
      for (i = 0; i < word; ++i) {
        if (i != 0) note(" ");
        at = noteItem(at);
      }
      note("]");
      return at;
  }
}

static int endLine(int index) {
  note("@");
  noteNumber(index);
  note("\n");
  return 0;
}

EXPORTED int setNumber(int value, int index) {
  note("number ");
  noteNumber(value);
  return endLine(index);
}

EXPORTED int setText(const char* value, int index) {
  note("text '");
  note(value);
  note("'");
  return endLine(index);
}

EXPORTED int setNumbers(void* in, int index) {
  note("numbers ");
  noteItem((const char*)in);
  return endLine(index);
}

EXPORTED int setTexts(void* in, int index) {
  note("texts ");
  noteItem((const char*)in);
  return endLine(index);
}

EXPORTED int run(void* in, void* out, int index) {
  const char* at = (const char*)in;
  note("run");
  while (getWord(at) != 99) {
    note(" ");
    at = noteItem(at);
  }
  memcpy(out, state.output, TEST_BUFFER);
  endLine(index);
  return state.result;
}
