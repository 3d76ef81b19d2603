#include "engine/CallBuffer.h"

#include <cstring>

CallBuffer::CallBuffer() {
  std::memset(storage_, 0, kSize);
  std::memset(storage_ + kSize, kGuardByte, kGuard);
}

bool CallBuffer::isIntact() const {
  // The guard is uniform: it equals itself one byte further on.
  const char* guard = storage_ + kSize;
  return static_cast<unsigned char>(guard[0]) == kGuardByte &&
         std::memcmp(guard, guard + 1, kGuard - 1) == 0;
}
