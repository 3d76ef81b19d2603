/* 10,000 devices, or as many as BENCH_DEVICES says, whose values cost next to nothing. */
#include <commonprovider/plugin.h>

#include <stdio.h>
#include <stdlib.h>

CP_FUNCTION(getI, deviceCount);
CP_FUNCTION(getSi, deviceText);
CP_FUNCTION(getIi, deviceNumber);
CP_FUNCTION(getLi, deviceLong);
CP_FUNCTION(getSi, deviceTime);
CP_FUNCTION(getASi, deviceTexts);

int deviceCount(void) {
  const char* count = getenv("BENCH_DEVICES");
  return count == NULL ? 10000 : atoi(count);
}

int deviceText(void* out, int index) {
  char text[] = "device 000000";
  int digit;
  for (digit = 12; digit > 6; --digit, index /= 10) text[digit] = (char)('0' + index % 10);
  return cp_return_string(out, text);
}

int deviceNumber(int index) {
  return index + 1;
}

long deviceLong(int index) {
  return index + 1000000L;
}

int deviceTime(void* out, int index) {
  (void)index;
  return cp_return_string(out, "20260131120000.123456+060");
}

int deviceTexts(void* out, int index) {
  static const char* const texts[] = {"alpha", "beta", "gamma"};
  (void)index;
  return cp_return_strings(out, texts, 3);
}
