// Every operation of a function on every calling type: what is called, and what arrives.

#include "tests/engine/RecorderTest.h"
#include "tests/support/LogLevel.h"

#include <algorithm>
#include <climits>
#include <functional>

using namespace std::string_literals;

namespace {

using Function = ProviderDefFunction;
using Value = const ProviderDefValue&;

struct Operation {
  const char* name;
  std::vector<int> codes;  // Of the types that it calls.
  bool checksType;         // Refuses an extra value whose type does not fit the function, too.
  std::function<ProviderDefValue(Function&, Value data, Value extra)> run;

  /// The result for all other types.
  int refused() const { return codes[0] >= 200 ? 99 : 0; }
};

const Values kInputs{7, "ab"};
Values ignored;

const Operation kOperations[] = {
    {"set_value",
     {0, 10, 20, 30},
     false,
     [](Function& f, Value data, Value) -> ProviderDefValue { return f.set(data); }},
    {"set_value_value",
     {1, 2, 3, 11, 12, 13, 21, 22, 23, 31, 32, 33},
     false,
     [](Function& f, Value data, Value extra) -> ProviderDefValue { return f.set(data, extra); }},
    {"set_value_vector",
     {3, 13, 23, 33},
     false,
     [](Function& f, Value data, Value extra) -> ProviderDefValue {
       return f.set(data, Values{extra});
     }},
    {"get", {100, 110, 120, 130, 140}, false, [](Function& f, Value, Value) { return f.get(); }},
    {"get_value",
     {101, 102, 103, 111, 112, 113, 121, 122, 123, 131, 132, 133, 141, 142, 143},
     true,
     [](Function& f, Value, Value extra) { return f.get(extra); }},
    {"get_vector",
     {103, 113, 123, 133, 143},
     false,
     [](Function& f, Value, Value extra) { return f.get(Values{extra}); }},
    {"exec", {200}, false, [](Function& f, Value, Value) -> ProviderDefValue { return f.exec(); }},
    {"exec_value",
     {200, 201, 202, 203},
     true,
     [](Function& f, Value, Value extra) -> ProviderDefValue { return f.exec(extra); }},
    {"exec_vector",
     {220},
     false,
     [](Function& f, Value, Value) -> ProviderDefValue { return f.exec(kInputs); }},
    {"exec_value_vector",
     {220, 221, 222, 223},
     true,
     [](Function& f, Value, Value extra) -> ProviderDefValue { return f.exec(extra, kInputs); }},
    {"exec_vector_outputs",
     {230},
     false,
     [](Function& f, Value, Value) -> ProviderDefValue { return f.exec(kInputs, ignored); }},
    {"exec_value_vector_outputs",
     {230, 231, 232, 233},
     true,
     [](Function& f, Value, Value extra) -> ProviderDefValue {
       return f.exec(extra, kInputs, ignored);
     }},
};

// By family of the set types.
const ProviderDefValue kData[] = {-5, "text", Ints{1, -1}, Texts{"a", "bc"}};
// By suffix; a function without one takes none.
const ProviderDefValue kExtras[] = {7, 7, "seven", Ints{7}};
const std::string kPackedExtra =
    "\2\0\0\0\1\0\0\0"
    "\0\0\0\0\7\0\0\0"s;
// By family.
const std::string kPackedData[] = {"", "",
                                   "\2\0\0\0\2\0\0\0"
                                   "\0\0\0\0\1\0\0\0"
                                   "\0\0\0\0\xff\xff\xff\xff"s,
                                   "\3\0\0\0\2\0\0\0"
                                   "\1\0\0\0\1\0\0\0a\0"
                                   "\1\0\0\0\2\0\0\0bc\0"s};
const std::string kPackedInputs =
    "\0\0\0\0\7\0\0\0"
    "\1\0\0\0\2\0\0\0ab\0"
    "\x63\0\0\0"s;

// What the buffer answers to a type, and the result. All other types give the plug-in's number.
struct Answer {
  int family;
  std::string bytes;
  const char* result;
};
const Answer kAnswers[] = {
    {110, "caf\xe9\0?"s, "1 caf\xe9"},
    {120,
     "\2\0\0\0\2\0\0\0"
     "????\1\0\0\0"
     "????\xff\xff\xff\xff"s,
     "2 {1, -1}"},
    {130,
     "\3\0\0\0\2\0\0\0"
     "????????a\0"s +
         std::string(24, '?') + "????????bc\0"s,
     "3 {a, bc}"},
    {230, "\x63\0\0\0"s, "0 -6"},
};

class FunctionOperation : public RecorderTest, public testing::WithParamInterface<Operation> {
 protected:
  static bool accepts(int code) {
    const auto& codes = GetParam().codes;
    return std::find(codes.begin(), codes.end(), code) != codes.end();
  }

