// Which operation a call's arguments choose, and the properties, methods and classes on top of it.

#include "engine/ProviderDefClass.h"
#include "tests/engine/RecorderTest.h"
#include "tests/support/LogLevel.h"

using namespace std::string_literals;

namespace {

const std::string kIndex = "<argument type=\"index\"/>";
const std::string kInput = "<argument type=\"input\"/>";
const std::string kOutput = "<argument type=\"output\"/>";

std::string element(const std::string& content) {
  return "<argument type=\"element\">" + content + "</argument>";
}

const std::string kText = element("<constant type=\"string\">seven</constant>");
const std::string kNumber = element("<constant type=\"int\">9</constant>");
const std::string kQuery = element("<cimproperty>any</cimproperty>");

// The index of all calls here is 4. Packed items:
const std::string kFour = words({0, 4});
const std::string kNine = words({0, 9});
const std::string kSeven = words({1, 5}) + "seven\0"s;
const std::string kNotSupported = words({1, 13}) + "Not Supported\0"s;

struct Case {
  const char* type;
  std::string arguments;
  const char* result;  // Of a call that reaches the plug-in, and of one that does not.
  bool called;
  int number = 0;
  const char* word = "";
  std::string extra = "";
};

class FunctionCall : public RecorderTest {
 protected:
  FunctionCall() {
    recorder_->result = 11;
    recorder_->longResult = 12;
    answer("\x63");
  }

  static ProviderDefFunctionCall call(const std::string& type, const std::string& arguments) {
    return fromText<ProviderDefFunctionCall>(callText("alltypes", type, type, arguments));
  }
};

const Case kGetCases[] = {
    {"getI", "", "0 11", true},
    {"getIi", kIndex, "0 11", true, 4},
    {"getLi", kNumber, "6 12", true, 9},
    {"getIi", kQuery, "0 11", true, 0},
    {"getI", kInput, "1 Not Supported", false},
    {"getI", kOutput, "0 0", false},
    {"getIv", kIndex + kText, "0 11", true, 0, "", kFour + kSeven},
    {"getIv", kText + kOutput + kIndex + kNumber, "0 11", true, 0, "", kSeven + kFour + kNine},
    {"getIv", kInput + kIndex, "0 11", true, 0, "", kNotSupported + kFour},
    {"getIv", kOutput + kOutput, "0 11", true},
};

const Case kSetCases[] = {
    {"setI", "", "0 11", true},
    {"setIi", kIndex, "0 11", true, 4},
    {"setSi", kNumber, "0 11", true, 9},
    {"setIi", kInput, "0 0", false},
    {"setIi", kOutput, "0 0", false},
    {"setIv", kIndex + kText, "0 11", true, 0, "", kFour + kSeven},
    {"setIv", kInput + kNumber + kOutput, "0 11", true, 0, "", kNotSupported + kNine},
};

const Case kExecCases[] = {
    {"execA", "", "0 11", true},
    {"execAi", kIndex, "0 11", true, 4},
    {"execAw", kText, "0 11", true, 0, "seven"},
    {"execB", kInput, "0 11", true},
    {"execC", kOutput, "0 11", true},
    {"execC", kInput + kOutput, "0 11", true},
    {"execB", kInput + kInput, "0 0", false},
    {"execC", kOutput + kOutput, "0 0", false},
    {"execBi", kInput + kIndex, "0 11", true, 4},
    {"execBw", kText + kInput, "0 11", true, 0, "seven"},
    {"execCi", kInput + kOutput + kIndex, "0 11", true, 4},
    {"execCi", kOutput + kIndex, "0 11", true, 4},
    {"execBi", kInput + kOutput + kIndex, "0 99", false},
    {"execB", kIndex + kIndex, "0 0", false},
    {"execC", kInput + kIndex + kOutput + kText, "0 0", false},
};

}  // namespace

TEST_F(FunctionCall, TheArgumentsChooseTheOperation) {
  Values outputs;
  const auto expectEach = [this](const auto& cases, auto run) {
    for (const Case& c : cases) {
      SCOPED_TRACE(c.type + (" " + c.arguments));
      recorder_->calls = recorder_->number = 0;
      recorder_->function = "";
      recorder_->word[0] = '\0';
      std::memset(recorder_->extra, 0, sizeof recorder_->extra);
      EXPECT_EQ(valueText(run(call(c.type, c.arguments))), c.result);
      EXPECT_EQ(recorder_->calls, c.called ? 1 : 0);
      EXPECT_EQ(recorder_->function, std::string(c.called ? c.type : ""));
      EXPECT_EQ(recorder_->number, c.number);
      EXPECT_STREQ(recorder_->word, c.word);
      EXPECT_EQ(trimmed(recorder_->extra), trimmed(c.extra));
    }
  };
  expectEach(kGetCases, [](const auto& made) { return made.getValue(4); });
  expectEach(kSetCases, [](const auto& made) { return made.setValue(-8, 4); });
  EXPECT_EQ(recorder_->value, -8);
  expectEach(kExecCases, [&](const auto& made) { return made.exec(Values{7}, outputs, 4); });
  EXPECT_TRUE(outputs.empty());
}

