// The layout of the packed buffers, as literal bytes: words of 32 bits, low byte first.

#include "tests/engine/RecorderTest.h"

#include <functional>

using namespace std::string_literals;

namespace {

const ProviderDefFunction kFunction("f", 100, nullptr);

// What `pack` writes into a buffer of `size` bytes; checks the position that it returns.
template <class Pack>
std::string packed(Pack pack, size_t size = 1024) {
  std::string buffer(size, '?');
  const char* end = pack(buffer.data(), buffer.data() + size);
  return buffer.substr(0, static_cast<size_t>(end - buffer.data()));
}

std::string packI(int value, size_t size = 1024) {
  return packed([&](char* at, char* end) { return kFunction.packI(at, end, value); }, size);
}
std::string packS(const std::string& value, size_t size = 1024) {
  return packed([&](char* at, char* end) { return kFunction.packS(at, end, value); }, size);
}
std::string packAI(const Ints& values, size_t size = 1024) {
  return packed([&](char* at, char* end) { return kFunction.packAI(at, end, values); }, size);
}
std::string packAS(const Texts& values, size_t size = 1024) {
  return packed([&](char* at, char* end) { return kFunction.packAS(at, end, values); }, size);
}

const std::string kGap(24, '?');  // What plug-ins leave behind each string of an array.

const char kInputError[] = "The input of function f does not fit into its buffer";
const char kResultError[] = "The result of function f does not fit into its buffer";

}  // namespace

TEST(PackedValues, AreWrittenAsPluginsReadThem) {
  EXPECT_EQ(packI(7), "\0\0\0\0\x07\0\0\0"s);
  EXPECT_EQ(packI(-2), "\0\0\0\0\xfe\xff\xff\xff"s);
  EXPECT_EQ(packS("abc"), "\1\0\0\0\3\0\0\0abc\0"s);
  EXPECT_EQ(packS(""), "\1\0\0\0\0\0\0\0\0"s);
  EXPECT_EQ(packS("a\0b"s), "\1\0\0\0\3\0\0\0a\0b\0"s);
  EXPECT_EQ(packAI({}), "\2\0\0\0\0\0\0\0"s);
  EXPECT_EQ(packAI({1, 258}),
            "\2\0\0\0\2\0\0\0"
            "\0\0\0\0\1\0\0\0"
            "\0\0\0\0\2\1\0\0"s);
  EXPECT_EQ(packAS({}), "\3\0\0\0\0\0\0\0"s);
  EXPECT_EQ(packAS({"a", "bc"}),
            "\3\0\0\0\2\0\0\0"
            "\1\0\0\0\1\0\0\0a\0"
            "\1\0\0\0\2\0\0\0bc\0"s);
}

TEST(PackedValues, FillABufferToItsLastByteAndNoFurther) {
  const std::pair<std::function<std::string(size_t)>, size_t> cases[] = {
      {[](size_t size) { return packI(7, size); }, 8},
      {[](size_t size) { return packS("", size); }, 9},
      {[](size_t size) { return packS("abc", size); }, 12},
      {[](size_t size) { return packAI(Ints(), size); }, 8},
      {[](size_t size) { return packAI(Ints(2, 1), size); }, 24},
      {[](size_t size) { return packAS(Texts(), size); }, 8},
      {[](size_t size) { return packAS(Texts(2, "bc"), size); }, 30},
  };
  for (const auto& [pack, needed] : cases) {
    EXPECT_EQ(pack(needed).size(), needed);
    for (size_t size = 0; size < needed; ++size) {
      EXPECT_EQ(errorOf([&, &write = pack] { write(size); }), kInputError)
          << size << " of " << needed;
    }
  }
}