  // Prepares the plug-in's answer to a call of this type; gives the result that it makes.
  std::string prepare(int code) {
    *recorder_ = Recorder();
    recorder_->result = -6;
    recorder_->longResult = -1234567890L;
    if (code >= 140 && code < 150) return "6 -1234567890";
    for (const Answer& known : kAnswers) {
      if (code / 10 * 10 != known.family) continue;
      answer(known.bytes);
      return known.result;
    }
    return "0 -6";
  }

  void expectReceived(int code) const {
    if (code < 100) {
      EXPECT_EQ(recorder_->value, code < 10 ? -5 : 0);
      EXPECT_STREQ(recorder_->text, code >= 10 && code < 20 ? "text" : "");
      EXPECT_EQ(trimmed(recorder_->in), trimmed(kPackedData[code / 10]));
    } else if (code >= 220) {
      EXPECT_EQ(trimmed(recorder_->in), trimmed(kPackedInputs));
    }
    const int suffix = code % 10;
    EXPECT_EQ(recorder_->number, suffix == 1 ? 7 : 0);
    EXPECT_STREQ(recorder_->word, suffix == 2 ? "seven" : "");
    EXPECT_EQ(trimmed(recorder_->extra), suffix == 3 ? trimmed(kPackedExtra) : "");
  }
};

}  // namespace

TEST_P(FunctionOperation, CallsItsTypesAndRefusesTheOthers) {
  const Operation& operation = GetParam();
  for (size_t slot = 0; slot < kFunctionTypes; ++slot) {
    const int code = function_type_number_table[slot];
    const std::string type = function_type_name_table[slot];
    SCOPED_TRACE(type);
    const std::string expected = prepare(code);
    const ProviderDefValue result =
        operation.run(function(type), kData[code < 100 ? code / 10 : 0], kExtras[code % 10]);
    EXPECT_EQ(recorder_->calls, accepts(code) ? 1 : 0);
    if (accepts(code)) {
      EXPECT_EQ(valueText(result), expected);
      EXPECT_EQ(recorder_->function, type);
      expectReceived(code);
    } else {
      EXPECT_EQ(valueText(result), valueText(operation.refused()));
    }
  }
}

TEST_P(FunctionOperation, RefusesExtraValuesOfAnotherType) {
  const Operation& operation = GetParam();
  if (!operation.checksType) return;
  for (const int code : operation.codes) {
    for (const ProviderDefValue& extra : oneOfEachType()) {
      const int type = extra.getType();
      const int suffix = code % 10;
      const bool fits = suffix == 0 || (suffix == 3 ? type == 2 || type == 3 : type == suffix - 1);
      const std::string name =
          function_type_name_table[static_cast<size_t>(functionTypeSlot(code))];
      const std::string expected = prepare(code);
      const ProviderDefValue result = operation.run(function(name), 0, extra);
      EXPECT_EQ(recorder_->calls, fits ? 1 : 0) << name << " " << valueText(extra);
      EXPECT_EQ(valueText(result), fits ? expected : valueText(operation.refused()));
    }
  }
  EXPECT_TRUE(ignored.empty());
}

INSTANTIATE_TEST_SUITE_P(All, FunctionOperation, testing::ValuesIn(kOperations),
                         [](const auto& test) { return test.param.name; });

class FunctionCalls : public RecorderTest {};

// The field that the function's type names, whatever the value's own type.
TEST_F(FunctionCalls, SetReadsTheFieldOfItsFamilyAndSuffix) {
  for (const ProviderDefValue& value : oneOfEachType()) {
    SCOPED_TRACE(valueText(value));
    *recorder_ = Recorder();
    function("setI").set(value);
    EXPECT_EQ(recorder_->value, value.getIntValue());
    function("setS").set(value);
    EXPECT_EQ(recorder_->text, value.getStringValue());
    function("setAI").set(value);
    EXPECT_EQ(recorder_->in[4], value.getIntArray().size());
    function("setAS").set(value);
    EXPECT_EQ(recorder_->in[4], value.getStringArray().size());
    function("setIi").set(1, value);
    EXPECT_EQ(recorder_->number, value.getIntValue());
    function("setIw").set(1, value);
    EXPECT_EQ(recorder_->word, value.getStringValue());
    EXPECT_EQ(recorder_->calls, 6);
    function("setIv").set(1, value);  // An array or nothing.
    EXPECT_EQ(recorder_->calls, value.getType() == 2 || value.getType() == 3 ? 7 : 6);
  }
}

TEST_F(FunctionCalls, NumbersKeepEveryBit) {
  for (const long number : {0L, -1L, long{INT_MIN}, long{INT_MAX}, LONG_MIN, LONG_MAX}) {
    recorder_->longResult = number;
    recorder_->result = static_cast<int>(number);
    EXPECT_EQ(function("getL").get().getLongValue(), number);
    EXPECT_EQ(function("getI").get().getIntValue(), static_cast<int>(number));
    function("setI").set(static_cast<int>(number));
    EXPECT_EQ(recorder_->value, static_cast<int>(number));
  }
}

TEST_F(FunctionCalls, AreLoggedWithTheirType) {
  const LogLevel level(8);
  Values outputs;
  recorder_->longResult = 12;
  answer("\x63");
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
