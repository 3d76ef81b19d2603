/* A plug-in whose answers the test sets and which notes what it is given. */
#include "provider_test_plugin.h"

#include <commonprovider/plugin.h>
#include <stdio.h>
#include <string.h>

CP_FUNCTION(getI, leftCount);
CP_FUNCTION(getI, rightCount);
CP_FUNCTION(getSi, leftText);
CP_FUNCTION(getSi, rightText);
CP_FUNCTION(getIi, number);
CP_FUNCTION(getAIi, numbers);
CP_FUNCTION(getASi, texts);
CP_FUNCTION(setIi, setNumber);
CP_FUNCTION(setSi, setText);
CP_FUNCTION(setAIi, setNumbers);
CP_FUNCTION(setASi, setTexts);
CP_FUNCTION(execCi, run);

__attribute__((visibility("default"))) struct TestPluginState test_plugin_state;
#define state test_plugin_state

static void countCall(void) {
  __atomic_fetch_add(&state.calls, 1, __ATOMIC_RELAXED);
}

static int tableText(const struct TestTable* table, void* out, int index) {
  countCall();
  if (table->texts[index] == NULL) {
    memset(out, 'x', TEST_BUFFER);
    return 0;
  }
  return cp_return_string(out, table->texts[index]);
}

int leftCount(void) {
  return state.left.count;
}
int rightCount(void) {
  return state.right.count;
}
int leftText(void* out, int index) {
  return tableText(&state.left, out, index);
}
int rightText(void* out, int index) {
  return tableText(&state.right, out, index);
}

int number(int index) {
  countCall();
  return state.numbers[index];
}

int numbers(void* out, int index) {
  (void)index;
  countCall();
  return cp_return_ints(out, state.numbers, (size_t)state.numbersCount);
}

/* All texts of the left table. */
int texts(void* out, int index) {
  (void)index;
  countCall();
  return cp_return_strings(out, state.left.texts, (size_t)state.left.count);
}

static void note(const char* text) {
  strncat(state.record, text, sizeof state.record - strlen(state.record) - 1);
}

static void noteNumber(int value) {
  char text[16];
  snprintf(text, sizeof text, "%d", value);
  note(text);
}

static void noteItem(const cp_item* item);

/* Each item as a text, with blanks between. */
static void noteItems(cp_reader reader, const char* before) {
  cp_item item;
  while (cp_next(&reader, &item) == CP_OK) {
    note(before);
    noteItem(&item);
    before = " ";
  }
}

static void noteItem(const cp_item* item) {
  if (item->kind == CP_INT) {
    noteNumber(item->number);
  } else if (item->kind == CP_STRING) {
    note("'");
    note(item->text);
    note("'");
  } else {
    note("[");
    noteItems(item->elements, "");
    note("]");
  }
}

/* The one item of a set function's buffer, behind which there is no end mark. */
static void noteFirst(const void* in) {
  cp_reader reader = cp_read(in);
  cp_item item;
  if (cp_next(&reader, &item) == CP_OK) noteItem(&item);
}

static int endLine(int index) {
  note("@");
  noteNumber(index);
  note("\n");
  return 0;
}

int setNumber(int value, int index) {
  note("number ");
  noteNumber(value);
  return endLine(index);
}

int setText(const char* value, int index) {
  note("text '");
  note(value);
  note("'");
  return endLine(index);
}

int setNumbers(void* in, int index) {
  note("numbers ");
  noteFirst(in);
  return endLine(index);
}

int setTexts(void* in, int index) {
  note("texts ");
  noteFirst(in);
  return endLine(index);
}

int run(void* in, void* out, int index) {
  note("run");
  noteItems(cp_read(in), " ");
  memcpy(out, state.output, TEST_BUFFER);
  endLine(index);
  return state.result;
}
