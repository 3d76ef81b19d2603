// Host_FileSystem: the mounted file systems that hold data.

#include <limits.h>
#include <stdlib.h>
#include <string.h>
#include <sys/statvfs.h>

#include "hostfiles.h"
#include "hostinfo.h"
#include "notes.h"
#include "snapshot.h"
#include "text.h"

enum { kMountLine = 65536 };

struct FileSystem {
  char mountPoint[CP_BUFFER_SIZE];  // as the kernel knows it
  char name[CP_BUFFER_SIZE];        // as a CIM client is told
  char device[CP_BUFFER_SIZE];
  char type[64];
  char options[CP_BUFFER_SIZE];  // the string array as it is told
  uint64_t sizeKiB;
  uint64_t freeKiB;
  int percentUsed;
  int readOnly;
};

static struct SnapshotTable table = SNAPSHOT_TABLE(struct FileSystem);

// Takes the text up to the next `separator` off `*rest`; NULL when nothing is left.
static char* takeField(char** rest, char separator) {
  char* field = *rest;
  if (field == NULL) {
    return NULL;
  }
  char* end = strchr(field, separator);
  *rest = end != NULL ? end + 1 : NULL;
  if (end != NULL) {
    *end = '\0';
  }
  return field;
}

static void addOption(struct FileSystem* row, char* option, cp_writer* told) {
  char clean[CP_BUFFER_SIZE];
  if (strcmp(option, "ro") == 0) {
    row->readOnly = 1;
  }
  textUnescape(option);
  if (*option != '\0' && textClean(clean, sizeof clean, option)) {
    cp_add_string(told, clean);
  }
}

// Fills a row from "device mountpoint type options dump pass" (fstab(5)). False when a field is
// missing, or when a name is too long to be told without cutting: it would be the name of another.
static int parseMount(char* line, struct FileSystem* row) {
  char* device = takeField(&line, ' ');
  char* mountPoint = takeField(&line, ' ');
  char* type = takeField(&line, ' ');
  char* options = takeField(&line, ' ');
  memset(row, 0, sizeof *row);
  if (options == NULL || strcmp(type, "autofs") == 0) {  // asking an autofs would mount things
    return 0;
  }
  textUnescape(device);
  textClean(row->device, sizeof row->device, device);
  textClean(row->type, sizeof row->type, type);
  cp_writer told = cp_write_strings(row->options);
  for (char* option = takeField(&options, ','); option; option = takeField(&options, ',')) {
    addOption(row, option, &told);
  }
  textUnescape(mountPoint);
  if (strlen(mountPoint) >= sizeof row->mountPoint) {
    return 0;
  }
  strcpy(row->mountPoint, mountPoint);
  return textClean(row->name, sizeof row->name, mountPoint);
}

static uint64_t toKiB(uint64_t blocks, uint64_t blockSize) {
  const uint64_t whole = blocks / 1024;
  if (blockSize != 0 && whole > (UINT64_MAX >> 1) / blockSize) {
    return UINT64_MAX >> 1;
  }
  return whole * blockSize + blocks % 1024 * blockSize / 1024;
}

static int percent(uint64_t part, uint64_t whole) {
  if (whole == 0) {
    return 0;
  }
  if (part > UINT64_MAX / 100) {
    return percent(part / 128, whole / 128);
  }
  const uint64_t scaled = part * 100;
  return (int)(scaled / whole + (scaled % whole != 0));
}

// False for what cannot be asked and for pseudo file systems, which have no blocks.
static int measure(struct FileSystem* row) {
  struct statvfs space;
  if (statvfs(row->mountPoint, &space) != 0 || space.f_blocks == 0) {
    return 0;
  }
  const uint64_t used = space.f_blocks >= space.f_bfree ? space.f_blocks - space.f_bfree : 0;
  row->sizeKiB = toKiB(space.f_blocks, space.f_frsize);
  row->freeKiB = toKiB(space.f_bavail, space.f_frsize);
  row->percentUsed = percent(used, used + space.f_bavail);
  return 1;
}

static void removeMountPoint(struct Rows* rows, const char* mountPoint) {
  struct FileSystem* row = (struct FileSystem*)(void*)rows->items;
  for (size_t i = 0; i < rows->count; ++i) {
    if (strcmp(row[i].mountPoint, mountPoint) == 0) {
      memmove(&row[i], &row[i + 1], (rows->count - i - 1) * sizeof *row);
      --rows->count;
      return;
    }
  }
}

// What is mounted over something else hides it, so a later line replaces an earlier one.
static void readMounts(FILE* file, char* line, struct FileSystem* row, struct Rows* rows) {
  while (hostReadLine(file, line, kMountLine)) {
    if (!parseMount(line, row)) {
      continue;
    }
    removeMountPoint(rows, row->mountPoint);
    if (measure(row)) {
      struct FileSystem* added = rowsAdd(rows);
      if (added == NULL) {
        return;
      }
      *added = *row;
    }
  }
}