TEST(PackedValues, AreReadAsPluginsWriteThem) {
  const auto read = [](auto make, const std::string& item, size_t length) {
    const char* next = nullptr;
    const auto value = make(item.data(), &next, item.data() + item.size());
    EXPECT_EQ(next - item.data(), static_cast<std::ptrdiff_t>(length));
    return value;
  };
  const auto makeI = [](auto... of) { return kFunction.makeI(of...); };
  const auto makeS = [](auto... of) { return kFunction.makeS(of...); };
  const auto makeAI = [](auto... of) { return kFunction.makeAI(of...); };
  const auto makeAS = [](auto... of) { return kFunction.makeAS(of...); };

  // No reader looks at the tag; a string ends at its NUL, whatever its length word says, and the
  // next item starts there.
  EXPECT_EQ(read(makeI, "????\xfe\xff\xff\xff"s, 8), -2);
  EXPECT_EQ(read(makeS, "????\x63\0\0\0abc\0?"s, 11), "abc");
  EXPECT_EQ(read(makeS, "????????\0"s, 8), "");
  EXPECT_EQ(read(makeAI,
                 "????\2\0\0\0"
                 "????\1\0\0\0"
                 "????\2\1\0\0"
                 "????"s,
                 24),
            (Ints{1, 258}));
  EXPECT_EQ(read(makeAI, "????\0\0\0\0"s, 8), Ints());
  EXPECT_EQ(read(makeAI, "????\xff\xff\xff\xff"s, 8), Ints());
  EXPECT_EQ(read(makeAS, "????\0\0\0\0"s, 8), Texts());
  EXPECT_EQ(read(makeAS, "????\x80\x80\x80\x80"s, 8), Texts());
  // The second string starts 33 bytes and its length behind the start of the first.
  EXPECT_EQ(read(makeAS,
                 "????\2\0\0\0"
                 "????????a\0"s +
                     kGap + "????????bc\0"s + kGap,
                 77),
            (Texts{"a", "bc"}));
}

TEST(PackedValues, AreNotReadBeyondTheBuffer) {
  const std::string strings =
      "????\2\0\0\0"
      "????????a\0"s +
      kGap + "????????bc\0"s;
  const auto failsBelow = [](size_t needed, const std::string& item, auto make) {
    for (size_t size = 0; size < needed; ++size) {
      // A copy of exactly this size, so that a sanitizer sees a read beyond it.
      const std::vector<char> exact(item.begin(), item.begin() + static_cast<std::ptrdiff_t>(size));
      EXPECT_EQ(errorOf([&] { make(exact.data(), nullptr, exact.data() + size); }), kResultError)
          << size << " of " << needed;
    }
    make(item.data(), nullptr, item.data() + needed);
  };
  failsBelow(8, "????????", [](auto... of) { return kFunction.makeI(of...); });
  failsBelow(12, "????????abc\0"s, [](auto... of) { return kFunction.makeS(of...); });
  failsBelow(24, "????\2\0\0\0????????????????"s,
             [](auto... of) { return kFunction.makeAI(of...); });
  failsBelow(strings.size(), strings, [](auto... of) { return kFunction.makeAS(of...); });
}

class PackedLists : public RecorderTest {};

