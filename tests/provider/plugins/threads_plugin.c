/* A plug-in that keeps a number for each of three instances and tolerates any number of threads. */
#include "commonprovider/plugin.h"

enum { kInstances = 3 };

static int inits;
static int numbers[kInstances];

CP_FUNCTION(getI, threads_init);
int threads_init(void) {
  return __atomic_add_fetch(&inits, 1, __ATOMIC_SEQ_CST);
}

/* How often the initialisation call ran. */
CP_FUNCTION(getI, threads_inits);
int threads_inits(void) {
  return __atomic_load_n(&inits, __ATOMIC_SEQ_CST);
}

CP_FUNCTION(getIi, threads_get);
int threads_get(int index) {
  return __atomic_load_n(&numbers[index], __ATOMIC_SEQ_CST);
}

CP_FUNCTION(setIi, threads_set);
int threads_set(int value, int index) {
  __atomic_store_n(&numbers[index], value, __ATOMIC_SEQ_CST);
  return 0;
}

/* Delivers its own instance and gives twice the number that came in. */
CP_FUNCTION(execCi, threads_twice);
int threads_twice(void* in, void* out, int index) {
  cp_reader reader = cp_read(in);
  cp_writer writer = cp_write_list(out);
  int number = 0;
  cp_next_int(&reader, &number);
  cp_put_int(&writer, index);
  cp_finish(&writer);
  return 2 * number;
}
