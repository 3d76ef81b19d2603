#include "hostinfo.h"

int hostInit(void) {
  hostFileSystemCount();
  hostNetworkPortCount();
  hostIPEndpointCount();
  return 0;
}
