/* Built twice, as the libraries pair_a and pair_b: SIDE is a or b. */

#define _POSIX_C_SOURCE 199309L
#include <time.h>

#define JOIN2(a, b) a##b
#define JOIN(a, b) JOIN2(a, b)

static int starts;

/* getI: takes its time */
int JOIN(pause_, SIDE)(void) {
  const struct timespec time = {0, 5000000};
  nanosleep(&time, 0);
  return 1;
}

/* getIv: the initialisation call, whose arguments are the pause and the other library's value */
int JOIN(start_, SIDE)(const void* values) {
  (void)values;
  return ++starts;
}

/* getI */
int JOIN(value_, SIDE)(void) {
  return 5;
}
int JOIN(starts_, SIDE)(void) {
  return starts;
}
