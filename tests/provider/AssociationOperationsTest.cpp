// associatorNames and associators.

#include "LinkTest.h"

namespace {

class AssociationOperations : public LinkTest {
 protected:
  void SetUp() override {
    LinkTest::SetUp();
    start(classes() + association("T_Link", itemsAndParts()) +
          association("T_Other", itemsAndParts() + itemsAndVolumes()) +
          association("T_All", pairOf("T_Volume", "Owner", "T_Part", "Owner", "<true/>")));
  }
};

const char kItemA[] = "root/t:T_Item.Name=\"a\"";
const std::string kB = "root/t:T_Item.Name=\"b\"";
const std::string kPart0 = "root/t:T_Part.Id=\"p 0\"";
const std::string kPart1 = "root/t:T_Part.Id=\"p 1\"";
const std::string kPart2 = "root/t:T_Part.Id=\"p 2\"";

TEST_F(AssociationOperations, NamesOfTheLinked) {
  const struct {
    const char *object, *associationClass, *resultClass;
    std::vector<std::string> paths;
  } cases[] = {
      // T_Other has two pairs: it is a candidate once for each that fits. Without a result class
      // each candidate leads to the other class of its first pair.
      {kItemA, "T_Link", "T_Part", {kPart1}},
      {"root/t:T_Item.Name=\"b\"", "t_link", "T_Part", {kPart0, kPart2}},
      {"root/t:T_Part.Id=\"p 2\"", "T_Link", "", {kB}},
      {kItemA, "", "T_Part", {kPart1, kPart1}},
      {kItemA, "", "", {kPart1, kPart1, kPart1}},
      {kItemA, "T_Other", "T_Volume", {"T_Volume.Id=1"}},
      {"root/t:T_Volume.Id=0x1", "T_Other", "", {kItemA}},
      {"root/t:T_Volume.Id=2", "T_Other", "", {}},
      {"//h/root/t:T_ITEM.NAME=\"a\"", "T_Link", "", {kPart1}},
      {"root/t:T_Item.Name=\"A\"", "T_Link", "", {}},
      {"root/t:T_Item", "T_Link", "", {}},
  };
  for (const auto& c : cases) {
    std::vector<std::string> events = c.paths;
    events.insert(events.begin(), "processing");
    events.push_back("complete");
    EXPECT_EQ(associatorNames(c.object, c.associationClass, c.resultClass), events) << c.object;
  }
}

TEST_F(AssociationOperations, UnmatchedClassesAreNotSupported) {
  const std::array<const char*, 3> kRequests[] = {{"root/t:T_Nothing", "", ""},
                                                  {kItemA, "T_Nothing", ""},
                                                  {kItemA, "T_Link", "T_Volume"},
                                                  {kItemA, "T_Link", "T_Item"}};
  const std::string text = "CommonProvider::associatorNames";
  for (const auto& each : kRequests) {
    EXPECT_EQ(refusal([&] { associatorNames(each[0], each[1], each[2]); }), text) << each[0];
    EXPECT_EQ(refusal([&] { associators(each[0], each[1], each[2]); }), text) << each[0];
  }
}

TEST_F(AssociationOperations, AssociatorsAreWholeInstances) {
  EXPECT_THAT(associators(kItemA, "T_Link"),
              ElementsAre("processing", "object " + kPart1 + " {Id=string p 1, Owner=string a}",
                          "complete"));
  host.calls.clear();
  EXPECT_THAT(associators(kItemA, "T_Other", "T_Volume"),
              ElementsAre("processing", "object T_Volume.Id=1 {Owner=string a}", "complete"));
  EXPECT_EQ(host.calls.back(), "getInstance root/t T_Volume.Id=1 0 1 1 null");
  EXPECT_THAT(associators("root/t:T_Volume.Id=2", "T_Other"),
              ElementsAre("processing", "complete"));
}

TEST_F(AssociationOperations, WhatCannotBeBuiltIsLeftOut) {
  setTable(state->right, {"a", nullptr, "a"});
  // Three parts are counted, two can be built.
  EXPECT_THAT(associatorNames("root/t:T_Volume.Id=2", "T_All"),
              ElementsAre("processing", kPart0, kPart2, "complete"));
  setTable(state->right, {"a", "a"});
  host.calls.clear();
  // Two items, two parts, and one part for the first path; then the server knows no class any more.
  host.callLimit = 6;
  EXPECT_THAT(associators(kItemA, "T_Link"),
              ElementsAre("processing", "object " + kPart0 + " {Id=string p 0, Owner=string a}",
                          "complete"));
}

TEST_F(AssociationOperations, TracesToStandardOutput) {
  StdoutCapture capture;
  associators(kItemA, "T_Link");
  const std::string traces = capture.text();
  EXPECT_THAT(traces, testing::StartsWith("associators\nCommonProvider::associatorNames Entry\n"));
  EXPECT_THAT(traces, HasSubstr("\nDelivering Association names!!! root/t:T_Part.Id=\"p 1\"\n"));
  EXPECT_THAT(traces, testing::EndsWith("CommonProvider::associatorNames Exit\n"));
}

}  // namespace
