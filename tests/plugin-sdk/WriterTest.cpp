// What the header writes: as bytes, and where the buffer ends.

#include "tests/engine/RecorderTest.h"

#include "commonprovider/plugin.h"

#include <functional>

using namespace std::string_literals;

namespace {

// A buffer full of question marks, with more of them behind it.
struct Buffer {
  std::string bytes = std::string(CP_BUFFER_SIZE + 64, '?');

  /// What was written, up to the last byte that is no question mark.
  std::string written() const {
    EXPECT_EQ(bytes.substr(CP_BUFFER_SIZE), std::string(64, '?'));
    return bytes.substr(0, bytes.find_last_not_of('?') + 1);
  }
};

const std::string kGap(CP_STRING_GAP, '?');
const char* const kTexts[] = {"a", "bc"};
const std::string kPackedTexts =
    words({3, 2, 1, 1}) + "a\0"s + kGap + words({1, 2}) + "bc\0"s;  // without the last gap
const int kInts[] = {7, -1};

// RoundTrip writes every sequence of items.
TEST(Writer, LaysListsAsTheProviderReadsThem) {
  Buffer buffer;
  cp_writer writer = cp_write_list(&buffer.bytes[0]);
  cp_put_strings(&writer, kTexts, 2);
  cp_put_string(&writer, "ok");
  cp_put_string(&writer, "");
  cp_put_ints(&writer, kInts, 1);
  cp_put_string(&writer, "ok");
  cp_put_int(&writer, -2);
  EXPECT_EQ(cp_finish(&writer), CP_OK);
  EXPECT_EQ(buffer.written(), kPackedTexts + kGap + words({1, 2}) + "ok\0"s + words({1, 0}) +
                                  "\0"s + words({2, 1, 0, 7, 1, 2}) + "ok" + words({0, -2, 99}));
}

TEST(Writer, LaysResultsAsTheProviderReadsThem) {
  Buffer text, ints, texts;
  EXPECT_EQ(cp_return_string(&text.bytes[0], "abc"), CP_OK);
  EXPECT_EQ(text.written(), "abc\0"s);
  EXPECT_EQ(cp_return_ints(&ints.bytes[0], kInts, 2), CP_OK);
  EXPECT_EQ(ints.written(), words({2, 2, 0, 7, 0, -1}));
  EXPECT_EQ(cp_return_strings(&texts.bytes[0], kTexts, 2), CP_OK);
  EXPECT_EQ(texts.written(), kPackedTexts);

  // They fill a buffer to its end, or are empty.
  EXPECT_EQ(cp_return_string(&text.bytes[0], std::string(1023, 'x').c_str()), CP_OK);
  EXPECT_EQ(text.written(), std::string(1023, 'x') + "\0"s);
  EXPECT_EQ(cp_return_string(&text.bytes[0], std::string(1024, 'x').c_str()), CP_NO_SPACE);
  EXPECT_EQ(text.bytes[0], '\0');
  for (const int count : {127, 128}) {
    const std::vector<int> numbers(128, 5);
    const bool fits = count == 127;
    EXPECT_EQ(cp_return_ints(&ints.bytes[0], numbers.data(), static_cast<size_t>(count)),
              fits ? CP_OK : CP_NO_SPACE);
    EXPECT_EQ(ints.written().substr(0, 8), words({2, fits ? 127 : 0}));
  }
  for (const size_t length : {974u, 975u}) {
    const std::string first(length, 'x');
    const char* const two[] = {first.c_str(), ""};
    EXPECT_EQ(cp_return_strings(&texts.bytes[0], two, 2), length == 974 ? CP_OK : CP_NO_SPACE);
    EXPECT_EQ(texts.written().substr(0, 8), words({3, length == 974 ? 2 : 0}));
  }
}

TEST(Writer, RefusesWhatDoesNotBelongThere) {
  Buffer buffer;
  cp_writer list = cp_write_list(&buffer.bytes[0]);
  EXPECT_EQ(cp_add_int(&list, 1), CP_WRONG_KIND);
  cp_begin_ints(&list);
  EXPECT_EQ(cp_add_string(&list, "a"), CP_WRONG_KIND);
  cp_put_int(&list, 1);
  EXPECT_EQ(cp_add_int(&list, 1), CP_WRONG_KIND) << "closed by the item behind it";
  cp_writer ints = cp_write_ints(&buffer.bytes[0]);
  EXPECT_EQ(cp_put_int(&ints, 1), CP_WRONG_KIND);
  EXPECT_EQ(cp_begin_strings(&ints), CP_WRONG_KIND);
  EXPECT_EQ(cp_add_int(&ints, 1), CP_OK);
  EXPECT_EQ(buffer.bytes.substr(0, 16), words({2, 1, 0, 1}));
}

class WriterAtTheEnd : public RecorderTest {
 protected:
  std::string read(const Buffer& buffer) {
    buffer.written();
    answer(buffer.bytes.substr(0, CP_BUFFER_SIZE));
    Values outputs;
    EXPECT_EQ(errorOf([&] { function("execC").exec(Values(), outputs); }), "");
    return valueText(outputs);
  }
};

struct Step {
  std::function<int(cp_writer*)> write;
  ProviderDefValue value;
  int most;  // Bytes of a text before it, so that it still fits.
};

// A text of every length, then one more item: it arrives whole or not at all, and so does the list.
TEST_F(WriterAtTheEnd, EveryItemFitsToTheLastByte) {
  const Step steps[] = {
      {[](cp_writer* w) { return cp_put_int(w, 5); }, 5, 1011 - 7},
      {[](cp_writer* w) { return cp_put_string(w, "abc"); }, "abc", 1011 - 12},
      {[](cp_writer* w) { return cp_put_ints(w, kInts, 2); }, Ints{7, -1}, 1011 - 24},
      {[](cp_writer* w) { return cp_put_strings(w, kTexts, 2); }, Texts{"a", "bc"}, 1011 - 77},
      {[](cp_writer* w) { return cp_begin_ints(w); }, Ints(), 1011 - 8},
      {[](cp_writer* w) { return cp_begin_strings(w); }, Texts(), 1011 - 8}};
  for (const Step& step : steps) {
    for (int length = step.most - 2; length <= 1013; ++length) {
      SCOPED_TRACE(length);
      const std::string text(static_cast<size_t>(length), 'x');
      Buffer buffer;
      cp_writer writer = cp_write_list(&buffer.bytes[0]);
      const int first = cp_put_string(&writer, text.c_str());
      const int second = step.write(&writer);
      EXPECT_EQ(first, length <= 1011 ? CP_OK : CP_NO_SPACE);
      EXPECT_EQ(second, length <= step.most ? CP_OK : CP_NO_SPACE);
      EXPECT_FALSE(second != CP_OK && cp_put_int(&writer, 1) == CP_OK) << "gap before an item";
      EXPECT_EQ(read(buffer).substr(0, 2), first == CP_OK ? "1 " : "") << "without cp_finish";
      EXPECT_EQ(cp_finish(&writer), second);
      Values expected;
      if (first == CP_OK) expected.push_back(text);
      if (second == CP_OK) expected.push_back(step.value);
      EXPECT_EQ(read(buffer), valueText(expected));
    }
  }
}

// Elements added one by one until none fits; the array keeps those that did.
TEST_F(WriterAtTheEnd, ArraysKeepWhatFits) {
  Buffer buffer;
  cp_writer ints = cp_write_list(&buffer.bytes[0]);
  cp_begin_ints(&ints);
  int count = 0;
  while (cp_add_int(&ints, 3) == CP_OK) ++count;
  EXPECT_EQ(count, 126);
  EXPECT_EQ(cp_put_int(&ints, 5), CP_NO_SPACE);
  EXPECT_EQ(read(buffer), valueText(Values{Ints(126, 3)}));

  cp_writer texts = cp_write_list(&buffer.bytes[0]);
  cp_begin_strings(&texts);
  for (count = 0; cp_add_string(&texts, "name") == CP_OK;) ++count;
  EXPECT_EQ(count, (1024 - 8 - 4) / 37);
  EXPECT_EQ(cp_add_string(&texts, std::string(100000, 'x').c_str()), CP_NO_SPACE);
  EXPECT_EQ(cp_finish(&texts), CP_OK);
  EXPECT_EQ(read(buffer), valueText(Values{Texts(27, "name")}));
}

}  // namespace
