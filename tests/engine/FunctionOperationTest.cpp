// Every operation of a function on every calling type: what is called, and what arrives.

#include "tests/engine/RecorderTest.h"
#include "tests/support/LogLevel.h"

#include <climits>
#include <functional>

using namespace std::string_literals;

namespace {

using Function = ProviderDefFunction;
using Value = const ProviderDefValue&;

const Values kInputs{7, "ab"};
Values outputs;

/// Calls the types with codes from `first` to `last` whose last digit is one of `suffixes`. On the
/// others, the result is 0, or 99 from exec.
struct Operation {
  int first, last;
  std::string suffixes;
  std::function<ProviderDefValue(Function&, Value data, Value extra)> run;
  bool checksType = false;  // Refuses an extra value whose type does not fit the function, too.

  bool calls(int code) const {
    return code >= first && code <= last &&
           suffixes.find(std::to_string(code % 10)) != std::string::npos;
  }
};

const Operation kOperations[] = {
    {0, 39, "0", [](Function& f, Value data, Value) { return f.set(data); }},
    {0, 39, "123", [](Function& f, Value data, Value extra) { return f.set(data, extra); }},
    {0, 39, "3", [](Function& f, Value data, Value extra) { return f.set(data, Values{extra}); }},
    {100, 149, "0", [](Function& f, Value, Value) { return f.get(); }},
    {100, 149, "123", [](Function& f, Value, Value extra) { return f.get(extra); }, true},
    {100, 149, "3", [](Function& f, Value, Value extra) { return f.get(Values{extra}); }},
    {200, 209, "0", [](Function& f, Value, Value) { return f.exec(); }},
    {200, 209, "0123", [](Function& f, Value, Value extra) { return f.exec(extra); }, true},
    {220, 229, "0", [](Function& f, Value, Value) { return f.exec(kInputs); }},
    {220, 229, "0123", [](Function& f, Value, Value extra) { return f.exec(extra, kInputs); },
     true},
    {230, 239, "0", [](Function& f, Value, Value) { return f.exec(kInputs, outputs); }},
    {230, 239, "0123",
     [](Function& f, Value, Value extra) { return f.exec(extra, kInputs, outputs); }, true},
};

// By family of the set types, and as it arrives in a buffer.
const std::pair<ProviderDefValue, std::string> kData[] = {
    {-5, ""},
    {"text", ""},
    {Ints{1, -1}, words({2, 2, 0, 1, 0, -1})},
    {Texts{"a", "bc"}, words({3, 2, 1, 1}) + "a\0"s + words({1, 2}) + "bc"},
};
const std::string kPackedInputs = words({0, 7, 1, 2}) + "ab\0"s + words({99});

// What the buffer answers to the types of a family, and the result. All other types give the
// plug-in's number.
const std::tuple<int, std::string, const char*> kAnswers[] = {
    {110, "caf\xe9\0?"s, "1 caf\xe9"},
    {120, words({77, 2, 77, 1, 77, -1}), "2 {1, -1}"},
    {130, words({77, 2, 77, 77}) + "a\0"s + std::string(32, '?') + "bc\0"s, "3 {a, bc}"},
    {230, words({99}), "0 -6"},
};

// Whether a value is one for the functions with a suffix: an integer, a string, an array.
bool fits(int suffix, Value extra) {
  const int type = extra.getType();
  return suffix == 0 || (suffix == 3 ? type == 2 || type == 3 : type == suffix - 1);
}

class FunctionOperation : public RecorderTest {
 protected:
  // Prepares the plug-in's answer to a call of this type; gives the result that it makes.
  std::string prepare(int code) {
    *recorder_ = Recorder();
    recorder_->result = -6;
    recorder_->longResult = -1234567890L;
    if (code / 10 == 14) return "6 -1234567890";
    for (const auto& [family, bytes, result] : kAnswers) {
      if (code / 10 * 10 != family) continue;
      answer(bytes);
      return result;
    }
    return "0 -6";
  }

  void expectReceived(int code, Value extra) const {
    if (code < 100) {
      EXPECT_EQ(recorder_->value, code < 10 ? -5 : 0);
      EXPECT_STREQ(recorder_->text, code / 10 == 1 ? "text" : "");
      EXPECT_EQ(trimmed(recorder_->in), trimmed(kData[code / 10].second));
    } else if (code >= 220) {
      EXPECT_EQ(trimmed(recorder_->in), trimmed(kPackedInputs));
    }
    const int suffix = code % 10;
    const std::string array =
        extra.getType() == 2 ? words({2, 1, 0, 7}) : words({3, 1, 1, 5}) + "seven";
    EXPECT_EQ(recorder_->number, suffix == 1 ? 7 : 0);
    EXPECT_STREQ(recorder_->word, suffix == 2 ? "seven" : "");
    EXPECT_EQ(trimmed(recorder_->extra), suffix == 3 ? trimmed(array) : "");
  }

