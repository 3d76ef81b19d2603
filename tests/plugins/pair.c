/* Built twice, as the libraries pair_a and pair_b: SIDE is a or b. */

#define JOIN2(a, b) a##b
#define JOIN(a, b) JOIN2(a, b)

static int starts;

/* getIi: the initialisation call, whose argument is the other library's value */
int JOIN(start_, SIDE)(int other) {
  (void)other;
  return ++starts;
}

/* getI */
int JOIN(value_, SIDE)(void) {
  return 5;
}
int JOIN(starts_, SIDE)(void) {
  return starts;
}
