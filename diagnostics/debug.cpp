#include "diagnostics/debug.h"

#include "platform/PropertyFile.h"
#include "platform/StringConverters.h"

#include <algorithm>
#include <climits>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <string>

std::atomic<int> LOG_LEVEL{0};
std::atomic<int> configRead{0};

void readLogConfiguration() {
  // Set first, so that a reading that fails is never tried again.
  configRead.store(1, std::memory_order_relaxed);
  try {
    Vaneth::PropertyFile file(Vaneth::File::Path("../logs/CommonProvider.ini"));
    file.open(Vaneth::PropertyFile::kReadExisting);
    const std::string text = Vaneth::make_string(file.getValue(Vaneth::make_wstring("LogLevel")));
    const long level = std::strtol(text.c_str(), nullptr, 10);
    LOG_LEVEL.store(static_cast<int>(std::clamp<long>(level, INT_MIN, INT_MAX)),
                    std::memory_order_relaxed);
    file.close();
  } catch (...) {
    // No configuration: the level stays as it is.
  }
}

void debug(int level, const char* text) {
  if (!debugEnabled(level)) return;
  std::FILE* file = std::fopen("../logs/CommonProvider.log", "a+");
  if (file == nullptr) return;
  std::fputs(text, file);
  std::fclose(file);
}

void debug(int level, char* text) {
  if (debugEnabled(level)) std::fputs(text, stdout);
}

void debugFormat(int level, const char* format, ...) {
  if (!debugEnabled(level)) return;
  va_list arguments;
  va_start(arguments, format);
  va_list measured;
  va_copy(measured, arguments);
  const int length = std::vsnprintf(nullptr, 0, format, measured);
  va_end(measured);
  if (length >= 0) {
    std::string text(static_cast<size_t>(length), '\0');
    std::vsnprintf(text.data(), text.size() + 1, format, arguments);
    debug(level, static_cast<const char*>(text.c_str()));
  }
  va_end(arguments);
}
