// Host_IPEndpoint: the IPv4 and IPv6 addresses of the network interfaces.

#include <arpa/inet.h>
#include <ifaddrs.h>
#include <net/if.h>
#include <netinet/in.h>
#include <stdio.h>
#include <string.h>

#include "hostinfo.h"
#include "snapshot.h"
#include "text.h"

struct IPEndpoint {
  char name[128];
  char portName[64];
  char address[INET6_ADDRSTRLEN];
  int prefixLength;
  int protocol;  // 4 or 6
};

static struct SnapshotTable table = SNAPSHOT_TABLE(struct IPEndpoint);

static int countBits(const unsigned char* bytes, size_t size) {
  int bits = 0;
  for (size_t i = 0; i < size; ++i) {
    for (unsigned byte = bytes[i]; byte != 0; byte >>= 1) {
      bits += (int)(byte & 1);
    }
  }
  return bits;
}

static void readIPv4(const struct ifaddrs* from, struct IPEndpoint* row) {
  const struct sockaddr_in* address = (const void*)from->ifa_addr;
  const struct sockaddr_in* mask = (const void*)from->ifa_netmask;
  row->protocol = 4;
  row->prefixLength = mask ? countBits((const void*)&mask->sin_addr, sizeof mask->sin_addr) : 32;
  inet_ntop(AF_INET, &address->sin_addr, row->address, sizeof row->address);
}

static void readIPv6(const struct ifaddrs* from, struct IPEndpoint* row) {
  const struct sockaddr_in6* address = (const void*)from->ifa_addr;
  const struct sockaddr_in6* mask = (const void*)from->ifa_netmask;
  row->protocol = 6;
  row->prefixLength = mask ? countBits((const void*)&mask->sin6_addr, sizeof mask->sin6_addr) : 128;
  inet_ntop(AF_INET6, &address->sin6_addr, row->address, sizeof row->address);
}

// False for addresses of other kinds.
static int readEndpoint(const struct ifaddrs* from, struct IPEndpoint* row) {
  char port[sizeof row->portName];
  if (from->ifa_addr == NULL) {
    return 0;
  }
  if (from->ifa_addr->sa_family == AF_INET) {
    readIPv4(from, row);
  } else if (from->ifa_addr->sa_family == AF_INET6) {
    readIPv6(from, row);
  } else {
    return 0;
  }
  // An IPv4 address may carry a label, "eth0:1": no interface's name has a colon.
  snprintf(port, sizeof port, "%.*s", (int)strcspn(from->ifa_name, ":"), from->ifa_name);
  textClean(row->portName, sizeof row->portName, port);
  snprintf(row->name, sizeof row->name, "%s:%s", row->portName, row->address);
  return 1;
}

static int hasName(const struct Rows* rows, const char* name) {
  const struct IPEndpoint* row = (const void*)rows->items;
  for (size_t i = 0; i < rows->count; ++i) {
    if (strcmp(row[i].name, name) == 0) {
      return 1;
    }
  }
  return 0;
}

// One port may have an address twice: with two prefix lengths, or towards two peers. The former
// are told apart by name, of the latter one is enough.
static int makeUnique(const struct Rows* rows, struct IPEndpoint* row) {
  if (!hasName(rows, row->name)) {
    return 1;
  }
  snprintf(row->name, sizeof row->name, "%s:%s/%d", row->portName, row->address, row->prefixLength);
  return !hasName(rows, row->name);
}

int hostIPEndpointCount(void) {
  struct Rows rows = {sizeof(struct IPEndpoint), 0, 0, NULL};
  struct ifaddrs* all = NULL;
  if (getifaddrs(&all) != 0) {
    all = NULL;
  }
  for (const struct ifaddrs* each = all; each != NULL; each = each->ifa_next) {
    struct IPEndpoint row;
    memset(&row, 0, sizeof row);
    if (readEndpoint(each, &row) && makeUnique(&rows, &row)) {
      struct IPEndpoint* added = rowsAdd(&rows);
      if (added == NULL) {
        break;
      }
      *added = row;
    }
  }
  if (all != NULL) {
    freeifaddrs(all);
  }
  return snapshotStore(&table, &rows);
}

int hostIPEndpointName(void* out, int index) {
  struct IPEndpoint row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.name);
  return 0;
}

int hostIPEndpointAddress(void* out, int index) {
  struct IPEndpoint row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.address);
  return 0;
}

int hostIPEndpointPrefixLength(int index) {
  struct IPEndpoint row;
  snapshotCopy(&table, index, &row);
  return row.prefixLength;
}

int hostIPEndpointProtocolIFType(int index) {
  struct IPEndpoint row;
  snapshotCopy(&table, index, &row);
  return row.protocol;
}

int hostIPEndpointPortName(void* out, int index) {
  struct IPEndpoint row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.portName);
  return 0;
}

__attribute__((destructor)) static void releaseIPEndpoints(void) {
  snapshotClear(&table);
}
