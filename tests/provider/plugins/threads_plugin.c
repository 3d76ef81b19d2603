/* A plug-in that keeps a number for each of three instances and tolerates any number of threads. */
#include <pthread.h>
#include <stdio.h>

#include "commonprovider/plugin.h"

enum { kInstances = 3 };

static pthread_mutex_t lock = PTHREAD_MUTEX_INITIALIZER;
static int inits;
static int numbers[kInstances];

CP_FUNCTION(getI, threads_init);
int threads_init(void) {
  pthread_mutex_lock(&lock);
  ++inits;
  pthread_mutex_unlock(&lock);
  return 0;
}

/* How often the initialisation call ran. */
CP_FUNCTION(getI, threads_inits);
int threads_inits(void) {
  int count;
  pthread_mutex_lock(&lock);
  count = inits;
  pthread_mutex_unlock(&lock);
  return count;
}

CP_FUNCTION(getI, threads_count);
int threads_count(void) {
  return kInstances;
}

CP_FUNCTION(getSi, threads_name);
int threads_name(void* out, int index) {
  return snprintf(out, 1024, "item %d", index);
}

CP_FUNCTION(getIi, threads_get);
int threads_get(int index) {
  int number;
  pthread_mutex_lock(&lock);
  number = numbers[index];
  pthread_mutex_unlock(&lock);
  return number;
}

CP_FUNCTION(setIi, threads_set);
int threads_set(int value, int index) {
  pthread_mutex_lock(&lock);
  numbers[index] = value;
  pthread_mutex_unlock(&lock);
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
