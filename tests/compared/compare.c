/* Instances whose values do not depend on the host, and places for what clients set: files in
   ../logs, so that one process reads what another was told. */
#include <commonprovider/plugin.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

CP_FUNCTION(getI, elementCount);
CP_FUNCTION(getSi, elementName);
CP_FUNCTION(getIi, elementNumber);
CP_FUNCTION(getIi, elementValue);
CP_FUNCTION(getLi, elementLong);
CP_FUNCTION(getIi, elementLetter);
CP_FUNCTION(getSi, elementTime);
CP_FUNCTION(getAIi, elementNumbers);
CP_FUNCTION(getASi, elementTexts);
CP_FUNCTION(getASi, elementTimes);
CP_FUNCTION(getI, partCount);
CP_FUNCTION(getSi, partName);
CP_FUNCTION(getSi, partOwner);
CP_FUNCTION(getSi, partBroken);
CP_FUNCTION(getIv, storedNumber);
CP_FUNCTION(setIv, storeNumber);
CP_FUNCTION(getSv, storedText);
CP_FUNCTION(setSv, storeText);
CP_FUNCTION(getAIv, storedNumbers);
CP_FUNCTION(setAIv, storeNumbers);
CP_FUNCTION(getASv, storedTexts);
CP_FUNCTION(setASv, storeTexts);
CP_FUNCTION(execC, echo);
CP_FUNCTION(execCi, whichElement);
CP_FUNCTION(execA, die);

enum { kElements = 4, kParts = 6, kMax = 64 };

/* Blanks, path characters, XML characters, quotes, and text beyond ASCII. */
static const char* const kNames[kElements] = {"plain", "a b,c=d.e:f", "<&>'\"\\",
                                              "\xC3\xA4\xE2\x82\xAC"};

int elementCount(void) {
  return kElements;
}

int elementName(void* out, int index) {
  return cp_return_string(out, kNames[index % kElements]);
}

int elementNumber(int index) {
  return index + 1;
}

int elementValue(int index) {
  static const int values[kElements] = {0, 1, -1, 1234567};
  return values[index % kElements];
}

long elementLong(int index) {
  return elementValue(index);
}

int elementLetter(int index) {
  static const int letters[kElements] = {'A', 0xE4, 0x20AC, '~'};
  return letters[index % kElements];
}

int elementTime(void* out, int index) {
  return cp_return_string(
      out, index % 2 == 0 ? "20260131120000.123456+060" : "00000001020304.000005:000");
}

int elementNumbers(void* out, int index) {
  static const int numbers[] = {1, 65, -3, 300, 70000};
  return cp_return_ints(out, numbers, (size_t)index);
}

int elementTexts(void* out, int index) {
  static const char* const texts[] = {"one", "", "<two> & \"three\"", "\xC3\xA4"};
  return cp_return_strings(out, texts, (size_t)index);
}

int elementTimes(void* out, int index) {
  static const char* const times[] = {"20260131120000.123456+060", "00000001020304.000005:000",
                                      "20260131******.******-300"};
  return cp_return_strings(out, times, (size_t)index);
}

int partCount(void) {
  return kParts;
}

int partName(void* out, int index) {
  char name[32];
  snprintf(name, sizeof name, "part %d", index);
  return cp_return_string(out, name);
}

int partOwner(void* out, int index) {
  return cp_return_string(out, kNames[index / 2]);
}

/* Every other text is no UTF-8: these instances cannot be delivered. */
int partBroken(void* out, int index) {
  return cp_return_string(out, index % 2 == 0 ? "fine" : "bro\xFFken");
}

/* The list that comes with a value: the position, and the name of the place. */
static FILE* open_place(const void* arg, const char* mode) {
  cp_reader reader = cp_read(arg);
  const char* name = "";
  char file[256];
  int index = 0;
  if (cp_next_int(&reader, &index) != CP_OK || cp_next_string(&reader, &name) != CP_OK) {
    return NULL;
  }
  snprintf(file, sizeof file, "../logs/%s.%d", name, index);
  return fopen(file, mode);
}

