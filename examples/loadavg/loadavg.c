// Load_Average: how many processes wanted to run, averaged over three spans of time.

#include <commonprovider/plugin.h>

#include <stdio.h>
#include <stdlib.h>

enum { kSpans = 3 };

static const int kMinutes[kSpans] = {1, 5, 15};

// Exported under these names; with another prototype than that of its type none of them compiles.
CP_FUNCTION(getSi, loadName);
CP_FUNCTION(getIi, loadMinutes);
CP_FUNCTION(getIi, loadHundredths);
CP_FUNCTION(execC, loadAbove);

static int exists(int index) {
  return index >= 0 && index < kSpans;
}

// getSi: text goes to the start of `out`, with its NUL.
int loadName(void* out, int index) {
  char name[32];
  snprintf(name, sizeof name, "last %d min", exists(index) ? kMinutes[index] : 0);
  return cp_return_string(out, name);
}

// getIi: the result is the value.
int loadMinutes(int index) {
  return exists(index) ? kMinutes[index] : 0;
}

// getIi again. The definition carries whole numbers, so the unit is a hundredth.
int loadHundredths(int index) {
  double averages[kSpans];
  if (!exists(index) || getloadavg(averages, kSpans) != kSpans) {
    return 0;
  }
  return (int)(averages[index] * 100 + 0.5);
}

// execC: a method. A number comes in; the names of the spans whose average is above it go out.
int loadAbove(void* in, void* out) {
  cp_reader inputs = cp_read(in);
  cp_writer outputs = cp_write_list(out);
  char name[CP_BUFFER_SIZE];
  int limit;
  if (cp_next_int(&inputs, &limit) != CP_OK) {
    return 1;
  }
  cp_begin_strings(&outputs);
  for (int i = 0; i < kSpans; ++i) {
    if (loadHundredths(i) > limit) {
      loadName(name, i);
      cp_add_string(&outputs, name);
    }
  }
  return cp_finish(&outputs);
}
