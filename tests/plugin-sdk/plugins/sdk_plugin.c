/* Functions written with the header alone. Also compiled as C++, as the library sdk_cpp. */

#include <commonprovider/plugin.h>

CP_FUNCTION(execC, echo);
CP_FUNCTION(execC, echoWhole);
CP_FUNCTION(getASv, echoStrings);

static void echoElements(cp_reader elements, cp_writer* writer) {
  cp_item item;
  while (cp_next(&elements, &item) == CP_OK) {
    if (item.kind == CP_INT) {
      cp_add_int(writer, item.number);
    } else {
      cp_add_string(writer, item.text);
    }
  }
}

/* Every item goes back, arrays element by element. */
int echo(void* in, void* out) {
  cp_reader reader = cp_read(in);
  cp_writer writer = cp_write_list(out);
  cp_item item;
  int status;
  while ((status = cp_next(&reader, &item)) == CP_OK) {
    if (item.kind == CP_INT) {
      cp_put_int(&writer, item.number);
    } else if (item.kind == CP_STRING) {
      cp_put_string(&writer, item.text);
    } else {
      if (item.kind == CP_INT_ARRAY) {
        cp_begin_ints(&writer);
      } else {
        cp_begin_strings(&writer);
      }
      echoElements(item.elements, &writer);
    }
  }
  return status == CP_END ? cp_finish(&writer) : status;
}

/* The same, arrays at once. */
int echoWhole(void* in, void* out) {
  cp_reader reader = cp_read(in);
  cp_writer writer = cp_write_list(out);
  cp_item item;
  const char* text;
  int number;
  for (;;) {
    if (cp_next_int(&reader, &number) == CP_OK) {
      cp_put_int(&writer, number);
    } else if (cp_next_string(&reader, &text) == CP_OK) {
      cp_put_string(&writer, text);
    } else if (cp_next_of(&reader, CP_STRING_ARRAY, &item) == CP_OK) {
      const char* texts[CP_BUFFER_SIZE];
      size_t i;
      for (i = 0; cp_next_string(&item.elements, &texts[i]) == CP_OK; ++i) {
      }
      cp_put_strings(&writer, texts, i);
    } else {
      int numbers[CP_MAX_INTS];
      size_t count;
      const int status = cp_next_ints(&reader, numbers, CP_MAX_INTS, &count);
      if (status == CP_END) return cp_finish(&writer);
      if (status != CP_OK) return status;
      cp_put_ints(&writer, numbers, count);
    }
  }
}

/* Leaves out what does not fit. */
int echoStrings(void* out, void* arg) {
  cp_reader reader = cp_read(arg);
  cp_writer writer = cp_write_strings(out);
  cp_item item;
  if (cp_next_of(&reader, CP_STRING_ARRAY, &item) != CP_OK) return 1;
  echoElements(item.elements, &writer);
  return cp_finish(&writer);
}