TEST_F(FunctionCall, GetValueWithoutIndexIgnoresTheArguments) {
  EXPECT_EQ(call("getI", "").getValue(), 11);
  EXPECT_EQ(call("getI", kIndex).getValue(), 11);
  EXPECT_EQ(call("getL", "").getValue(), 0) << "the integer field of a long";
  EXPECT_EQ(call("getIi", kIndex).getValue(), 0);
}

TEST_F(FunctionCall, ExecHandsInputsInAndOutputsOut) {
  answer(words({0, 5, 99}));
  Values outputs{1};
  EXPECT_EQ(call("execCi", kIndex + kInput + kOutput).exec(Values{9}, outputs, 4), 11);
  EXPECT_EQ(trimmed(recorder_->in), kNine + "\x63");
  EXPECT_EQ(valueText(outputs), "0 1; 0 5; ");
}

TEST_F(FunctionCall, NestedCallsAreEvaluatedFirstWithTheSameIndex) {
  answer(words({77, 1, 77, 7}));
  const std::string inner = callText("alltypes", "getAIi", "getAIi", kIndex);
  EXPECT_EQ(valueText(call("getIv", element(inner)).getValue(4)), "0 11");
  EXPECT_EQ(recorder_->calls, 2);
  EXPECT_EQ(recorder_->number, 4);
  EXPECT_EQ(trimmed(recorder_->extra), trimmed(words({2, 1, 0, 7})));

  const std::string deep = callText("alltypes", "getIi", "getIi",
                                    element(callText("alltypes", "getIi", "getIi", kIndex)));
  EXPECT_EQ(valueText(call("getLi", element(deep)).getValue(4)), "6 12");
  EXPECT_EQ(recorder_->calls, 5);
  EXPECT_EQ(recorder_->number, 11);
}

TEST_F(FunctionCall, PropertiesUseTheirSidesOrConstants) {
  const auto property = [](const std::string& get, const std::string& set) {
    return fromText<ProviderDefProperty>("<property name=\"P\"><get>" + get + "</get>" + set +
                                         "</property>");
  };
  const std::string constant = "<constant type=\"string\">fixed</constant>";
  const auto fixed = property(constant, "");
  EXPECT_EQ(valueText(fixed.getValue(0)), "1 fixed");
  EXPECT_EQ(fixed.setValue(5, 0), 0);
  EXPECT_EQ(recorder_->calls, 0);

  const auto called = property(callText("alltypes", "getIi", "getIi", kIndex),
                               "<set>" + callText("alltypes", "setIi", "setIi", kIndex) + "</set>");
  EXPECT_EQ(valueText(called.getValue(3)), "0 11");
  EXPECT_EQ(recorder_->number, 3);
  EXPECT_EQ(called.setValue(5, 2), 11);
  EXPECT_EQ(recorder_->value, 5);
  EXPECT_EQ(recorder_->number, 2);
}

TEST_F(FunctionCall, ClassesCountTheirInstancesAndMethodsHandOn) {
  const auto counted = fromText<ProviderDefClass>(
      "<class name=\"C\" namespace=\"root\"><instances>" + callText("alltypes", "getI", "getI") +
      "</instances><method name=\"M\">" +
      callText("alltypes", "execBi", "execBi", kIndex + kInput) + "</method></class>");
  for (const int count : {0, 5, -1, kMaxInstances, kMaxInstances + 1}) {
    recorder_->result = count;
    EXPECT_EQ(counted.getNumberOfInstances(), count);
    EXPECT_EQ(boundedNumberOfInstances(counted), std::min(count, 1000000));
  }
  Values outputs;
  recorder_->result = 6;
  ASSERT_NE(counted.getMethod("M"), nullptr);
  EXPECT_EQ(counted.getMethod("M")->exec(Values{9}, outputs, 4), 6);
  EXPECT_EQ(recorder_->number, 4);
  EXPECT_EQ(counted.getMethod("m"), nullptr);
}
