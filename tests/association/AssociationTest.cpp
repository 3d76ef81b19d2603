#include "association/ProviderDefAssociation.h"

#include <gmock/gmock.h>

#include <string>
#include <tuple>
#include <vector>

#include "definition/DefinitionRegistry.h"
#include "tests/definition/Reading.h"
#include "tests/support/StdoutCapture.h"

namespace {

using Values = ProviderDefAssociation::Values;

std::string group(const std::string& first, const std::string& second, const std::string& content) {
  return "<classname name='" + first + "'/><classname name='" + second + "'/><condition>" +
         content + "</condition>";
}

std::string association(const std::string& name, const std::string& groups) {
  return "<association name='" + name + "'>" + groups + "</association>";
}

const std::string kTrue = "<true/>";
const std::string kFalse = "<false/>";
// Property 0 of the first class equals property 0, or 1, of the second.
const std::string kSame = "<equal>0 0</equal>";
const std::string kSameAsNext = "<equal>0 1</equal>";

class Associations : public Registered {};

struct LinkCase {
  std::string groups;
  std::vector<int> linked;
  Values source = {};
  std::vector<Values> targets = {{}};
  const char* target = "B";
};

// From an instance of A. Two has two instances, None has none and Broken a negative number; other
// classes are unknown.
TEST_F(Associations, GiveTheTargetsByIndex) {
  const LinkCase cases[] = {
      {group("A", "B", kTrue), {}, {}, {{}}, "C"},
      {group("A", "B", kTrue), {}, {}, {{}}, "A"},
      {group("a", "B", kSameAsNext), {1, 2}, {"x", "y"}, {{"x", "y"}, {"y", "x"}, {"z", "x"}}, "b"},
      // The pair's first class stays side 1: it is the target here.
      {group("B", "A", kSameAsNext), {1, 2}, {"x", "y"}, {{"x", "y"}, {"y", "x"}, {"y", "y"}}},
      {group("A", "a", kSameAsNext), {1}, {"x", "y"}, {{"x", "y"}, {"y", "x"}}, "A"},
      // By pair first, then by index; nothing is sorted or made unique.
      {group("A", "B", kSame) + group("B", "A", kTrue), {1, 0, 1}, {5}, {{4}, {5}}},
      {group("A", "C", kTrue) + group("A", "B", kFalse) + group("A", "B", kTrue), {0}},
      {"", {}},
      {group("A", "B", kTrue), {0, 1, 2}, {}, {{}, {}, {}}},
      {group("A", "Two", kTrue), {0, 1}, {}, {{}, {}, {}}, "two"},
      {group("A", "Two", kSame), {1}, {0}, {{7}}, "Two"},
      {group("A", "None", kTrue), {}, {}, {{}}, "None"},
      {group("A", "Broken", kTrue), {}, {}, {{}}, "Broken"},
  };
  ASSERT_EQ(errorOfReading(kModule + classText("Two", 2) + classText("None", 0) +
                           classText("Broken", -5)),
            "");
  for (const LinkCase& c : cases) {
    const auto built = element<ProviderDefAssociation>(association("A", c.groups));
    const StdoutCapture quiet;
    EXPECT_EQ(built.getAssociation("A", 0, c.source, c.target, c.targets), c.linked) << c.groups;
  }
}

TEST_F(Associations, TheWholeTraceGoesToStandardOutput) {
  const auto built = element<ProviderDefAssociation>(
      association("A", group("X", "Y", kTrue) + group("A", "B", kFalse) + group("B", "A", kTrue)));
  StdoutCapture captured;
  built.getAssociation("A", 7, {}, "B", {{}, {}});
  EXPECT_EQ(captured.text(),
            "ProviderDefAssociation::getAssociation Entry\n"
            "pairs 1, numinst 2, numcond 3\n"
            "ProviderDefCondition::getValue( 7, 0) type = 6 \n"
            "ProviderDefCondition::getValue( 7, 1) type = 6 \n"
            "pairs 2, numinst 2, numcond 3\n"
            "ProviderDefCondition::getValue( 0, 7) type = 5 \n"
            "putting associated index : 0\n"
            "ProviderDefCondition::getValue( 1, 7) type = 5 \n"
            "putting associated index : 1\n"
            "ProviderDefAssociation::getAssociation Exit. Number of results is 2 \n");
}

TEST_F(Associations, TheOtherClassIsThatOfTheFirstPairWithTheName) {
  const auto built = element<ProviderDefAssociation>(
      association("A", group("X", "Y", kTrue) + group("Z", "X", kTrue) + group("S", "S", kTrue)));
  EXPECT_EQ(built.getPair("x"), "Y");
  EXPECT_EQ(built.getPair("Y"), "X");
  EXPECT_EQ(built.getPair("z"), "X");
  EXPECT_EQ(built.getPair("s"), "S");
  EXPECT_EQ(built.getPair("Q"), "");
  EXPECT_EQ(built.getPair(""), "");
}

TEST_F(Associations, AreFoundByNameAndByTheClassesOfEachPair) {
  ASSERT_EQ(errorOfReading(kModule +
                           association("One", group("A", "B", kTrue) + group("B", "a", kTrue) +
                                                  group("C", "C", kTrue)) +
                           association("Two", group("B", "D", kTrue)) +
                           association("ONE", group("A", "D", kTrue))),
            "");
  const auto& all = registeredAssociations();
  EXPECT_EQ(getProviderDefAssociation("one"), &all[0]);
  EXPECT_EQ(getProviderDefAssociation("TWO"), &all[1]);
  EXPECT_EQ(getProviderDefAssociation("Three"), nullptr);
  EXPECT_EQ(getProviderDefAssociation(""), nullptr);

  // Positions in the registry, once for each pair that matches.
  const std::tuple<const char*, const char*, const char*, std::vector<int>> cases[] = {
      {"", "", "", {0, 0, 0, 1, 2}}, {"", "A", "", {0, 0, 2}}, {"", "", "a", {0, 0, 2}},
      {"", "B", "", {0, 0, 1}},      {"one", "B", "", {0, 0}}, {"", "D", "A", {2}},
      {"", "a", "d", {2}},           {"", "C", "C", {0}},      {"", "C", "", {0}},
      {"One", "", "", {0, 0, 0, 2}}, {"Two", "A", "", {}},     {"", "B", "B", {}},
      {"None", "", "", {}},
  };
  for (const auto& [name, class1, class2, found] : cases) {
    std::vector<int> positions;
    for (const auto* one : getProviderDefAssociation(name, class1, class2)) {
      positions.push_back(one == &all[0] ? 0 : one == &all[1] ? 1 : one == &all[2] ? 2 : -1);
    }
    EXPECT_EQ(positions, found) << name << " " << class1 << " " << class2;
  }
}

}  // namespace
