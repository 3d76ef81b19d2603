// Which operation a call's arguments choose, and the instances that a class counts.

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
    {"setIi", kInput, "0 0", false},
    {"setIi", kOutput, "0 0", false},
    {"setIv", kIndex + kText, "0 11", true, 0, "", kFour + kSeven},
    {"setIv", kInput + kNumber + kOutput, "0 11", true, 0, "", kNotSupported + kNine},
};

const Case kExecCases[] = {
    {"execA", "", "0 11", true},
    {"execAw", kText, "0 11", true, 0, "seven"},
    {"execB", kInput, "0 11", true},
    {"execC", kOutput, "0 11", true},
    {"execC", kInput + kOutput, "0 11", true},
    {"execB", kInput + kInput, "0 0", false},
    {"execC", kOutput + kOutput, "0 0", false},
    {"execBi", kInput + kIndex, "0 11", true, 4},
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

TEST_F(FunctionCall, NestedCallsAreEvaluatedFirstWithTheSameIndex) {
  answer(words({77, 1, 77, 7}));
  const std::string inner = callText("alltypes", "getAIi", "getAIi", kIndex);
  EXPECT_EQ(valueText(call("getIv", element(inner)).getValue(4)), "0 11");
  EXPECT_EQ(recorder_->calls, 2);
  EXPECT_EQ(recorder_->number, 4);
  EXPECT_EQ(trimmed(recorder_->extra), trimmed(words({2, 1, 0, 7})));
}

TEST_F(FunctionCall, ClassesCountTheirInstances) {
  const auto counted =
      fromText<ProviderDefClass>("<class name=\"C\" namespace=\"root\"><instances>" +
                                 callText("alltypes", "getI", "getI") + "</instances></class>");
  for (const int count : {0, 5, -1, kMaxInstances, kMaxInstances + 1}) {
    recorder_->result = count;
    EXPECT_EQ(counted.getNumberOfInstances(), count);
    EXPECT_EQ(boundedNumberOfInstances(counted), std::min(count, 1000000));
  }
}
