#include "association/ProviderDefCondition.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/definition/Reading.h"
#include "tests/support/StdoutCapture.h"

namespace {

using Values = ProviderDefCondition::Values;

const std::string kTrue = "<condition><true/></condition>";
const std::string kFalse = "<condition><false/></condition>";
const std::string kIndexCall =
    "<functioncall><function name='sameIndex' type='getIi'/><argument "
    "type='index'/></functioncall>";

class Conditions : public Registered {
 protected:
  static ProviderDefCondition condition(const std::string& content, ProviderDefModule* module) {
    return element<ProviderDefCondition>("<condition>" + content + "</condition>", module);
  }

  // For instance 3 of the first class and instance 4 of the second.
  static bool holds(const ProviderDefCondition& built, const Values& values1 = {},
                    const Values& values2 = {}) {
    const StdoutCapture quiet;
    return built.getValue(3, values1, 4, values2);
  }

  int callCount() { return ProviderDefFunction("callCount", 100, &plugin_).get().getIntValue(); }

  ProviderDefModule plugin_{PLUGIN, false};
};

struct ConditionCase {
  const char* name;
  std::string content;
  Values values1, values2;
  bool holds;
};

class Condition : public Conditions, public testing::WithParamInterface<ConditionCase> {};

TEST_P(Condition, DecidesForTwoInstances) {
  const ConditionCase& c = GetParam();
  EXPECT_EQ(holds(condition(c.content, &plugin_), c.values1, c.values2), c.holds);
}

std::string text(const std::string& value) {
  return "<constant type='string'>" + value + "</constant>";
}

std::string number(int value) {
  return "<constant type='int'>" + std::to_string(value) + "</constant>";
}

INSTANTIATE_TEST_SUITE_P(
    Operators, Condition,
    testing::Values(
        ConditionCase{"EqualTexts", "<equal>0" + text("part") + "</equal>", {"part"}, {}, true},
        // Part of a text: unless it begins with it.
        ConditionCase{"PartAtTheStart", "<partof>" + text("ab") + "0</partof>", {}, {"abc"}, false},
        ConditionCase{"PartOfList", "<partof>0 0</partof>", {2}, {std::vector<int>{1, 2}}, true},
        ConditionCase{
            "PartIsDirected", "<partof>0 0</partof>", {std::vector<int>{1, 2}}, {2}, false},
        ConditionCase{"IncludeList", "<include>0 0</include>", {std::vector<int>{1, 2}}, {2}, true},
        ConditionCase{
            "IncludeIsDirected", "<include>0 0</include>", {2}, {std::vector<int>{1, 2}}, false},
        ConditionCase{"True", "<true/>", {}, {}, true},
        ConditionCase{"TrueWithEndTag", "<true></true>", {}, {}, true},
        ConditionCase{"False", "<false/>", {}, {}, false},
        ConditionCase{"FalseWithEndTag", "<false> </false>", {}, {}, false},
        ConditionCase{"AndOfTrue", "<and>" + kTrue + kTrue + "</and>", {}, {}, true},
        ConditionCase{"AndOfTrueAndFalse", "<and>" + kTrue + kFalse + "</and>", {}, {}, false},
        // "or" asks for both.
        ConditionCase{"OrOfTrue", "<or>" + kTrue + kTrue + "</or>", {}, {}, true},
        ConditionCase{"OrOfTrueAndFalse", "<or>" + kTrue + kFalse + "</or>", {}, {}, false},
        ConditionCase{"Nested",
                      "<or><condition><and>" + kTrue + "<condition><equal>0 1</equal></condition>" +
                          "</and></condition>" + kTrue + "</or>",
                      {7},
                      {0, 7},
                      true}),
    kCaseName);

// The first operand is taken from side 1 and the second from side 2, whatever their kinds.
INSTANTIATE_TEST_SUITE_P(
    Operands, Condition,
    testing::Values(
        ConditionCase{"CallAndIndex", "<equal>" + kIndexCall + " 1 </equal>", {}, {0, 3}, true},
        ConditionCase{"IndexAndCall", "<equal> 1 " + kIndexCall + "</equal>", {0, 4}, {}, true},
        ConditionCase{"TwoIndexes", "<equal>\n 2\t0 </equal>", {0, 0, "x"}, {"x"}, true},
        ConditionCase{
            "WordIsIndexZero", "<equal>name" + text("x") + "</equal>", {"x", "y"}, {}, true},
        ConditionCase{"UnknownConstantTypeIsZero",
                      "<equal><constant type='real'>1</constant>0</equal>",
                      {},
                      {0},
                      true},
        // A position that the side does not have is the empty value, an integer 0.
        ConditionCase{"IndexBeyond", "<equal>1" + text("x") + "</equal>", {"x"}, {"x", "x"}, false},
        ConditionCase{"IndexBeyondIsEmpty", "<equal>1 9</equal>", {"x"}, {"x"}, true},
        ConditionCase{"NegativeIndex", "<equal>-1" + number(0) + "</equal>", {"x"}, {}, true},
        ConditionCase{"HugeIndex", "<equal>99999999999" + text("x") + "</equal>", {"x"}, {}, false},
        ConditionCase{"NoValues", "<partof>0 0</partof>", {}, {}, false}),
    kCaseName);

TEST_F(Conditions, TheSecondSubConditionIsLeftOutWhenTheFirstIsFalse) {
  const std::string counted =
      "<condition><equal>" + kIndexCall + number(3) + "</equal></condition>";
  const struct {
    std::string content;
    int calls;
  } cases[] = {{"<and>" + kFalse + counted + "</and>", 0},
               {"<or>" + kFalse + counted + "</or>", 0},
               {"<and>" + kTrue + counted + "</and>", 1},
               {"<or>" + kTrue + counted + "</or>", 1},
               {"<or>" + counted + counted + "</or>", 2},
               {"<equal>" + kIndexCall + kIndexCall + "</equal>", 2}};
  for (const auto& c : cases) {
    const int before = callCount();
    holds(condition(c.content, &plugin_));
    EXPECT_EQ(callCount() - before, c.calls) << c.content;
  }
}

TEST_F(Conditions, CallsAreMadeAnewForEveryEvaluation) {
  const auto built = condition("<equal>" + kIndexCall + "0</equal>", &plugin_);
  const int before = callCount();
  EXPECT_TRUE(holds(built, {}, {3}));
  EXPECT_FALSE(holds(built, {}, {4}));
  EXPECT_EQ(callCount() - before, 2);
}

TEST_F(Conditions, EveryEvaluationWritesALine) {
  StdoutCapture captured;
  condition("<or><condition><and>" + kTrue + "<condition><partof>0 0</partof></condition></and>" +
                "</condition>" + kTrue + "</or>",
            nullptr)
      .getValue(-1, {}, 12, {});
  EXPECT_EQ(captured.text(),
            "ProviderDefCondition::getValue( -1, 12) type = 4 \n"
            "ProviderDefCondition::getValue( -1, 12) type = 3 \n"
            "ProviderDefCondition::getValue( -1, 12) type = 5 \n"
            "ProviderDefCondition::getValue( -1, 12) type = 1 \n");
}

}  // namespace
