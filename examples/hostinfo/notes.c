#include "notes.h"

#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/file.h>
#include <unistd.h>

#include "hostfiles.h"
#include "text.h"

enum { kEscapedSize = 4 * kNoteSize, kNoteLine = 2 * kEscapedSize };

static const char* notesDirectory(void) {
  const char* directory = getenv("HOSTINFO_STATE");
  return directory != NULL && *directory != '\0' ? directory : "../logs";
}

static int notesPath(char to[kPathSize], const char* file) {
  const int length = snprintf(to, kPathSize, "%s/%s", notesDirectory(), file);
  return length > 0 && length < kPathSize;
}

// Writes `text`, which has less than kNoteSize bytes.
static void escape(char to[kEscapedSize], const char* text) {
  for (; *text != '\0'; ++text) {
    const unsigned char byte = (unsigned char)*text;
    if (byte <= ' ' || byte == '\\' || byte == 0x7F) {
      to += sprintf(to, "\\%03o", byte);
    } else {
      *to++ = *text;
    }
  }
  *to = '\0';
}

// The text of a line that is about this name, else NULL.
static char* textOf(char* line, const char* escapedName) {
  const size_t length = strlen(escapedName);
  return strncmp(line, escapedName, length) == 0 && line[length] == ' ' ? line + length + 1 : NULL;
}

void noteRead(const char* name, char to[kNoteSize]) {
  char path[kPathSize];
  char line[kNoteLine];
  char escaped[kEscapedSize];
  to[0] = '\0';
  if (strlen(name) >= kNoteSize || !notesPath(path, "hostinfo.notes")) {
    return;
  }
  FILE* file = fopen(path, "re");
  int begins = 1;
  escape(escaped, name);
  while (file != NULL && fgets(line, sizeof line, file) != NULL) {
    char* text = begins ? textOf(line, escaped) : NULL;
    if (text != NULL) {
      text[strcspn(text, "\n")] = '\0';
      textUnescape(text);
      textClean(to, kNoteSize, text);
      break;
    }
    begins = strchr(line, '\n') != NULL;
  }
  if (file != NULL) {
    fclose(file);
  }
}

// Copies the lines about others as they are, in pieces where they are longer than any of ours.
// Returns how many, -1 when they cannot all be read.
static int copyOthers(FILE* from, FILE* to, const char* escapedName) {
  char piece[kNoteLine];
  int copied = 0;
  int begins = 1;
  int own = 0;
  while (fgets(piece, sizeof piece, from) != NULL) {
    own = begins ? textOf(piece, escapedName) != NULL : own;
    if (!own) {
      fputs(piece, to);
      copied += begins;
    }
    begins = strchr(piece, '\n') != NULL;
  }
  if (!begins && !own) {
    fputc('\n', to);
  }
  return ferror(from) ? -1 : copied;
}

// Everything but the file's place: true when the notes are complete and on the disk.
static int writeNotes(FILE* from, FILE* to, const char* escapedName, const char* text) {
  char escaped[kEscapedSize];
  const int others = from != NULL ? copyOthers(from, to, escapedName) : 0;
  int done = others >= 0;
  if (*text != '\0') {
    done = done && others < kMaxNotes;
    escape(escaped, text);
    fprintf(to, "%s %s\n", escapedName, escaped);
  }
  done = done && fflush(to) == 0 && !ferror(to) && fsync(fileno(to)) == 0;
  return fclose(to) == 0 && done;
}

static int replaceNotes(const char* name, const char* text) {
  char path[kPathSize];
  char newPath[kPathSize];
  char escaped[kEscapedSize];
  if (!notesPath(path, "hostinfo.notes") || !notesPath(newPath, "hostinfo.notes.new")) {
    return 0;
  }
  FILE* old = fopen(path, "re");
  if (old == NULL && errno != ENOENT) {  // notes that cannot be read must not be lost
    return 0;
  }
  escape(escaped, name);
  unlink(newPath);  // left behind by a crash
  FILE* replacement = fopen(newPath, "wxe");
  int done = replacement != NULL && writeNotes(old, replacement, escaped, text);
  if (old != NULL) {
    fclose(old);
  }
  done = done && rename(newPath, path) == 0;
  if (!done) {
    unlink(newPath);
  }
  return done;
}

static int lockWhole(int directory) {
  int result = flock(directory, LOCK_EX);
  while (result != 0 && errno == EINTR) {
    result = flock(directory, LOCK_EX);
  }
  return result == 0;
}

int noteWrite(const char* name, const char* text) {
  if (strlen(name) >= kNoteSize || strlen(text) >= kNoteSize) {
    return 0;
  }
  const int directory = open(notesDirectory(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (directory < 0) {
    return 0;
  }
  // Released when the directory is closed.
  const int done = lockWhole(directory) && replaceNotes(name, text);
  if (done) {
    fsync(directory);
  }
  close(directory);
  return done;
}
