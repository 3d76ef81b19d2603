#pragma once

#include <pthread.h>
#include <stddef.h>
#include <stdint.h>

// What one count of a class's instances saw, kept for the calls that ask for instance i.
//
// The provider asks for the number of instances and then, on the same thread, for each property of
// each instance. So every thread reads the snapshot that its own last count took: an instance never
// mixes two states of the host, however many requests run at once. All functions may be called from
// any thread.

/// A growing array of rows of one size, before it becomes a snapshot.
struct Rows {
  size_t rowSize;
  size_t count;
  size_t capacity;
  unsigned char* items;
};

/// A new row of zeros at the end; NULL without memory and beyond kMaxRows rows.
void* rowsAdd(struct Rows* rows);

enum { kMaxRows = 4096, kSnapshots = 8 };

struct Snapshot {
  pthread_t thread;
  uint64_t taken;  ///< Value of the table's clock; 0: this place is free.
  size_t count;
  unsigned char* items;
};

/// The snapshots of one class; the oldest gives way when more than kSnapshots threads count.
struct SnapshotTable {
  size_t rowSize;
  pthread_mutex_t mutex;
  uint64_t clock;
  struct Snapshot kept[kSnapshots];
};

#define SNAPSHOT_TABLE(RowType)                      \
  {                                                  \
    sizeof(RowType), PTHREAD_MUTEX_INITIALIZER, 0, { \
      { 0 }                                          \
    }                                                \
  }

/// Makes `rows` the calling thread's snapshot, takes them over, and returns their number.
int snapshotStore(struct SnapshotTable* table, struct Rows* rows);

/// Copies row `index` of the calling thread's snapshot (of the newest one, when this thread never
/// counted) to `row`. An index that it does not have gives a row of zeros.
void snapshotCopy(struct SnapshotTable* table, int index, void* row);

/// Frees every snapshot; for the time when the library is closed.
void snapshotClear(struct SnapshotTable* table);
