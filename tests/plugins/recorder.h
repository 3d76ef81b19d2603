#ifndef TESTS_PLUGINS_RECORDER_H
#define TESTS_PLUGINS_RECORDER_H

/* What the plug-in "alltypes" exports under the name "recorder": the last call as it arrived, and
   what the functions shall answer. Plain data, for one thread at a time. */
struct Recorder {
  int calls;            /* of any function */
  const char* function; /* the one that was called last */
  int value;            /* setI */
  char text[1024];      /* setS */
  unsigned char in[1024];
  int number;                /* suffix i */
  char word[1024];           /* suffix w */
  unsigned char extra[1024]; /* suffix v */

  int result;
  long longResult;
  unsigned char out[1024]; /* written to the output buffer as a whole */
};

#endif
