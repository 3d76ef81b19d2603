#include "association/ProviderDefCondition.h"

#include <gtest/gtest.h>

#include <string>
#include <tuple>
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

std::string text(const std::string& value) {
  return "<constant type='string'>" + value + "</constant>";
}

std::string number(int value) {
  return "<constant type='int'>" + std::to_string(value) + "</constant>";
}

TEST_F(Conditions, DecideForTwoInstances) {
  const std::tuple<std::string, Values, Values, bool> cases[] = {
      {"<equal>0" + text("part") + "</equal>", {"part"}, {}, true},
      // Part of a text: unless it begins with it.
      {"<partof>" + text("ab") + "0</partof>", {}, {"abc"}, false},
      {"<partof>0 0</partof>", {2}, {std::vector<int>{1, 2}}, true},
      {"<partof>0 0</partof>", {std::vector<int>{1, 2}}, {2}, false},
      {"<include>0 0</include>", {std::vector<int>{1, 2}}, {2}, true},
      {"<include>0 0</include>", {2}, {std::vector<int>{1, 2}}, false},
      {"<true/>", {}, {}, true},
      {"<true></true>", {}, {}, true},
      {"<false/>", {}, {}, false},
      {"<false> </false>", {}, {}, false},
      {"<and>" + kTrue + kTrue + "</and>", {}, {}, true},
      {"<and>" + kTrue + kFalse + "</and>", {}, {}, false},
      // "or" asks for both.
      {"<or>" + kTrue + kTrue + "</or>", {}, {}, true},
      {"<or>" + kTrue + kFalse + "</or>", {}, {}, false},
      {"<or><condition><and>" + kTrue + "<condition><equal>0 1</equal></condition>" +
           "</and></condition>" + kTrue + "</or>",
       {7},
       {0, 7},
       true},
      // The first operand is taken from side 1 and the second from side 2, whatever their kinds.
      {"<equal>" + kIndexCall + " 1 </equal>", {}, {0, 3}, true},
      {"<equal> 1 " + kIndexCall + "</equal>", {0, 4}, {}, true},
      {"<equal>\n 2\t0 </equal>", {0, 0, "x"}, {"x"}, true},
      {"<equal>name 1" + text("x") + "</equal>", {"x", "y"}, {}, true},
      {"<equal><constant type='real'>1</constant>0</equal>", {}, {0}, true},
      // A position that the side does not have is the empty value, an integer 0.
      {"<equal>1" + text("x") + "</equal>", {"x"}, {"x", "x"}, false},
      {"<equal>1 9</equal>", {"x"}, {"x"}, true},
      {"<equal>-1" + number(0) + "</equal>", {"x"}, {}, true},
      {"<equal>99999999999" + text("x") + "</equal>", {"x"}, {}, false},
      {"<partof>0 0</partof>", {}, {}, false},
  };
  for (const auto& [content, values1, values2, expected] : cases) {
    EXPECT_EQ(holds(condition(content, &plugin_), values1, values2), expected) << content;
  }
}

TEST_F(Conditions, TheSecondSubConditionIsLeftOutWhenTheFirstIsFalse) {
  const std::string counted =
      "<condition><equal>" + kIndexCall + number(3) + "</equal></condition>";
  const std::pair<std::string, int> cases[] = {
      {"<and>" + kFalse + counted + "</and>", 0},
      {"<or>" + kFalse + counted + "</or>", 0},
      {"<and>" + kTrue + counted + "</and>", 1},
      {"<or>" + kTrue + counted + "</or>", 1},
      {"<or>" + counted + counted + "</or>", 2},
      {"<equal>" + kIndexCall + kIndexCall + "</equal>", 2}};
  for (const auto& [content, calls] : cases) {
    const auto built = condition(content, &plugin_);
    const int before = callCount();
    holds(built);
    holds(built);  // Calls are made anew for every evaluation.
    EXPECT_EQ(callCount() - before, 2 * calls) << content;
  }
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
