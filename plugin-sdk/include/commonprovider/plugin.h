#ifndef COMMONPROVIDER_PLUGIN_H
#define COMMONPROVIDER_PLUGIN_H

// What a plug-in of CommonProvider needs, in one header for C99 and C++11; there is no library.
//
//   CP_FUNCTION   declares and exports a plug-in function, checked against its calling type
//   cp_read ...   reads the buffers that come in: `in` and `arg`
//   cp_return ... writes the result of a getS, getAI or getAS function to `out`
//   cp_write ...  writes such an array, or the list of an execC function, step by step
//
// Nothing here reads or writes outside a buffer's 1024 bytes, allocates, or keeps state: a reader
// or a writer is a plain value that its caller owns, and is valid during the call whose buffer it
// was made for. Functions that can fail return a cp_status.
//
// What is read and what is written lie differently. The strings of an array that comes in lie end
// to end; of one that goes out they start 33 bytes plus the string's length apart. docs/plugins.md
// shows both as bytes.

#include <stddef.h>
#include <stdint.h>
#include <string.h>

#ifdef __cplusplus
#define CP_C_LINKAGE extern "C"
extern "C" {
#else
#define CP_C_LINKAGE extern
#endif

enum {
  CP_BUFFER_SIZE = 1024,  ///< Bytes in each of `in`, `out` and `arg`.
  CP_MAX_STRING = 1023,   ///< Bytes of a getS text, without its NUL.
  CP_MAX_INTS = 127,      ///< Elements of an int array that fills a buffer.
  CP_HEADER_SIZE = 8,     ///< Tag and second word of an item; an int item as a whole.
  CP_END_MARK_SIZE = 4,   ///< The end mark of a list.
  CP_STRING_GAP = 24      ///< Bytes behind each string of an array that goes out.
};

/// The tags of items.
enum cp_kind { CP_INT = 0, CP_STRING = 1, CP_INT_ARRAY = 2, CP_STRING_ARRAY = 3, CP_LIST_END = 99 };

enum cp_status {
  CP_OK = 0,
  CP_END = 1,         ///< There is no further item.
  CP_WRONG_KIND = 2,  ///< The next item, or the open array, is of another kind.
  CP_BAD_BUFFER = 3,  ///< The bytes are no item, or it does not end within the buffer.
  CP_NO_SPACE = 4     ///< What is to be written does not fit any more.
};

// --- The 48 function types -----------------------------------------------------------------------

typedef int cp_setI_fn(int value);
typedef int cp_setIi_fn(int value, int n);
typedef int cp_setIw_fn(int value, const char* s);
typedef int cp_setIv_fn(int value, void* arg);
typedef int cp_setS_fn(const char* value);
typedef int cp_setSi_fn(const char* value, int n);
typedef int cp_setSw_fn(const char* value, const char* s);
typedef int cp_setSv_fn(const char* value, void* arg);
typedef int cp_setAI_fn(void* in);
typedef int cp_setAIi_fn(void* in, int n);
typedef int cp_setAIw_fn(void* in, const char* s);
typedef int cp_setAIv_fn(void* in, void* arg);
typedef int cp_setAS_fn(void* in);
typedef int cp_setASi_fn(void* in, int n);
typedef int cp_setASw_fn(void* in, const char* s);
typedef int cp_setASv_fn(void* in, void* arg);

typedef int cp_getI_fn(void);
typedef int cp_getIi_fn(int n);
typedef int cp_getIw_fn(const char* s);
typedef int cp_getIv_fn(void* arg);
typedef int cp_getS_fn(void* out);
typedef int cp_getSi_fn(void* out, int n);
typedef int cp_getSw_fn(void* out, const char* s);
typedef int cp_getSv_fn(void* out, void* arg);
typedef int cp_getAI_fn(void* out);
typedef int cp_getAIi_fn(void* out, int n);
typedef int cp_getAIw_fn(void* out, const char* s);
typedef int cp_getAIv_fn(void* out, void* arg);
typedef int cp_getAS_fn(void* out);
typedef int cp_getASi_fn(void* out, int n);
typedef int cp_getASw_fn(void* out, const char* s);
typedef int cp_getASv_fn(void* out, void* arg);
typedef long cp_getL_fn(void);
typedef long cp_getLi_fn(int n);
typedef long cp_getLw_fn(const char* s);
typedef long cp_getLv_fn(void* arg);

typedef int cp_execA_fn(void);
typedef int cp_execAi_fn(int n);
typedef int cp_execAw_fn(const char* s);
typedef int cp_execAv_fn(void* arg);
typedef int cp_execB_fn(void* in);
typedef int cp_execBi_fn(void* in, int n);
typedef int cp_execBw_fn(void* in, const char* s);
typedef int cp_execBv_fn(void* in, void* arg);
typedef int cp_execC_fn(void* in, void* out);
typedef int cp_execCi_fn(void* in, void* out, int n);
typedef int cp_execCw_fn(void* in, void* out, const char* s);
typedef int cp_execCv_fn(void* in, void* out, void* arg);

/// CP_FUNCTION(getSi, diskName); declares diskName as a function of the type getSi: with C linkage
/// and exported from the library. Goes before the definition, which must have that type: with
/// another prototype it does not compile.
#define CP_FUNCTION(type, name) \
  CP_C_LINKAGE __attribute__((visibility("default"))) cp_##type##_fn name

/// CP_CHECK_TYPE(getSi, diskName); compiles when diskName, declared elsewhere with C linkage, is a
/// function of the type getSi.
#define CP_CHECK_TYPE(type, name) CP_C_LINKAGE cp_##type##_fn name

// --- Reading what comes in -----------------------------------------------------------------------

/// A position in a buffer, or in the elements of an array.
typedef struct cp_reader {
  const char* at;
  const char* end;
} cp_reader;

/// One item, as a view into the buffer.
typedef struct cp_item {
  int kind;            ///< CP_INT, CP_STRING, CP_INT_ARRAY or CP_STRING_ARRAY.
  int number;          ///< CP_INT: the value.
  const char* text;    ///< CP_STRING: the bytes, with a NUL behind the last.
  size_t length;       ///< CP_STRING: how many; more than strlen(text) when a NUL is among them.
  int count;           ///< Arrays: number of elements.
  cp_reader elements;  ///< Arrays: reads the elements, as items of kind CP_INT or CP_STRING.
} cp_item;

/// Starts reading at the beginning of `in` or `arg`.
static inline cp_reader cp_read(const void* buffer) {
  cp_reader reader;
  reader.at = (const char*)buffer;
  reader.end = reader.at + CP_BUFFER_SIZE;
  return reader;
}

static inline uint32_t cp_word_(const char* at) {
  uint32_t word;
  memcpy(&word, at, sizeof word);
  return word;
}

// Bytes of the int or string item at `at`; 0 when there is none before `end`.
static inline size_t cp_scalar_size_(const char* at, const char* end, uint32_t kind) {
  const size_t room = (size_t)(end - at);
  if (room < CP_HEADER_SIZE || cp_word_(at) != kind) return 0;
  if (kind == CP_INT) return CP_HEADER_SIZE;
  if (cp_word_(at + 4) >= room - CP_HEADER_SIZE) return 0;
  if (at[CP_HEADER_SIZE + cp_word_(at + 4)] != '\0') return 0;
  return CP_HEADER_SIZE + cp_word_(at + 4) + 1;
}

// The same for an array item of `kind`.
static inline size_t cp_array_size_(const char* at, const char* end, uint32_t kind) {
  const uint32_t element_kind = kind - CP_INT_ARRAY + CP_INT;
  const char* element = at + CP_HEADER_SIZE;
  uint32_t i;
  for (i = 0; i < cp_word_(at + 4); ++i) {
    const size_t size = cp_scalar_size_(element, end, element_kind);
    if (size == 0) return 0;
    element += size;
  }
  return (size_t)(element - at);
}

/// Takes the next item. CP_END at an end mark, at the end of an array's elements, and at the end of
/// the buffer; CP_BAD_BUFFER where there is no item. In both cases nothing is taken.
///
/// The list in `arg` has no end mark: behind its last item lie zeros, which read as ints. Its
/// function takes as many items as its definition has arguments.
static inline int cp_next(cp_reader* reader, cp_item* item) {
  const char* const at = reader->at;
  const size_t room = (size_t)(reader->end - at);
  uint32_t kind;
  size_t size;
  if (room == 0) return CP_END;
  if (room < CP_END_MARK_SIZE) return CP_BAD_BUFFER;
  kind = cp_word_(at);
  if (kind == CP_LIST_END) return CP_END;
  if (room < CP_HEADER_SIZE || kind > CP_STRING_ARRAY) return CP_BAD_BUFFER;
  size = kind < CP_INT_ARRAY ? cp_scalar_size_(at, reader->end, kind)
                             : cp_array_size_(at, reader->end, kind);
  if (size == 0) return CP_BAD_BUFFER;
  memset(item, 0, sizeof *item);
  item->kind = (int)kind;
  item->number = kind == CP_INT ? (int)cp_word_(at + 4) : 0;
  item->text = kind == CP_STRING ? at + CP_HEADER_SIZE : "";
  item->length = kind == CP_STRING ? cp_word_(at + 4) : 0;
  item->count = kind >= CP_INT_ARRAY ? (int)cp_word_(at + 4) : 0;
  item->elements.at = at + CP_HEADER_SIZE;
  item->elements.end = kind >= CP_INT_ARRAY ? at + size : item->elements.at;
  reader->at = at + size;
  return CP_OK;
}

/// Takes the next item if it is of `kind`. CP_WRONG_KIND when it is of another: it is not taken and
/// can still be read as what it is.
static inline int cp_next_of(cp_reader* reader, enum cp_kind kind, cp_item* item) {
  cp_reader behind = *reader;
  cp_item found;
  const int status = cp_next(&behind, &found);
  if (status != CP_OK) return status;
  if (found.kind != (int)kind) return CP_WRONG_KIND;
  *item = found;
  *reader = behind;
  return CP_OK;
}

/// Takes an int. Otherwise `*value` stays as it is.
static inline int cp_next_int(cp_reader* reader, int* value) {
  cp_item item;
  const int status = cp_next_of(reader, CP_INT, &item);
  if (status == CP_OK) *value = item.number;
  return status;
}

/// Takes a string; `*text` becomes a pointer into the buffer. Otherwise it stays as it is.
static inline int cp_next_string(cp_reader* reader, const char** text) {
  cp_item item;
  const int status = cp_next_of(reader, CP_STRING, &item);
  if (status == CP_OK) *text = item.text;
  return status;
}

/// Takes an int array and copies its elements; there are at most CP_MAX_INTS. Otherwise, and with
/// CP_NO_SPACE when it has more than `capacity`, nothing is taken or copied.
static inline int cp_next_ints(cp_reader* reader, int* values, size_t capacity, size_t* count) {
  cp_reader behind = *reader;
  cp_item array;
  size_t i;
  const int status = cp_next_of(&behind, CP_INT_ARRAY, &array);
  if (status != CP_OK) return status;
  if ((size_t)array.count > capacity) return CP_NO_SPACE;
  for (i = 0; i < (size_t)array.count; ++i) cp_next_int(&array.elements, &values[i]);
  *count = (size_t)array.count;
  *reader = behind;
  return CP_OK;
}

// --- Writing what goes out -----------------------------------------------------------------------

/// The items written so far. Its members are private.
typedef struct cp_writer {
  char* buffer;
  size_t limit;  // Items end here: the buffer's size, less the end mark in a list.
  size_t next;   // Where the next item begins; behind a string an int begins one byte before.
  size_t array;  // Where the open array begins.
  int open;      // Kind of the open array; CP_LIST_END when none takes elements.
  int last;      // Kind of the last item.
  int status;    // CP_OK, or why an item of a list could not be written.
} cp_writer;

static inline void cp_store_(char* at, size_t word) {
  const uint32_t stored = (uint32_t)word;
  memcpy(at, &stored, sizeof stored);
}

static inline int cp_is_list_(const cp_writer* writer) {
  return writer->limit != CP_BUFFER_SIZE;
}

// A list ends with its mark after every step, so that one that is given up is well-formed.
static inline void cp_mark_(cp_writer* writer) {
  if (cp_is_list_(writer)) cp_store_(writer->buffer + writer->next, CP_LIST_END);
}

static inline int cp_fits_(const cp_writer* writer, size_t at, size_t size) {
  return at <= writer->limit && size <= writer->limit - at;
}

static inline cp_writer cp_write_(void* out, size_t limit) {
  cp_writer writer;
  writer.buffer = (char*)out;
  writer.limit = limit;
  writer.next = 0;
  writer.array = 0;
  writer.open = CP_LIST_END;
  writer.last = CP_LIST_END;
  writer.status = CP_OK;
  cp_mark_(&writer);
  return writer;
}

// Writes the first eight bytes of an item for which `size` bytes are needed, and goes behind them.
static inline int cp_start_(cp_writer* writer, enum cp_kind kind, size_t second, size_t size) {
  // The provider looks for an int at the NUL of the string before it: the NUL is the low byte of
  // the int's tag. Any other item stands behind the NUL.
  const size_t at = writer->next - (size_t)(kind == CP_INT && writer->last == CP_STRING ? 1 : 0);
  if (!cp_fits_(writer, at, size)) return CP_NO_SPACE;
  cp_store_(writer->buffer + at, (size_t)kind);
  cp_store_(writer->buffer + at + 4, second);
  writer->next = at + CP_HEADER_SIZE;
  writer->last = (int)kind;
  return CP_OK;
}

// Ends a step: where it failed, later items fail too, as they would arrive as earlier parameters.
static inline int cp_step_(cp_writer* writer, const cp_writer* before, int status) {
  if (status != CP_OK) {
    *writer = *before;
    writer->status = status;
  }
  writer->open = CP_LIST_END;
  cp_mark_(writer);
  return status;
}

// Whether a list can take one more item.
static inline int cp_may_put_(const cp_writer* writer) {
  return cp_is_list_(writer) ? writer->status : CP_WRONG_KIND;
}

static inline int cp_open_(cp_writer* writer, enum cp_kind kind) {
  const size_t at = writer->next;
  const int status = cp_start_(writer, kind, 0, CP_HEADER_SIZE);
  if (status != CP_OK) return status;
  writer->array = at;
  writer->open = (int)kind;
  cp_mark_(writer);
  return CP_OK;
}

static inline void cp_count_(cp_writer* writer) {
  char* const count = writer->buffer + writer->array + 4;
  cp_store_(count, cp_word_(count) + 1);
  writer->last = writer->open;
  cp_mark_(writer);
}

/// Starts the list of an execC function, for cp_put_... and cp_begin_...; cp_finish ends it.
static inline cp_writer cp_write_list(void* out) {
  return cp_write_(out, CP_BUFFER_SIZE - CP_END_MARK_SIZE);
}

/// Starts the result of a getAI function; takes elements with cp_add_int.
static inline cp_writer cp_write_ints(void* out) {
  cp_writer writer = cp_write_(out, CP_BUFFER_SIZE);
  cp_open_(&writer, CP_INT_ARRAY);
  return writer;
}

/// Starts the result of a getAS function; takes elements with cp_add_string.
static inline cp_writer cp_write_strings(void* out) {
  cp_writer writer = cp_write_(out, CP_BUFFER_SIZE);
  cp_open_(&writer, CP_STRING_ARRAY);
  return writer;
}

/// Adds an element to the open int array. CP_NO_SPACE leaves the array as it was.
static inline int cp_add_int(cp_writer* writer, int value) {
  if (writer->open != CP_INT_ARRAY) return CP_WRONG_KIND;
  if (cp_start_(writer, CP_INT, (uint32_t)value, CP_HEADER_SIZE) != CP_OK) return CP_NO_SPACE;
  cp_count_(writer);
  return CP_OK;
}

/// Adds an element to the open string array. CP_NO_SPACE leaves the array as it was; a shorter text
/// may still fit.
static inline int cp_add_string(cp_writer* writer, const char* text) {
  const size_t length = strlen(text);
  // Behind the last string of an array that is not followed by anything the gap may be missing.
  const size_t gap = cp_is_list_(writer) ? CP_STRING_GAP : 0;
  const size_t rest = CP_HEADER_SIZE + 1 + gap;
  if (writer->open != CP_STRING_ARRAY) return CP_WRONG_KIND;
  if (length > CP_BUFFER_SIZE) return CP_NO_SPACE;
  if (cp_start_(writer, CP_STRING, length, rest + length) != CP_OK) return CP_NO_SPACE;
  memcpy(writer->buffer + writer->next, text, length + 1);
  writer->next += length + 1 + CP_STRING_GAP;
  cp_count_(writer);
  return CP_OK;
}

/// Opens an int array as the next item of a list; cp_add_int fills it, the next item closes it.
static inline int cp_begin_ints(cp_writer* writer) {
  const cp_writer before = *writer;
  const int status = cp_may_put_(writer);
  if (status != CP_OK) return status;
  if (cp_open_(writer, CP_INT_ARRAY) == CP_OK) return CP_OK;
  return cp_step_(writer, &before, CP_NO_SPACE);
}

/// Opens a string array as the next item of a list; cp_add_string fills it, the next item closes
/// it.
static inline int cp_begin_strings(cp_writer* writer) {
  const cp_writer before = *writer;
  const int status = cp_may_put_(writer);
  if (status != CP_OK) return status;
  if (cp_open_(writer, CP_STRING_ARRAY) == CP_OK) return CP_OK;
  return cp_step_(writer, &before, CP_NO_SPACE);
}

// The following write one item of a list as a whole. CP_NO_SPACE: nothing of it was written, and
// the list takes no further item, because that would arrive as this one's parameter. CP_WRONG_KIND:
// the writer is not that of a list.

static inline int cp_put_int(cp_writer* writer, int value) {
  const cp_writer before = *writer;
  const int status = cp_may_put_(writer);
  if (status != CP_OK) return status;
  return cp_step_(writer, &before, cp_start_(writer, CP_INT, (uint32_t)value, CP_HEADER_SIZE));
}

static inline int cp_put_string(cp_writer* writer, const char* text) {
  const cp_writer before = *writer;
  const size_t length = strlen(text);
  int status = cp_may_put_(writer);
  if (status != CP_OK) return status;
  status = length > CP_BUFFER_SIZE
               ? CP_NO_SPACE
               : cp_start_(writer, CP_STRING, length, CP_HEADER_SIZE + length + 1);
  if (status == CP_OK) {
    memcpy(writer->buffer + writer->next, text, length + 1);
    writer->next += length + 1;
  }
  return cp_step_(writer, &before, status);
}

static inline int cp_put_ints(cp_writer* writer, const int* values, size_t count) {
  const cp_writer before = *writer;
  size_t i;
  int status = cp_begin_ints(writer);
  if (status != CP_OK) return status;
  for (i = 0; i < count && status == CP_OK; ++i) status = cp_add_int(writer, values[i]);
  return cp_step_(writer, &before, status);
}

static inline int cp_put_strings(cp_writer* writer, const char* const* texts, size_t count) {
  const cp_writer before = *writer;
  size_t i;
  int status = cp_begin_strings(writer);
  if (status != CP_OK) return status;
  for (i = 0; i < count && status == CP_OK; ++i) status = cp_add_string(writer, texts[i]);
  return cp_step_(writer, &before, status);
}

/// Ends a list with its end mark, for which there is always room. Returns CP_OK, or the error of
/// the first item that could not be written; the list ends before that item.
static inline int cp_finish(cp_writer* writer) {
  writer->open = CP_LIST_END;
  cp_mark_(writer);
  return writer->status;
}

// The following write the whole result of a get function. CP_NO_SPACE: the result is empty.

/// getS: at most CP_MAX_STRING bytes.
static inline int cp_return_string(void* out, const char* text) {
  const size_t length = strlen(text);
  ((char*)out)[0] = '\0';
  if (length > CP_MAX_STRING) return CP_NO_SPACE;
  memcpy(out, text, length + 1);
  return CP_OK;
}

/// getAI: at most CP_MAX_INTS elements.
static inline int cp_return_ints(void* out, const int* values, size_t count) {
  cp_writer writer = cp_write_ints(out);
  size_t i;
  for (i = 0; i < count; ++i) {
    if (cp_add_int(&writer, values[i]) != CP_OK) {
      cp_write_ints(out);
      return CP_NO_SPACE;
    }
  }
  return CP_OK;
}

/// getAS.
static inline int cp_return_strings(void* out, const char* const* texts, size_t count) {
  cp_writer writer = cp_write_strings(out);
  size_t i;
  for (i = 0; i < count; ++i) {
    if (cp_add_string(&writer, texts[i]) != CP_OK) {
      cp_write_strings(out);
      return CP_NO_SPACE;
    }
  }
  return CP_OK;
}

#ifdef __cplusplus
}  // extern "C"
#endif

#endif
