/* Plug-in functions for operands of conditions. */

static int calls = 0;

/* getIi: the index itself; counts its calls. */
int sameIndex(int index) {
  ++calls;
  return index;
}

/* getI: how often sameIndex was called. */
int callCount(void) {
  return calls;
}
