#pragma once

// Notes that clients attach to what the host has, kept in the file hostinfo.notes in the directory
// that the environment variable HOSTINFO_STATE names, else in ../logs.
//
// Each line is a name, a blank and a text. In both every byte up to the blank, the backslash and
// DEL are written as a backslash and three octal digits, as in /proc/self/mounts; thus a name may
// be any bytes. A change writes a new file beside the old one and puts it in its place in one step,
// so that a reader sees the old notes or the new ones, and a crash loses neither. Changes by
// several threads and processes go one after the other.

enum { kNoteSize = 1024, kMaxNotes = 4096 };

/// The note on `name` as clean text (see textClean); "" when there is none or it cannot be read.
void noteRead(const char* name, char to[kNoteSize]);

/// Sets the note on `name`; an empty text removes it. False, and nothing is changed, when name or
/// text has kNoteSize bytes or more, when there are kMaxNotes others, and when the file cannot be
/// read or written.
int noteWrite(const char* name, const char* text);