int hostFileSystemCount(void) {
  struct Rows rows = {sizeof(struct FileSystem), 0, 0, NULL};
  FILE* file = hostOpen("/proc/self/mounts");
  char* line = malloc(kMountLine);
  struct FileSystem* row = malloc(sizeof *row);
  if (file != NULL && line != NULL && row != NULL) {
    readMounts(file, line, row, &rows);
  }
  free(row);
  free(line);
  if (file != NULL) {
    fclose(file);
  }
  return snapshotStore(&table, &rows);
}

int hostFileSystemName(void* out, int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.name);
  return 0;
}

int hostFileSystemDevice(void* out, int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.device);
  return 0;
}

int hostFileSystemType(void* out, int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  cp_return_string(out, row.type);
  return 0;
}

static long saturateToLong(uint64_t value) {
  return value > LONG_MAX ? LONG_MAX : (long)value;
}

long hostFileSystemSizeKiB(int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  return saturateToLong(row.sizeKiB);
}

long hostFileSystemFreeKiB(int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  return saturateToLong(row.freeKiB);
}

int hostFileSystemPercentUsed(int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  return row.percentUsed;
}

int hostFileSystemReadOnly(int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  return row.readOnly;
}

int hostFileSystemMountOptions(void* out, int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  if (row.name[0] == '\0') {
    return cp_return_strings(out, NULL, 0);
  }
  memcpy(out, row.options, sizeof row.options);
  return 0;
}

int hostFileSystemOwner(void* out, int index) {
  struct FileSystem row;
  char note[kNoteSize] = "";
  snapshotCopy(&table, index, &row);
  if (row.name[0] != '\0') {
    noteRead(row.mountPoint, note);
  }
  return cp_return_string(out, note);
}

int hostFileSystemSetOwner(const char* value, int index) {
  struct FileSystem row;
  snapshotCopy(&table, index, &row);
  return row.name[0] != '\0' && noteWrite(row.mountPoint, value) ? 0 : 1;
}

static int isOfType(int index, const char* type, struct FileSystem* row) {
  snapshotCopy(&table, index, row);
  return row->name[0] != '\0' && (*type == '\0' || strcmp(row->type, type) == 0);
}

// Adds the names of up to `limit` file systems among the first `count`; returns how many it added.
static unsigned addNames(int count, const char* type, unsigned limit, cp_writer* names) {
  struct FileSystem row;
  unsigned added = 0;
  for (int i = 0; i < count && added < limit; ++i) {
    if (isOfType(i, type, &row) && cp_add_string(names, row.name) == CP_OK) {
      ++added;
    }
  }
  return added;
}

int hostFileSystemFindByType(void* in, void* out) {
  cp_reader inputs = cp_read(in);
  cp_writer outputs = cp_write_list(out);
  struct FileSystem row;
  cp_item more;
  const char* type = "";
  int limit = 0;
  unsigned found = 0;
  // A parameter that the client leaves out leaves no gap: take what is there.
  cp_next_string(&inputs, &type);
  cp_next_int(&inputs, &limit);
  if (cp_next(&inputs, &more) != CP_END) {
    return kMethodBadInput;
  }
  // No instance is looked up for this method: nobody has counted.
  const int count = hostFileSystemCount();
  for (int i = 0; i < count; ++i) {
    found += (unsigned)isOfType(i, type, &row);
  }
  cp_put_int(&outputs, (int)found);
  cp_begin_strings(&outputs);
  const unsigned told = addNames(count, type, limit == 0 ? UINT_MAX : (unsigned)limit, &outputs);
  cp_finish(&outputs);
  return told == found ? kMethodYes : kMethodNo;
}

int hostFileSystemCheckSpace(void* in, void* out, int index) {
  cp_reader inputs = cp_read(in);
  cp_writer outputs = cp_write_list(out);
  struct FileSystem row;
  int needed = 0;
  if (cp_next_int(&inputs, &needed) != CP_OK) {
    return kMethodBadInput;
  }
  snapshotCopy(&table, index, &row);
  if (row.name[0] == '\0') {
    return kMethodNoInstance;
  }
  const uint64_t freeMiB = row.freeKiB / 1024;
  const int fits = freeMiB >= (uint32_t)needed;
  cp_put_int(&outputs, fits);
  cp_put_int(&outputs, saturateToInt(freeMiB));
  cp_put_string(&outputs, row.name);
  cp_finish(&outputs);
  return fits ? kMethodYes : kMethodNo;
}

__attribute__((destructor)) static void releaseFileSystems(void) {
  snapshotClear(&table);
}
