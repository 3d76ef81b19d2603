#pragma once

#include "diagnostics/debug.h"

/// Sets the level of the log without a configuration file, from here to the end of the object.
class LogLevel {
 public:
  explicit LogLevel(int level) : level_(LOG_LEVEL.load()), read_(configRead.load()) {
    LOG_LEVEL.store(level);
    configRead.store(1);
  }
  ~LogLevel() {
    LOG_LEVEL.store(level_);
    configRead.store(read_);
  }
  LogLevel(const LogLevel&) = delete;
  LogLevel& operator=(const LogLevel&) = delete;

 private:
  int level_;
  int read_;
};

/// As in a process that has not logged yet: the next message reads the configuration.
inline void forgetLogConfiguration() {
  LOG_LEVEL.store(0);
  configRead.store(0);
}
