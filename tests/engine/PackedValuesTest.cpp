// The layout of the packed buffers, as literal bytes: words of 32 bits, low byte first.

#include "tests/engine/RecorderTest.h"

#include <climits>
#include <functional>

using namespace std::string_literals;

namespace {

const ProviderDefFunction kFunction("f", 100, nullptr);

const std::string kGap(24, '?');  // What plug-ins leave behind each string of an array.

}  // namespace

// Each fills a buffer to its last byte, and none that is smaller.
TEST(PackedValues, AreWrittenAsPluginsReadThem) {
  const std::pair<std::function<char*(char*, const char*)>, std::string> cases[] = {
      {[](auto... at) { return kFunction.packI(at..., -2); }, words({0, -2})},
      {[](auto... at) { return kFunction.packS(at..., ""); }, words({1, 0}) + "\0"s},
      {[](auto... at) { return kFunction.packS(at..., "a\0b"s); }, words({1, 3}) + "a\0b\0"s},
      {[](auto... at) { return kFunction.packAI(at..., {}); }, words({2, 0})},
      {[](auto... at) {
         return kFunction.packAI(at..., {1, 258});
       },
       words({2, 2, 0, 1, 0, 258})},
      {[](auto... at) { return kFunction.packAS(at..., {}); }, words({3, 0})},
      {[](auto... at) {
         return kFunction.packAS(at..., {"a", "bc"});
       },
       words({3, 2, 1, 1}) + "a\0"s + words({1, 2}) + "bc\0"s},
  };
  for (const auto& [pack, bytes] : cases) {
    for (size_t size = 0; size <= bytes.size(); ++size) {
      std::vector<char> buffer(size);
      char* end = buffer.data();
      const std::string error =
          errorOf([&, &write = pack] { end = write(buffer.data(), buffer.data() + size); });
      const bool fits = size == bytes.size();
      EXPECT_EQ(error, fits ? "" : "The input of function f does not fit into its buffer");
      EXPECT_EQ(std::string(buffer.data(), end), fits ? bytes : "");
    }
  }
}

// No reader looks at the tag, and none beyond the buffer.
TEST(PackedValues, AreReadAsPluginsWriteThem) {
  const auto readI = [](auto... of) { return valueText(kFunction.makeI(of...)); };
  const auto readS = [](auto... of) { return valueText(kFunction.makeS(of...)); };
  const auto readAI = [](auto... of) { return valueText(kFunction.makeAI(of...)); };
  const auto readAS = [](auto... of) { return valueText(kFunction.makeAS(of...)); };
  const struct {
    std::function<std::string(const char*, const char**, const char*)> read;
    std::string item;
    size_t needed, next;  // Bytes; where the next item starts.
    std::string text;
  } cases[] = {
      {readI, words({77, -2}), 8, 8, "0 -2"},
      // A string ends at its NUL, whatever its length says, and the next item starts there.
      {readS, words({77, 99}) + "abc\0?"s, 12, 11, "1 abc"},
      {readS, words({77, 77, 0}), 9, 8, "1 "},
      {readAI, words({77, 2, 77, 1, 77, 258, 77}), 24, 24, "2 {1, 258}"},
      {readAI, words({77, 0}), 8, 8, "2 {}"},
      {readAI, words({77, -1}), 8, 8, "2 {}"},
      {readAS, words({77, 0}), 8, 8, "3 {}"},
      {readAS, words({77, INT_MIN}), 8, 8, "3 {}"},
      // The second string starts 33 bytes and its length behind the start of the first.
      {readAS, words({77, 2, 77, 77}) + "a\0"s + kGap + words({77, 77}) + "bc\0"s + kGap, 53, 77,
       "3 {a, bc}"},
  };
  for (const auto& c : cases) {
    const char* next = nullptr;
    const char* const start = c.item.data();
    EXPECT_EQ(c.read(start, &next, start + c.item.size()), c.text);
    EXPECT_EQ(next - start, static_cast<std::ptrdiff_t>(c.next)) << c.text;
    for (size_t size = 0; size < c.item.size(); ++size) {
      // A copy of exactly this size, so that a sanitizer sees a read beyond it.
      const std::vector<char> exact(start, start + size);
      std::string text;
      const std::string error =
          errorOf([&] { text = c.read(exact.data(), nullptr, exact.data() + size); });
      EXPECT_EQ(text, size < c.needed ? "" : c.text) << size;
      EXPECT_EQ(error,
                size < c.needed ? "The result of function f does not fit into its buffer" : "");
    }
  }
}

class PackedLists : public RecorderTest {};

