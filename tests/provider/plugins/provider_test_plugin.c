/* A plug-in whose answers the test sets and which notes what it is given. */
#include "provider_test_plugin.h"

#include <commonprovider/plugin.h>
#include <stdarg.h>
#include <stdio.h>
#include <string.h>

CP_FUNCTION(getI, leftCount);
CP_FUNCTION(getI, rightCount);
CP_FUNCTION(getSi, leftText);
CP_FUNCTION(getSi, rightText);
CP_FUNCTION(getIi, number);
CP_FUNCTION(getAIi, numbers);
CP_FUNCTION(setIi, setNumber);
CP_FUNCTION(setSi, setText);
CP_FUNCTION(setAIi, setNumbers);
CP_FUNCTION(setASi, setTexts);
CP_FUNCTION(execCi, run);

__attribute__((visibility("default"))) struct TestPluginState test_plugin_state;
#define state test_plugin_state

static int tableText(const struct TestTable* table, void* out, int index) {
  ++state.calls;
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
  return state.numbers[index];
}

int numbers(void* out, int index) {
  return cp_return_ints(out, state.numbers, (size_t)index + 2);
}

/* Appends to the record, as printf does. */
__attribute__((format(printf, 1, 2))) static void note(const char* format, ...) {
  const size_t used = strlen(state.record);
  va_list values;
  va_start(values, format);
  vsnprintf(state.record + used, sizeof state.record - used, format, values);
  va_end(values);
}

static void noteItem(const cp_item* item);

/* Each item as a text, with blanks between. */
static void noteItems(cp_reader reader, const char* before) {
  cp_item item;
  while (cp_next(&reader, &item) == CP_OK) {
    note("%s", before);
    noteItem(&item);
    before = " ";
  }
}

static void noteItem(const cp_item* item) {
  if (item->kind == CP_INT) {
    note("%d", item->number);
  } else if (item->kind == CP_STRING) {
    note("'%s'", item->text);
  } else {
    note("[");
    noteItems(item->elements, "");
    note("]");
  }
}

int setNumber(int value, int index) {
  note("number %d@%d\n", value, index);
  return 0;
}

int setText(const char* value, int index) {
  note("text '%s'@%d\n", value, index);
  return 0;
}

/* The one item of the buffer, behind which there is no end mark. */
static int setItem(const char* name, const void* in, int index) {
  cp_reader reader = cp_read(in);
  cp_item item;
  note("%s ", name);
  if (cp_next(&reader, &item) == CP_OK) noteItem(&item);
  note("@%d\n", index);
  return 0;
}

int setNumbers(void* in, int index) {
  return setItem("numbers", in, index);
}

int setTexts(void* in, int index) {
  return setItem("texts", in, index);
}

int run(void* in, void* out, int index) {
  note("run");
  noteItems(cp_read(in), " ");
  note("@%d\n", index);
  memcpy(out, state.output, TEST_BUFFER);
  return state.result;
}
