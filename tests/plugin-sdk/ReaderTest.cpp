// The reader on bytes that the provider does not write.

#include <gtest/gtest.h>

#include <climits>
#include <cstring>
#include <memory>
#include <random>

#include "commonprovider/plugin.h"
#include "tests/engine/ValueText.h"

using namespace std::string_literals;

namespace {

// 1024 bytes of their own, so that a sanitizer sees a read beyond them.
struct Buffer {
  explicit Buffer(const std::string& start, char fill = '\0')
      : bytes(new char[CP_BUFFER_SIZE]), reader(cp_read(bytes.get())) {
    std::memset(bytes.get(), fill, CP_BUFFER_SIZE);
    std::memcpy(bytes.get(), start.data(), start.size());
  }
  std::unique_ptr<char[]> bytes;
  cp_reader reader;
};

std::string ints(size_t count) {
  std::string result;
  for (size_t i = 0; i < count; ++i) result += words({0, 7});
  return result;
}

TEST(Reader, StopsAtTheEndOrBeforeWhatIsNoItem) {
  const std::pair<std::string, int> cases[] = {
      {words({4, 0}), CP_BAD_BUFFER},
      {words({-1, 0}), CP_BAD_BUFFER},
      {words({1, -1}), CP_BAD_BUFFER},
      {words({1, 1016}), CP_BAD_BUFFER},  // the NUL would be behind the end
      {words({1, 2}) + "abc\0"s, CP_BAD_BUFFER},
      {words({1, 1015}), CP_END},
      {words({2, -1}), CP_BAD_BUFFER},
      {words({2, 128}), CP_BAD_BUFFER},
      {words({2, 127}), CP_END},
      {words({2, 2, 0, 1, 1, 0, 0}), CP_BAD_BUFFER},
      {words({3, 1, 0, 1}), CP_BAD_BUFFER},
      {words({3, 1, 3, 0}), CP_BAD_BUFFER},
      {words({3, 2, 1, 1}) + "a\0"s + words({1, 1023}), CP_BAD_BUFFER},
      {words({99}), CP_END},
      {ints(128), CP_END},
      {ints(127) + words({1, 0}), CP_BAD_BUFFER},
      {ints(126) + words({1, 4}) + "abcd", CP_BAD_BUFFER},  // three bytes are left
      {ints(126) + words({1, 3}) + "abc\0"s + words({99}), CP_END},
      {ints(126) + words({1, 3}) + "abc\0"s, CP_BAD_BUFFER}};
  for (const auto& [bytes, expected] : cases) {
    Buffer buffer(bytes);
    const char* before = nullptr;
    cp_item item;
    int status = CP_OK;
    while (status == CP_OK) {
      before = buffer.reader.at;
      status = cp_next(&buffer.reader, &item);
    }
    EXPECT_EQ(status, expected) << testing::PrintToString(bytes);
    EXPECT_EQ(buffer.reader.at, before) << "stays where it was";
  }
}

TEST(Reader, TellsTheLengthOfATextWithANul) {
  Buffer buffer(words({1, 3}) + "a\0b\0"s + words({0, 5}));
  cp_item item;
  int number = 0;
  EXPECT_EQ(cp_next(&buffer.reader, &item), CP_OK);
  EXPECT_EQ(std::string(item.text, item.length), "a\0b"s);
  EXPECT_EQ(cp_next_int(&buffer.reader, &number), CP_OK);
  EXPECT_EQ(number, 5);
}

TEST(Reader, AnItemOfAnotherKindStays) {
  const std::string items[] = {words({CP_INT, 5}), words({CP_STRING, 4}) + "five\0"s,
                               words({CP_INT_ARRAY, 3, 0, 5, 0, 6, 0, 7}),
                               words({CP_STRING_ARRAY, 1, 1, 4}) + "five\0"s, words({99})};
  const auto ask = [](int asked, cp_reader* reader) {
    cp_item item;
    const char* text = nullptr;
    int number = 0;
    return asked == CP_INT      ? cp_next_int(reader, &number)
           : asked == CP_STRING ? cp_next_string(reader, &text)
                                : cp_next_of(reader, static_cast<cp_kind>(asked), &item);
  };
  for (int asked = 0; asked < 4; ++asked) {
    for (int given = 0; given < 5; ++given) {
      Buffer buffer(items[given]);
      EXPECT_EQ(ask(asked, &buffer.reader), given == 4       ? CP_END
                                            : asked == given ? CP_OK
                                                             : CP_WRONG_KIND)
          << asked << given;
      EXPECT_EQ(buffer.reader.at == buffer.bytes.get(), asked != given);
    }
  }
  for (const size_t capacity : {2u, 3u}) {
    Buffer buffer(items[CP_INT_ARRAY]);
    int numbers[3];
    size_t count = 0;
    EXPECT_EQ(cp_next_ints(&buffer.reader, numbers, capacity, &count),
              capacity == 3 ? CP_OK : CP_NO_SPACE);
    EXPECT_EQ(count, capacity == 3 ? 3u : 0u);
    EXPECT_EQ(buffer.reader.at == buffer.bytes.get(), capacity == 2);
  }
}

// Items of random tags, lengths and counts: whatever comes, reading ends and stays inside.
TEST(Reader, StaysInTheBufferWhateverItHolds) {
  std::mt19937 random(20260131);
  const int values[] = {0, 1, 2, 3, 99, 4, 16, 127, 1007, 1015, 1016, INT_MAX, -1};
  for (int round = 0; round < 20000; ++round) {
    Buffer buffer("");
    for (int i = 0; i < 40; ++i) {
      const int word = values[random() % (random() % 4 == 0 ? std::size(values) : 4)];
      std::memcpy(buffer.bytes.get() + random() % 300, &word, sizeof word);
    }
    const char* const end = buffer.reader.end;
    cp_item item, element;
    for (const char* before = buffer.reader.at; cp_next(&buffer.reader, &item) == CP_OK;) {
      ASSERT_GT(buffer.reader.at, before);
      ASSERT_LE(buffer.reader.at, end);
      before = buffer.reader.at;
      int count = 0;
      while (cp_next(&item.elements, &element) == CP_OK) ++count;
      ASSERT_EQ(count, item.count);
      ASSERT_EQ(item.elements.at, item.elements.end);
      ASSERT_TRUE(item.kind != CP_STRING || item.text[item.length] == 0);
    }
  }
}

}  // namespace
