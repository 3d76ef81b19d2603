// The packed value buffers of plug-in calls: items that begin with two 32-bit words in the
// machine's (little-endian) order, a tag and a value, length or count.

#include "diagnostics/debug.h"
#include "engine/ProviderDefFunction.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace {

enum Tag : std::uint32_t {
  kTagInteger = 0,
  kTagString = 1,
  kTagIntArray = 2,
  kTagStringArray = 3,
  kTagEnd = 99
};

constexpr size_t kWord = 4;
constexpr size_t kHeader = 2 * kWord;
// From one string of an array to the next, besides the string's bytes: header, NUL and 24 more
// bytes. Plug-ins write results so; packAS writes inputs without the 24.
constexpr size_t kStringArrayStride = 33;

size_t room(const char* position, const char* end) {
  return position < end ? static_cast<size_t>(end - position) : 0;
}

std::uint32_t readWord(const char* position) {
  std::uint32_t word;
  std::memcpy(&word, position, kWord);
  return word;
}

char* writeWord(char* position, std::uint32_t word) {
  std::memcpy(position, &word, kWord);
  return position + kWord;
}

char* writeHeader(char* position, Tag tag, size_t second) {
  return writeWord(writeWord(position, tag), static_cast<std::uint32_t>(second));
}

bool isTag(std::uint32_t word) {
  return word <= kTagStringArray || word == kTagEnd;
}

}  // namespace

char* ProviderDefFunction::packI(char* position, const char* end, int value) const {
  if (room(position, end) < kHeader) failInput();
  return writeHeader(position, kTagInteger, static_cast<std::uint32_t>(value));
}

char* ProviderDefFunction::packS(char* position, const char* end, const std::string& value) const {
  if (value.size() >= CallBuffer::kSize || room(position, end) < kHeader + value.size() + 1) {
    failInput();
  }
  position = writeHeader(position, kTagString, value.size());
  std::memcpy(position, value.c_str(), value.size() + 1);
  return position + value.size() + 1;
}

char* ProviderDefFunction::packAI(char* position, const char* end,
                                  const std::vector<int>& values) const {
  if (room(position, end) < kHeader) failInput();
  position = writeHeader(position, kTagIntArray, values.size());
  for (const int value : values) position = packI(position, end, value);
  return position;
}

char* ProviderDefFunction::packAS(char* position, const char* end,
                                  const std::vector<std::string>& values) const {
  if (room(position, end) < kHeader) failInput();
  position = writeHeader(position, kTagStringArray, values.size());
  for (const std::string& value : values) position = packS(position, end, value);
  return position;
}

char* ProviderDefFunction::packList(char* position, const char* end, const Values& values,
                                    bool endMark) const {
  for (const ProviderDefValue& value : values) {
    switch (value.getType()) {
      case ProviderDefValue::kInteger:
        position = packI(position, end, value.getIntValue());
        break;
      case ProviderDefValue::kString:
        position = packS(position, end, value.getStringValue());
        break;
      case ProviderDefValue::kIntArray:
        position = packAI(position, end, value.getIntArray());
        break;
      case ProviderDefValue::kStringArray:
        position = packAS(position, end, value.getStringArray());
        break;
      default:
        break;  // index strings, booleans and longs have no item: they are left out
    }
  }
  if (!endMark) return position;
  if (room(position, end) < kWord) failInput();
  return writeWord(position, kTagEnd);
}

int ProviderDefFunction::makeI(const char* item, const char** next, const char* end) const {
  if (room(item, end) < kHeader) failResult();
  if (next != nullptr) *next = item + kHeader;
  return static_cast<int>(readWord(item + kWord));
}

std::string ProviderDefFunction::makeS(const char* item, const char** next, const char* end) const {
  if (room(item, end) <= kHeader) failResult();
  const char* text = item + kHeader;
  const void* nul = std::memchr(text, '\0', room(text, end));
  if (nul == nullptr) failResult();
  // The next item starts at this string's NUL, not after it: plug-ins write it so.
  if (next != nullptr) *next = static_cast<const char*>(nul);
  return std::string(text, static_cast<const char*>(nul));
}

std::vector<int> ProviderDefFunction::makeAI(const char* item, const char** next,
                                             const char* end) const {
  const int count = makeI(item, &item, end);
  if (count > 0 && static_cast<size_t>(count) > room(item, end) / kHeader) failResult();
  std::vector<int> values;
  values.reserve(static_cast<size_t>(std::max(count, 0)));
  for (int i = 0; i < count; ++i) values.push_back(makeI(item, &item, end));
  if (next != nullptr) *next = item;
  return values;
}

std::vector<std::string> ProviderDefFunction::makeAS(const char* item, const char** next,
                                                     const char* end) const {
  const int count = makeI(item, &item, end);
  std::vector<std::string> values;
  for (int i = 0; i < count; ++i) {
    values.push_back(makeS(item, nullptr, end));
    item += std::min(kStringArrayStride + values.back().size(), room(item, end));
  }
  if (next != nullptr) *next = item;
  return values;
}

void ProviderDefFunction::readOutputs(const char* position, const char* end,
                                      Values& outputs) const {
  bool afterString = false;
  for (;;) {
    if (room(position, end) < kWord) failResult();
    // A string's NUL is the low byte of the word read there, so that word can only be the tag of an
    // integer. An item of another kind, or the end mark, stands right behind the NUL.
    if (afterString && !isTag(readWord(position)) && room(position, end) > kWord &&
        isTag(readWord(position + 1))) {
      ++position;
    }
    const std::uint32_t tag = readWord(position);
    afterString = tag == kTagString;
    switch (tag) {
      case kTagInteger:
        outputs.emplace_back(makeI(position, &position, end));
        break;
      case kTagString:
        outputs.emplace_back(makeS(position, &position, end));
        break;
      case kTagIntArray:
        outputs.emplace_back(makeAI(position, &position, end));
        break;
      case kTagStringArray:
        outputs.emplace_back(makeAS(position, &position, end));
        break;
      case kTagEnd:
        return;
      default:
        DEBUG_FORMAT(1, "Function %s delivered an item with the unknown tag %u\n", name_.c_str(),
                     static_cast<unsigned>(tag));
        return;
    }
  }
}
