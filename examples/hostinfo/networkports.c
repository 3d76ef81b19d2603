// Host_NetworkPort: the network interfaces of this network namespace.

#include <dirent.h>
#include <net/if.h>
#include <stdlib.h>
#include <string.h>

#include "hostfiles.h"
#include "hostinfo.h"
#include "snapshot.h"
#include "text.h"

enum { kCounters = 4 };

struct NetworkPort {
  char name[256];
  char currentAddress[128];
  int addressIsPermanent;
  int64_t interfaceIndex;
  int mtu;
  int up;
  int speedMbps;
  int traffic[kCounters];
};

static struct SnapshotTable table = SNAPSHOT_TABLE(struct NetworkPort);

// /sys/class/net/<port>/<attribute>; a path that does not fit becomes "", which cannot be opened.
static void attributePath(char to[kPathSize], const char* port, const char* attribute) {
  const int length = snprintf(to, kPathSize, "/sys/class/net/%s/%s", port, attribute);
  if (length >= kPathSize) {
    to[0] = '\0';
  }
}

static int readAttribute(const char* port, const char* attribute, int64_t* value) {
  char path[kPathSize];
  attributePath(path, port, attribute);
  return hostReadNumber(path, value);
}

static int readCount(const char* port, const char* attribute, uint64_t unit) {
  int64_t value = 0;
  readAttribute(port, attribute, &value);
  return value > 0 ? saturateToInt((uint64_t)value / unit) : 0;
}

// What the loopback port shows: not an address that its device came with.
static int isZeroAddress(const char* address) {
  return address[strspn(address, "0:")] == '\0';
}

// False for what is no interface, such as the file bonding_masters.
static int readPort(const char* directory, struct NetworkPort* row) {
  char path[kPathSize];
  int64_t flags = 0;
  int64_t assigned = 0;
  if (!textClean(row->name, sizeof row->name, directory) ||
      !readAttribute(directory, "ifindex", &row->interfaceIndex)) {
    return 0;
  }
  attributePath(path, directory, "address");
  hostReadText(path, row->currentAddress, sizeof row->currentAddress);
  row->addressIsPermanent = readAttribute(directory, "addr_assign_type", &assigned) && !assigned &&
                            !isZeroAddress(row->currentAddress);
  row->up = readAttribute(directory, "flags", &flags) && (flags & IFF_UP) != 0;
  row->mtu = readCount(directory, "mtu", 1);
  row->speedMbps = readCount(directory, "speed", 1);  // -1, or unreadable, while there is no link
  row->traffic[0] = readCount(directory, "statistics/rx_bytes", 1024);
  row->traffic[1] = readCount(directory, "statistics/tx_bytes", 1024);
  row->traffic[2] = readCount(directory, "statistics/rx_packets", 1);
  row->traffic[3] = readCount(directory, "statistics/tx_packets", 1);
  return 1;
}

// The kernel's order, which stays the same from one snapshot to the next; a directory's does not.
static int compareRows(const void* left, const void* right) {
  const struct NetworkPort* a = left;
  const struct NetworkPort* b = right;
  if (a->interfaceIndex != b->interfaceIndex) {
    return a->interfaceIndex < b->interfaceIndex ? -1 : 1;
  }
  return strcmp(a->name, b->name);
}

static void readPorts(DIR* directory, struct Rows* rows) {
  for (struct dirent* entry = readdir(directory); entry; entry = readdir(directory)) {
    struct NetworkPort row;
    memset(&row, 0, sizeof row);
    if (entry->d_name[0] == '.' || !readPort(entry->d_name, &row)) {
      continue;
    }
    struct NetworkPort* added = rowsAdd(rows);
    if (added == NULL) {
      return;
    }
    *added = row;
  }
}

int hostNetworkPortCount(void) {
  struct Rows rows = {sizeof(struct NetworkPort), 0, 0, NULL};
  char path[kPathSize];
  DIR* directory = hostPath(path, "/sys/class/net") ? opendir(path) : NULL;
  if (directory != NULL) {
    readPorts(directory, &rows);
    closedir(directory);
  }
  if (rows.count > 1) {
    qsort(rows.items, rows.count, rows.rowSize, compareRows);
  }
  return snapshotStore(&table, &rows);
}

int hostNetworkPortName(void* out, int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.name);
  return 0;
}

int hostNetworkPortPermanentAddress(void* out, int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.addressIsPermanent ? row.currentAddress : "");
  return 0;
}

int hostNetworkPortCurrentAddress(void* out, int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.currentAddress);
  return 0;
}

int hostNetworkPortMTU(int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  return row.mtu;
}

int hostNetworkPortUp(int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  return row.up;
}

int hostNetworkPortSpeedMbps(int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  return row.speedMbps;
}

int hostNetworkPortTraffic(void* out, int index) {
  struct NetworkPort row;
  snapshotCopy(&table, index, &row);
  cp_return_ints(out, row.traffic, row.name[0] != '\0' ? kCounters : 0);
  return 0;
}

__attribute__((destructor)) static void releaseNetworkPorts(void) {
  snapshotClear(&table);
}