/* Up to `capacity` lines, in `text` one after the other. */
static size_t read_lines(void* arg, char* text, size_t size, const char** lines, size_t capacity) {
  FILE* file = open_place(arg, "r");
  size_t count = 0;
  if (file == NULL) return 0;
  while (count < capacity && size > 1 && fgets(text, (int)size, file) != NULL) {
    const size_t length = strcspn(text, "\n");
    text[length] = '\0';
    lines[count++] = text;
    text += length + 1;
    size -= length + 1;
  }
  fclose(file);
  return count;
}

int storedNumber(void* arg) {
  char text[CP_BUFFER_SIZE];
  const char* line = "-1";
  read_lines(arg, text, sizeof text, &line, 1);
  return atoi(line);
}

int storedText(void* out, void* arg) {
  char text[CP_BUFFER_SIZE];
  const char* line = "20260131120000.123456+060";
  read_lines(arg, text, sizeof text, &line, 1);
  return cp_return_string(out, line);
}

int storedNumbers(void* out, void* arg) {
  char text[CP_BUFFER_SIZE];
  const char* lines[kMax];
  int numbers[kMax];
  const size_t count = read_lines(arg, text, sizeof text, lines, kMax);
  size_t i;
  for (i = 0; i < count; ++i) numbers[i] = atoi(lines[i]);
  return cp_return_ints(out, numbers, count);
}

int storedTexts(void* out, void* arg) {
  char text[CP_BUFFER_SIZE];
  const char* lines[kMax];
  const size_t count = read_lines(arg, text, sizeof text, lines, kMax);
  return cp_return_strings(out, lines, count);
}

int storeNumber(int value, void* arg) {
  char text[16];
  snprintf(text, sizeof text, "%d", value);
  return storeText(text, arg);
}

int storeText(const char* value, void* arg) {
  FILE* file = open_place(arg, "w");
  if (file == NULL) return 1;
  fprintf(file, "%s\n", value);
  return fclose(file);
}

static int store_elements(void* in, void* arg) {
  FILE* file = open_place(arg, "w");
  cp_reader reader = cp_read(in);
  cp_item array;
  cp_item element;
  if (file == NULL) return 1;
  if (cp_next(&reader, &array) != CP_OK) return fclose(file);
  while (cp_next(&array.elements, &element) == CP_OK) {
    if (element.kind == CP_INT) {
      fprintf(file, "%d\n", element.number);
    } else {
      fprintf(file, "%s\n", element.text);
    }
  }
  return fclose(file);
}

int storeNumbers(void* in, void* arg) {
  return store_elements(in, arg);
}

int storeTexts(void* in, void* arg) {
  return store_elements(in, arg);
}

static int copy_item(cp_writer* to, cp_item* item) {
  cp_item element;
  int status;
  if (item->kind == CP_INT) return cp_put_int(to, item->number);
  if (item->kind == CP_STRING) return cp_put_string(to, item->text);
  status = item->kind == CP_INT_ARRAY ? cp_begin_ints(to) : cp_begin_strings(to);
  while (status == CP_OK && cp_next(&item->elements, &element) == CP_OK) {
    status =
        element.kind == CP_INT ? cp_add_int(to, element.number) : cp_add_string(to, element.text);
  }
  return status;
}

/* What comes in goes out, in the same order; the result is how much that was. */
int echo(void* in, void* out) {
  cp_reader inputs = cp_read(in);
  cp_writer outputs = cp_write_list(out);
  cp_item item;
  int count = 0;
  while (cp_next(&inputs, &item) == CP_OK && copy_item(&outputs, &item) == CP_OK) ++count;
  return cp_finish(&outputs) == CP_OK ? count : -1;
}

int whichElement(void* in, void* out, int index) {
  cp_writer outputs = cp_write_list(out);
  (void)in;
  cp_put_int(&outputs, index);
  cp_put_string(&outputs, index < kElements ? kNames[index] : "none");
  return cp_finish(&outputs);
}

/* A plug-in that takes its process along. */
int die(void) {
  abort();
}
