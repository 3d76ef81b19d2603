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

/* A function and its forms i, w and v: `first` is its parameters again, with a comma at the end. */
#define FORMS(Result, name, parameters, first, body)                                       \
  FUNCTION(Result, name, parameters, body)                                                 \
  FUNCTION(Result, name##i, (first int number), recorder.number = number; body)            \
  FUNCTION(Result, name##w, (first const char* word), keepText(recorder.word, word); body) \
  FUNCTION(Result, name##v, (first const void* extra), keepBuffer(recorder.extra, extra); body)

#define NOTHING
#define NUMBER int value,
#define TEXT const char *text,
#define IN const void *in,
#define OUT void *out,
#define IN_OUT const void *in, void *out,
#define RESULT return recorder.result

FORMS(int, setI, (int value), NUMBER, recorder.value = value; RESULT)
FORMS(int, setS, (const char* text), TEXT, keepText(recorder.text, text); RESULT)
FORMS(int, setAI, (const void* in), IN, keepBuffer(recorder.in, in); RESULT)
FORMS(int, setAS, (const void* in), IN, keepBuffer(recorder.in, in); RESULT)

FORMS(int, getI, (void), NOTHING, RESULT)
FORMS(int, getS, (void* out), OUT, return answer(out))
FORMS(int, getAI, (void* out), OUT, return answer(out))
FORMS(int, getAS, (void* out), OUT, return answer(out))
FORMS(long, getL, (void), NOTHING, return recorder.longResult)

FORMS(int, execA, (void), NOTHING, RESULT)
FORMS(int, execB, (const void* in), IN, keepBuffer(recorder.in, in); RESULT)
FORMS(int, execC, (const void* in, void* out), IN_OUT, keepBuffer(recorder.in, in);
      return answer(out))