  // Calls with all extra values, or those that fit where the operation does not check them.
  void expectCall(const Operation& operation, int code, const std::string& type) {
    for (const ProviderDefValue& extra : oneOfEachType()) {
      const bool fit = fits(code % 10, extra);
      if (!fit && !operation.checksType) continue;
      SCOPED_TRACE(type + " with " + valueText(extra));
      const bool called = operation.calls(code) && fit;
      const std::string expected = prepare(code);
      const auto& data = kData[code < 100 ? code / 10 : 0].first;
      const ProviderDefValue result = operation.run(function(type), data, extra);
      EXPECT_EQ(recorder_->calls, called ? 1 : 0);
      EXPECT_EQ(valueText(result), called ? expected : operation.first < 200 ? "0 0" : "0 99");
      if (!called) continue;
      EXPECT_EQ(recorder_->function, type);
      expectReceived(code, extra);
    }
  }
};

}  // namespace

TEST_F(FunctionOperation, CallsItsTypesAndRefusesTheOthers) {
  for (const Operation& operation : kOperations) {
    SCOPED_TRACE(&operation - kOperations);
    for (size_t slot = 0; slot < kFunctionTypes; ++slot) {
      expectCall(operation, function_type_number_table[slot], function_type_name_table[slot]);
    }
  }
  EXPECT_TRUE(outputs.empty());
}

// The field that the function's type names, whatever the value's own type.
TEST_F(FunctionOperation, SetReadsTheFieldOfItsFamilyAndSuffix) {
  for (const ProviderDefValue& value : oneOfEachType()) {
    SCOPED_TRACE(valueText(value));
    *recorder_ = Recorder();
    function("setI").set(value);
    function("setS").set(value);
    EXPECT_EQ(recorder_->value, value.getIntValue());
    EXPECT_EQ(recorder_->text, value.getStringValue());
    function("setAI").set(value);
    EXPECT_EQ(recorder_->in[4], value.getIntArray().size());
    function("setAS").set(value);
    EXPECT_EQ(recorder_->in[4], value.getStringArray().size());
    function("setIi").set(1, value);
    function("setIw").set(1, value);
    EXPECT_EQ(recorder_->number, value.getIntValue());
    EXPECT_EQ(recorder_->word, value.getStringValue());
    EXPECT_EQ(recorder_->calls, 6);
    function("setIv").set(1, value);  // An array or nothing.
    EXPECT_EQ(recorder_->calls, fits(3, value) ? 7 : 6);
  }
}

TEST_F(FunctionOperation, NumbersKeepEveryBit) {
  for (const long number : {0L, -1L, long{INT_MIN}, long{INT_MAX}, LONG_MIN, LONG_MAX}) {
    recorder_->longResult = number;
    recorder_->result = static_cast<int>(number);
    EXPECT_EQ(function("getL").get().getLongValue(), number);
    EXPECT_EQ(function("getI").get().getIntValue(), static_cast<int>(number));
    function("setI").set(static_cast<int>(number));
    EXPECT_EQ(recorder_->value, static_cast<int>(number));
  }
}

TEST_F(FunctionOperation, CallsAreLoggedWithTheirType) {
  const LogLevel level(8);
  recorder_->longResult = 12;
  const std::pair<std::function<void()>, const char*> cases[] = {
      {[&] { function("getI").get(); }, "ProviderDefFunction::get(void) Type:100\n"},
      {[&] { function("execA").exec(); }, "ProviderDefFunction::exec(void) Type:200\n"},
      {[&] { function("execB").exec(Values()); }, "ProviderDefFunction::exec(void) Type:220\n"},
      {[&] { function("setI").exec(); }, "ProviderDefFunction::exec(void) Type:0\n"},
      {[&] { function("getLi").get(7); }, "DEBUG function call getLi: 12\n"},
      {[&] { function("getIi").get(7); }, ""},
  };
  for (const auto& [call, line] : cases) {
    call();  // Loaded now: loading logs lines of its own.
    std::filesystem::remove(tree_.logs() / "CommonProvider.log");
    call();
    EXPECT_EQ(tree_.log(), line);
  }
}
