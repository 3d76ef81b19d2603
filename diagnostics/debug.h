#pragma once

#include <atomic>

// The provider's diagnostic log.
//
// A message has a level: 1 errors, 7 and 8 operation entry and major steps, 9 per-instance,
// per-property and per-character detail. It is written when its level is at most LOG_LEVEL, which
// comes from the key "LogLevel" of "../logs/CommonProvider.ini" (relative to the working
// directory), read once, at the first message of the process; without it the level is 0 and nothing
// is written.
//
// Safe from several threads: a message is opened, appended and closed as a whole. Texts are written
// as they are, never used as a format.

/// The highest level that is written.
extern std::atomic<int> LOG_LEVEL;

/// 1 once the configuration has been read, or its reading was tried.
extern std::atomic<int> configRead;

/// Appends `text` to "../logs/CommonProvider.log". Skipped when the file cannot be opened.
void debug(int level, const char* text);

/// Writes `text` to standard output instead: mind which overload a call selects.
void debug(int level, char* text);

/// Reads the configuration; what debug() does at the first message.
void readLogConfiguration();

/// True when a message of this level is written. One comparison once the configuration is read.
inline bool debugEnabled(int level) {
  if (configRead.load(std::memory_order_relaxed) == 0) readLogConfiguration();
  return level <= LOG_LEVEL.load(std::memory_order_relaxed);
}

/// Formats the message and appends it to the log file, only when the level is written.
void debugFormat(int level, const char* format, ...) __attribute__((format(printf, 2, 3)));

/// debugFormat() whose arguments are not even evaluated below the level.
#define DEBUG_FORMAT(level, ...)                                \
  do {                                                          \
    if (debugEnabled(level)) debugFormat((level), __VA_ARGS__); \
  } while (false)
