// Load_Average: how many processes wanted to run, averaged over three spans of time.

#include <stdio.h>
#include <stdlib.h>

enum { kSpans = 3, kBufferSize = 1024 };

static const int kMinutes[kSpans] = {1, 5, 15};

static int exists(int index) {
  return index >= 0 && index < kSpans;
}

// getSi: text goes to the start of `out`, with its NUL.
int loadName(void* out, int index) {
  return snprintf(out, kBufferSize, "last %d min", exists(index) ? kMinutes[index] : 0);
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
