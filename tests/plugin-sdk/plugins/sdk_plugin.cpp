// The header as C++ sees it.
#include "sdk_plugin.c"
