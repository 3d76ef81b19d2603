/* The plug-in behind data/demo.xml: two disks. */
#include <stdio.h>
#include <string.h>

int initAll(void);
int getCount(void);
int getName(void* out, int index);
int setName(const char* value, int index);
int getLabel(void* out, void* in);
int reset(int index);

static char names[2][64] = {"part", "sdb"};

int initAll(void) {
  /* An initialisation call is a get call: a function of an exec type is not called. */
  strcpy(names[0], "initialised");
  return 0;
}

int getCount(void) {
  return 2;
}

int getName(void* out, int index) {
  return snprintf(out, 1024, "%s", names[index]);
}

int setName(const char* value, int index) {
  return snprintf(names[index], sizeof names[index], "%s", value);
}

/* The list holds the index alone: an index string has no item in it. */
int getLabel(void* out, void* in) {
  int words[4];
  memcpy(words, in, sizeof words);
  return snprintf(out, 1024, "label %d, next tag %d value %d", words[1], words[2], words[3]);
}

int reset(int index) {
  return 40 + index;
}
