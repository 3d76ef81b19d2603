/* What the plug-in answers, for the test program that loads it too and finds the symbol by name. */
#ifndef PROVIDER_TEST_PLUGIN_H
#define PROVIDER_TEST_PLUGIN_H

enum { TEST_ITEMS = 8, TEST_BUFFER = 1024 };

/* The texts of one list of instances; a null text is answered with a buffer without end. */
struct TestTable {
  int count;
  const char* texts[TEST_ITEMS];
};

struct TestPluginState {
  struct TestTable left;
  struct TestTable right;
  int numbers[TEST_ITEMS];      /* of number() by index; numbers() has two of them, and more */
  int calls;                    /* of leftText() and rightText() */
  char record[4 * TEST_BUFFER]; /* one line for each setter and method call */
  char output[TEST_BUFFER];     /* the output list of run() */
  int result;                   /* of run() */
};

#endif