TEST_F(PackedLists, InputsLeaveOutIndexStringsBooleansAndLongs) {
  Values outputs;
  const std::string items =
      words({0, 7, 1, 5}) + "seven\0"s + words({2, 1, 0, 7}) + words({3, 1, 1, 5}) + "seven\0"s;
  answer("\x63");
  function("getIv").get(oneOfEachType());
  EXPECT_EQ(trimmed(recorder_->extra), trimmed(items));
  function("setIv").set(1, oneOfEachType());
  EXPECT_EQ(trimmed(recorder_->extra), trimmed(items));
  function("execB").exec(oneOfEachType());
  EXPECT_EQ(trimmed(recorder_->in), items + "\x63");
  function("execC").exec(oneOfEachType(), outputs);
  EXPECT_EQ(trimmed(recorder_->in), items + "\x63");
  function("execB").exec(Values());
  EXPECT_EQ(trimmed(recorder_->in), "\x63");
}

TEST_F(PackedLists, OutputsAreReadUpToTheEndMark) {
  const std::string text = words({1, 2}) + "ab", end = words({99});
  const std::pair<std::string, std::string> cases[] = {
      {end, ""},
      {words({0, 5, 99, 0, 6}), "0 5; "},
      {words({2, 2, 77, 1, 77, 2, 0, 5, 99}), "2 {1, 2}; 0 5; "},
      {words({3, 2, 77, 77}) + "a\0"s + kGap + words({77, 77}) + "bc\0"s + kGap + end,
       "3 {a, bc}; "},
      // An integer's tag begins with the NUL of the string before it.
      {text + words({0, 5, 99}), "1 ab; 0 5; "},
      // The other tags cannot: they stand behind the NUL.
      {text + "\0"s + end, "1 ab; "},
      {text + "\0"s + words({1, 1}) + "c\0"s + words({1, 0}) + "\0"s + end, "1 ab; 1 c; 1 ; "},
      {text + "\0"s + words({3, 0, 99}), "1 ab; 3 {}; "},
      // Only behind a string: elsewhere a tag stands where the item before it ends.
      {words({0, 5}) + "\0"s + words({1, 1}) + "c\0"s, "0 5; "},
  };
  recorder_->result = -3;
  for (const auto& [bytes, expected] : cases) {
    answer(bytes);
    Values outputs{"kept"};
    EXPECT_EQ(function("execC").exec(Values(), outputs), -3);
    EXPECT_EQ(valueText(outputs), "1 kept; " + expected) << testing::PrintToString(bytes);
  }
}

TEST_F(PackedLists, EndAnywhereWithinTheBuffer) {
  std::string integers;
  for (int i = 0; i < 127; ++i) integers += words({0, 1});
  for (const size_t gap : {0u, 4u}) {  // An unknown tag ends the list, too.
    answer(integers + std::string(gap, '?') + "\x63");
    Values outputs;
    EXPECT_EQ(errorOf([&] { function("execC").exec(Values(), outputs); }), "");
    EXPECT_EQ(outputs.size(), 127u);
  }
  answer(words({1, 77}) + std::string(1011, 'x') + "\0\x63\0\0\0"s);
  Values outputs;
  function("execC").exec(Values(), outputs);
  EXPECT_EQ(valueText(outputs), "1 " + std::string(1011, 'x') + "; ");
}

// What fits exactly arrives; one byte more is an error, and the plug-in is not called.
TEST_F(PackedLists, InputsFitUpTo1024Bytes) {
  Values outputs;
  answer("\x63");
  for (const bool over : {true, false}) {
    const Ints ints(over ? 128 : 127, 9);
    const Values list{7, std::string(over ? 1004 : 1003, 'x')};
    const std::pair<const char*, std::function<void()>> calls[] = {
        {"setAI", [&] { function("setAI").set(ints); }},
        {"setIv", [&] { function("setIv").set(1, ints); }},
        {"getIv", [&] { function("getIv").get(Texts{std::string(over ? 1008 : 1007, 'x')}); }},
        {"execB", [&] { function("execB").exec(list); }},
        {"execC", [&] { function("execC").exec(list, outputs); }},
        {"execCv", [&] { function("execCv").exec(ints, {}, outputs); }},
    };
    for (const auto& [name, call] : calls) {
      recorder_->calls = 0;
      EXPECT_EQ(errorOf(call),
                over ? "The input of function "s + name + " does not fit into its buffer" : "");
      EXPECT_EQ(recorder_->calls, over ? 0 : 1) << name;
    }
  }
}

// Strings that are not packed have no limit.
TEST_F(PackedLists, PlainStringsHaveNoLimit) {
  const std::string text(100000, 'x');
  function("setSw").set(text, text);
  EXPECT_EQ(recorder_->text, std::string(1023, 'x'));
  EXPECT_EQ(recorder_->word, std::string(1023, 'x'));
}
