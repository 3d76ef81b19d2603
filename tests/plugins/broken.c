/* Cannot be loaded: nothing defines what it calls. */

int definedNowhere(void);

int getBroken(void) {
  return definedNowhere();
}
