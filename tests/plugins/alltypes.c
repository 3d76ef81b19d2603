/* One function for each calling type, named after it: "getAIw" is a function of type getAIw. */

#include "recorder.h"

#include <string.h>

struct Recorder recorder;

static void enter(const char* function) {
  recorder.calls++;
  recorder.function = function;
}

static void keepText(char* kept, const char* text) {
  strncpy(kept, text, sizeof recorder.text - 1);
}

static void keepBuffer(unsigned char* kept, const void* buffer) {
  memcpy(kept, buffer, sizeof recorder.in);
}

static int answer(void* out) {
  memcpy(out, recorder.out, sizeof recorder.out);
  return recorder.result;
}

#define FUNCTION(Result, name, parameters, body) \
  Result name parameters {                       \
    enter(#name);                                \
    body;                                        \
  }

/* The forms i, w and v of a function: `first` is its parameters with a comma at the end. */
#define FORMS(Result, name, first, body)                                                   \
  FUNCTION(Result, name##i, (first int number), recorder.number = number; body)            \
  FUNCTION(Result, name##w, (first const char* word), keepText(recorder.word, word); body) \
  FUNCTION(Result, name##v, (first const void* extra), keepBuffer(recorder.extra, extra); body)

#define NOTHING
#define NUMBER int value,
#define TEXT const char *text,
#define IN const void *in,
#define OUT void *out,
#define IN_OUT const void *in, void *out,

FUNCTION(int, setI, (int value), recorder.value = value; return recorder.result)
FORMS(int, setI, NUMBER, recorder.value = value; return recorder.result)
FUNCTION(int, setS, (const char* text), keepText(recorder.text, text); return recorder.result)
FORMS(int, setS, TEXT, keepText(recorder.text, text); return recorder.result)
FUNCTION(int, setAI, (const void* in), keepBuffer(recorder.in, in); return recorder.result)
FORMS(int, setAI, IN, keepBuffer(recorder.in, in); return recorder.result)
FUNCTION(int, setAS, (const void* in), keepBuffer(recorder.in, in); return recorder.result)
FORMS(int, setAS, IN, keepBuffer(recorder.in, in); return recorder.result)

FUNCTION(int, getI, (void), return recorder.result)
FORMS(int, getI, NOTHING, return recorder.result)
FUNCTION(int, getS, (void* out), return answer(out))
FORMS(int, getS, OUT, return answer(out))
FUNCTION(int, getAI, (void* out), return answer(out))
FORMS(int, getAI, OUT, return answer(out))
FUNCTION(int, getAS, (void* out), return answer(out))
FORMS(int, getAS, OUT, return answer(out))
FUNCTION(long, getL, (void), return recorder.longResult)
FORMS(long, getL, NOTHING, return recorder.longResult)

FUNCTION(int, execA, (void), return recorder.result)
FORMS(int, execA, NOTHING, return recorder.result)
FUNCTION(int, execB, (const void* in), keepBuffer(recorder.in, in); return recorder.result)
FORMS(int, execB, IN, keepBuffer(recorder.in, in); return recorder.result)
FUNCTION(int, execC, (const void* in, void* out), keepBuffer(recorder.in, in); return answer(out))
FORMS(int, execC, IN_OUT, keepBuffer(recorder.in, in); return answer(out))
