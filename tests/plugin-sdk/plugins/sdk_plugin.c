/* Functions written with the header alone. Also compiled as C++, as the library sdk_cpp. */

#include <commonprovider/plugin.h>

CP_FUNCTION(execC, echo);
CP_FUNCTION(execC, echoWhole);
CP_FUNCTION(execBw, nextOf);
CP_FUNCTION(getAIv, kindsOf);
CP_FUNCTION(getSi, textOf);
CP_FUNCTION(getAIi, intsOf);
CP_FUNCTION(getASi, stringsOf);
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

/* What cp_next_... of the first item says: `kind` is a letter, i, s, I or S; "t" asks for ints into
   an array of two. A refused item must still be there: 100 is added where it is not. */
int nextOf(void* in, const char* kind) {
  cp_reader reader = cp_read(in);
  cp_item item;
  const char* text = "";
  int numbers[2];
  size_t count = 0;
  int status;
  switch (kind[0]) {
    case 'i':
      status = cp_next_int(&reader, numbers);
      break;
    case 's':
      status = cp_next_string(&reader, &text);
      break;
    case 't':
      status = cp_next_ints(&reader, numbers, 2, &count);
      break;
    default:
      status = cp_next_of(&reader, kind[0] == 'I' ? CP_INT_ARRAY : CP_STRING_ARRAY, &item);
      break;
  }
  return status + (status != CP_OK && reader.at != (const char*)in ? 100 : 0);
}

/* The kinds of the first four items of a list without an end mark. */
int kindsOf(void* out, void* arg) {
  cp_reader reader = cp_read(arg);
  cp_writer writer = cp_write_ints(out);
  cp_item item;
  int i;
  for (i = 0; i < 4 && cp_next(&reader, &item) == CP_OK; ++i) cp_add_int(&writer, item.kind);
  return 0;
}

/* `length` bytes */
int textOf(void* out, int length) {
  char text[2 * CP_BUFFER_SIZE];
  memset(text, 'x', (size_t)length);
  text[length] = '\0';
  return cp_return_string(out, text);
}

/* `count` zeros */
int intsOf(void* out, int count) {
  static int zeros[2 * CP_BUFFER_SIZE];
  return cp_return_ints(out, zeros, (size_t)count);
}

/* Two strings, of `length` bytes and of none. */
int stringsOf(void* out, int length) {
  char text[2 * CP_BUFFER_SIZE];
  const char* texts[2];
  memset(text, 'x', (size_t)length);
  text[length] = '\0';
  texts[0] = text;
  texts[1] = text + length;
  return cp_return_strings(out, texts, 2);
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
