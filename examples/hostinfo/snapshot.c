#include "snapshot.h"

#include <stdlib.h>
#include <string.h>

static int grow(struct Rows* rows) {
  const size_t capacity = rows->capacity == 0 ? 16 : rows->capacity * 2;
  unsigned char* items = realloc(rows->items, capacity * rows->rowSize);
  if (items == NULL) {
    return 0;
  }
  rows->items = items;
  rows->capacity = capacity;
  return 1;
}

void* rowsAdd(struct Rows* rows) {
  if (rows->count == kMaxRows || (rows->count == rows->capacity && !grow(rows))) {
    return NULL;
  }
  unsigned char* row = rows->items + rows->count * rows->rowSize;
  memset(row, 0, rows->rowSize);
  ++rows->count;
  return row;
}

static struct Snapshot* findOwn(struct SnapshotTable* table) {
  for (int i = 0; i < kSnapshots; ++i) {
    struct Snapshot* snapshot = &table->kept[i];
    if (snapshot->taken != 0 && pthread_equal(snapshot->thread, pthread_self())) {
      return snapshot;
    }
  }
  return NULL;
}

static struct Snapshot* findOldest(struct SnapshotTable* table) {
  struct Snapshot* oldest = &table->kept[0];
  for (int i = 1; i < kSnapshots; ++i) {
    oldest = table->kept[i].taken < oldest->taken ? &table->kept[i] : oldest;
  }
  return oldest;
}

static struct Snapshot* findNewest(struct SnapshotTable* table) {
  struct Snapshot* newest = &table->kept[0];
  for (int i = 1; i < kSnapshots; ++i) {
    newest = table->kept[i].taken > newest->taken ? &table->kept[i] : newest;
  }
  return newest;
}

int snapshotStore(struct SnapshotTable* table, struct Rows* rows) {
  pthread_mutex_lock(&table->mutex);
  struct Snapshot* own = findOwn(table);
  struct Snapshot* place = own != NULL ? own : findOldest(table);
  unsigned char* old = place->items;
  *place = (struct Snapshot){pthread_self(), ++table->clock, rows->count, rows->items};
  pthread_mutex_unlock(&table->mutex);
  free(old);
  return (int)rows->count;
}

void snapshotCopy(struct SnapshotTable* table, int index, void* row) {
  memset(row, 0, table->rowSize);
  pthread_mutex_lock(&table->mutex);
  const struct Snapshot* own = findOwn(table);
  const struct Snapshot* snapshot = own != NULL ? own : findNewest(table);
  if (index >= 0 && (size_t)index < snapshot->count) {
    memcpy(row, snapshot->items + (size_t)index * table->rowSize, table->rowSize);
  }
  pthread_mutex_unlock(&table->mutex);
}

void snapshotClear(struct SnapshotTable* table) {
  pthread_mutex_lock(&table->mutex);
  for (int i = 0; i < kSnapshots; ++i) {
    free(table->kept[i].items);
    memset(&table->kept[i], 0, sizeof table->kept[i]);
  }
  pthread_mutex_unlock(&table->mutex);
}
