/* Initialisation calls and what depends on them. */

#include <string.h>

static int starts;
static int factor; /* set by start(), read without a lock: nothing may run before it has ended */
static char history[64];

static void note(char step) {
  const size_t length = strlen(history);
  if (length + 1 < sizeof history) history[length] = step;
}

/* getI, getIi: the initialisation call */
int start(void) {
  note('s');
  __sync_fetch_and_add(&starts, 1);
  factor = 2;
  return starts;
}
int startWith(int number) {
  note((char)('0' + number));
  factor = number;
  return start();
}

/* getI */
int prepare(void) {
  note('p');
  return 7;
}
int getStarts(void) {
  return starts;
}
int getFactor(void) {
  return factor;
}

/* getIi; safe from several threads */
int twice(int number) {
  return number * factor;
}

/* execC: the first integer that comes in, twice, as an output */
int twiceList(const void* in, void* out) {
  int words[5] = {0, 0, 99, 0, 0};
  memcpy(words, in, 2 * sizeof(int));
  words[1] = twice(words[1]);
  memcpy(out, words, 3 * sizeof(int));
  return 0;
}

/* getS: a letter for each step so far: s start, a digit startWith, p prepare */
int getHistory(char* out) {
  strcpy(out, history);
  return 0;
}