TEST_F(PackedLists, InputsLeaveOutIndexStringsBooleansAndLongs) {
  Values outputs;
  const std::string items =
      "\0\0\0\0\7\0\0\0"
      "\1\0\0\0\5\0\0\0seven\0"
      "\2\0\0\0\1\0\0\0"
      "\0\0\0\0\7\0\0\0"
      "\3\0\0\0\1\0\0\0"
      "\1\0\0\0\5\0\0\0seven\0"s;
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
  const std::pair<std::string, std::string> cases[] = {
      {"\x63\0\0\0"s, ""},
      {"\0\0\0\0\5\0\0\0"
       "\x63\0\0\0"
       "\0\0\0\0\6\0\0\0"s,
       "0 5; "},
      {"\2\0\0\0\2\0\0\0"
       "????\1\0\0\0"
       "????\2\0\0\0"
       "\0\0\0\0\5\0\0\0"
       "\x63\0\0\0"s,
       "2 {1, 2}; 0 5; "},
      {"\3\0\0\0\2\0\0\0"
       "????????a\0"s +
           kGap + "????????bc\0"s + kGap + "\x63\0\0\0"s,
       "3 {a, bc}; "},
      // An integer's tag begins with the NUL of the string before it.
      {"\1\0\0\0\2\0\0\0ab"
       "\0\0\0\0\5\0\0\0"
       "\x63\0\0\0"s,
       "1 ab; 0 5; "},
      // The other tags cannot: they stand behind the NUL.
      {"\1\0\0\0\2\0\0\0ab\0"
       "\x63\0\0\0"s,
       "1 ab; "},
      {"\1\0\0\0\2\0\0\0ab\0"
       "\1\0\0\0\1\0\0\0c\0"
       "\1\0\0\0\0\0\0\0\0"
       "\x63\0\0\0"s,
       "1 ab; 1 c; 1 ; "},
      {"\1\0\0\0\2\0\0\0ab\0"
       "\3\0\0\0\0\0\0\0"
       "\x63\0\0\0"s,
       "1 ab; 3 {}; "},
      // Only behind a string: elsewhere a tag stands where the item before it ends.
      {"\0\0\0\0\5\0\0\0"
       "\0\1\0\0\0\1\0\0\0c\0"s,
       "0 5; "},
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
  const std::string integer = "\0\0\0\0\1\0\0\0"s;
  std::string bytes;
  for (int i = 0; i < 127; ++i) bytes += integer;
  for (const size_t offset : {1016u, 1020u}) {
    answer(bytes + std::string(offset - 1016, '?') + "\x63");
    Values outputs;
    const std::string error = errorOf([&] { function("execC").exec(Values(), outputs); });
    EXPECT_EQ(outputs.size(), 127u);
    EXPECT_EQ(error, "") << "an unknown tag ends the list, too";
  }
  answer("\1\0\0\0????"s + std::string(1011, 'x') + "\0\x63\0\0\0"s);
  Values outputs;
  function("execC").exec(Values(), outputs);
  EXPECT_EQ(valueText(outputs), "1 " + std::string(1011, 'x') + "; ");
}

// What fits exactly arrives; one byte more is an error, and the plug-in is not called.
TEST_F(PackedLists, InputsFitUpTo1024Bytes) {
  const auto text = [](size_t size) { return std::string(size, 'x'); };
  const auto list = [&](size_t size) { return Values{7, text(size)}; };
  Values outputs;
  const struct {
    const char* function;
    std::function<void(bool)> call;
  } cases[] = {
      {"setAI", [&](bool over) { function("setAI").set(Ints(over ? 128 : 127, 9)); }},
      {"setIv", [&](bool over) { function("setIv").set(1, Ints(over ? 128 : 127, 9)); }},
      {"getIv", [&](bool over) { function("getIv").get(Texts{text(over ? 1008 : 1007)}); }},
      {"execB", [&](bool over) { function("execB").exec(list(over ? 1004 : 1003)); }},
      {"execC", [&](bool over) { function("execC").exec(list(over ? 1004 : 1003), outputs); }},
      {"execCv",
       [&](bool over) { function("execCv").exec(Ints(over ? 128 : 127, 9), {}, outputs); }},
  };
  answer("\x63");
  for (const auto& c : cases) {
    recorder_->calls = 0;
    EXPECT_EQ(errorOf([&] { c.call(true); }),
              "The input of function "s + c.function + " does not fit into its buffer");
    EXPECT_EQ(recorder_->calls, 0) << c.function;
    EXPECT_EQ(errorOf([&] { c.call(false); }), "");
    EXPECT_EQ(recorder_->calls, 1) << c.function;
  }
}

// Strings that are not packed have no limit.
TEST_F(PackedLists, PlainStringsHaveNoLimit) {
  const std::string text(100000, 'x');
  function("setSw").set(text, text);
  EXPECT_EQ(recorder_->text, std::string(1023, 'x'));
  EXPECT_EQ(recorder_->word, std::string(1023, 'x'));
}
