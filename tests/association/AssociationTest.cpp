#include "association/ProviderDefAssociation.h"

#include <gmock/gmock.h>

#include <string>
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

// Property 0 of the first class equals property 0, or 1, of the second.
const std::string kSame = "<equal>0 0</equal>";
const std::string kSameAsNext = "<equal>0 1</equal>";

class Associations : public Registered {};

// Two has two instances, None has none and Broken a negative number; other classes are unknown.
TEST_F(Associations, GiveTheTargetsByIndex) {
  const struct {
    std::string groups;
    const char *source, *target;
    Values sourceValues;
    std::vector<Values> targetValues;
    std::vector<int> linked;
  } cases[] = {
      {group("A", "B", "<true/>"), "A", "C", {}, {{}}, {}},
      {group("A", "B", "<true/>"), "A", "A", {}, {{}}, {}},
      {group("A", "B", kSameAsNext),
       "a",
       "b",
       {"x", "y"},
       {{"x", "y"}, {"y", "x"}, {"z", "x"}},
       {1, 2}},
      // The pair's first class stays side 1: it is the target here.
      {group("B", "A", kSameAsNext),
       "A",
       "B",
       {"x", "y"},
       {{"x", "y"}, {"y", "x"}, {"y", "y"}},
       {1, 2}},
      {group("A", "a", kSameAsNext), "A", "A", {"x", "y"}, {{"x", "y"}, {"y", "x"}}, {1}},
      // By pair first, then by index; nothing is sorted or made unique.
      {group("A", "B", kSame) + group("B", "A", "<true/>"), "A", "B", {5}, {{4}, {5}}, {1, 0, 1}},
      {group("A", "C", "<true/>") + group("A", "B", "<false/>") + group("A", "B", "<true/>"),
       "A",
       "B",
       {},
       {{}},
       {0}},
      {"", "A", "B", {}, {{}}, {}},
      {group("A", "B", "<true/>"), "A", "B", {}, {{}, {}, {}}, {0, 1, 2}},
      {group("A", "Two", "<true/>"), "A", "two", {}, {{}, {}, {}}, {0, 1}},
      {group("A", "Two", "<equal>0 0</equal>"), "A", "Two", {0}, {{7}}, {1}},
      {group("A", "Broken", "<true/>"), "A", "Broken", {}, {{}}, {}},
  };
  ASSERT_EQ(errorOfReading(kModule + classText("Two", 2) + classText("None", 0) +
                           classText("Broken", -5)),
            "");
  for (const auto& c : cases) {
    const auto built = element<ProviderDefAssociation>(association("A", c.groups));
    StdoutCapture quiet;
    const auto linked = built.getAssociation(c.source, 0, c.sourceValues, c.target, c.targetValues);
    quiet.text();
    EXPECT_EQ(linked, c.linked) << c.groups;
  }
}

TEST_F(Associations, TheWholeTraceGoesToStandardOutput) {
  const auto built = element<ProviderDefAssociation>(association(
      "A", group("X", "Y", "<true/>") + group("A", "B", "<false/>") + group("B", "A", "<true/>")));
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
  const auto built = element<ProviderDefAssociation>(association(
      "A", group("X", "Y", "<true/>") + group("Z", "X", "<true/>") + group("S", "S", "<true/>")));
  EXPECT_EQ(built.getPair("x"), "Y");
  EXPECT_EQ(built.getPair("Y"), "X");
  EXPECT_EQ(built.getPair("z"), "X");
  EXPECT_EQ(built.getPair("s"), "S");
  EXPECT_EQ(built.getPair("Q"), "");
  EXPECT_EQ(built.getPair(""), "");
}

TEST_F(Associations, AreFoundByNameAndByTheClassesOfEachPair) {
  ASSERT_EQ(
      errorOfReading(kModule +
                     association("One", group("A", "B", "<true/>") + group("B", "a", "<true/>") +
                                            group("C", "C", "<true/>")) +
                     association("Two", group("B", "D", "<true/>")) +
                     association("ONE", group("A", "D", "<true/>"))),
      "");
  const auto* all = &registeredAssociations();
  EXPECT_EQ(getProviderDefAssociation("one"), &(*all)[0]);
  EXPECT_EQ(getProviderDefAssociation("TWO"), &(*all)[1]);
  EXPECT_EQ(getProviderDefAssociation("Three"), nullptr);
  EXPECT_EQ(getProviderDefAssociation(""), nullptr);

  const struct {
    const char *name, *class1, *class2;
    std::vector<int> found;  // positions in the registry, once for each pair that matches
  } cases[] = {
      {"", "", "", {0, 0, 0, 1, 2}}, {"", "A", "", {0, 0, 2}}, {"", "", "a", {0, 0, 2}},
      {"", "B", "", {0, 0, 1}},      {"one", "B", "", {0, 0}}, {"", "D", "A", {2}},
      {"", "a", "d", {2}},           {"", "C", "C", {0}},      {"", "C", "", {0}},
      {"One", "", "", {0, 0, 0, 2}}, {"Two", "A", "", {}},     {"", "B", "B", {}},
      {"None", "", "", {}},
  };
  for (const auto& c : cases) {
    std::vector<const ProviderDefAssociation*> expected;
    for (const int position : c.found) expected.push_back(&(*all)[static_cast<size_t>(position)]);
    EXPECT_EQ(getProviderDefAssociation(c.name, c.class1, c.class2), expected)
        << c.name << " " << c.class1 << " " << c.class2;
  }
}

}  // namespace
