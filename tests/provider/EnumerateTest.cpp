// Enumeration of defined classes: how many instances, which properties, what drops an instance.

#include <climits>

#include "ProviderTest.h"
#include "engine/ProviderDefError.h"

namespace {

using Enumerate = ProviderTest;

const CIMProperty kName = declared("Name", CIMTYPE_STRING, Key::kYes);

TEST_F(Enumerate, EachIndexGivesAnInstanceAndFetchesTheClassAnew) {
  setTable(state->left, {"a", "b"});
  state->numbers[1] = 7;
  host.add(makeClass("T_Item", {declared("Undefined", CIMTYPE_STRING, Key::kUnqualified),
                                declared("Size", CIMTYPE_UINT8, Key::kYes), kName}));
  start(itemClass(property("Size", call("number", "getIi")) +
                  property("NotInTheClass", constant("int", "1"))));
  // The class's order, not the definition's; its name as the client spells it.
  EXPECT_THAT(
      enumerate("root/t:t_item").events,
      ElementsAre("processing", "root/t:t_item.Name=\"a\",Size=0 {Size=uint8 0, Name=string a}",
                  "root/t:t_item.Name=\"b\",Size=7 {Size=uint8 7, Name=string b}", "complete"));
  EXPECT_THAT(host.calls, ElementsAre("getClass root/t t_item 0 1 1 null",
                                      "getClass root/t t_item 0 1 1 null"));
  EXPECT_THAT(enumerate("root/t:T_Nothing").events, ElementsAre());
}

TEST_F(Enumerate, DeliversPropertiesOfNameAndValueOnly) {
  setTable(state->left, {"a"});
  CIMProperty name(CIMName("Name"), CIMValue(CIMTYPE_STRING, false), 0, CIMName(),
                   CIMName("T_Origin"), true);
  name.addQualifier(flag("Key", true));
  host.add(makeClass("T_Item", {name}));
  start(itemClass());
  Array<CIMInstance> delivered = enumerate("root/t:T_Item").instances;
  ASSERT_EQ(delivered.size(), 1u);
  const CIMProperty property = delivered[0].getProperty(0);
  EXPECT_EQ(property.getQualifierCount(), 0u);
  EXPECT_TRUE(property.getClassOrigin().isNull());
  EXPECT_FALSE(property.getPropagated());
}

TEST_F(Enumerate, CountsThatGiveNoInstance) {
  host.add(makeClass("T_Item", {kName}));
  start(itemClass() + definedClass("T_Failing", call("nowhere", "getI", ""), ""));
  for (const int count : {0, -1, INT_MIN}) {
    state->left.count = count;
    EXPECT_THAT(enumerate("root/t:T_Item").events, ElementsAre("processing", "complete")) << count;
  }
  const LogLevel errors(1);
  EXPECT_THROW(enumerate("root/t:T_Failing"), ProviderDefError);
  EXPECT_EQ(tree.log(), "Couldn't load function nowhere\n");
  EXPECT_THAT(host.calls, ElementsAre());
}

TEST_F(Enumerate, IndexStringsTellInstancesApart) {
  host.add(makeClass("T_Item", {kName}));
  start(definedClass("T_Item", constant("int", "2"),
                     property("Name", constant("indexstring", "Disk"))));
  EXPECT_THAT(enumerate("root/t:T_Item").events,
              ElementsAre("processing", "root/t:T_Item.Name=\"Disk 0\" {Name=string Disk 0}",
                          "root/t:T_Item.Name=\"Disk 1\" {Name=string Disk 1}", "complete"));
}

TEST_F(Enumerate, DatetimeIsEvaluatedTwiceAndOthersOnce) {
  setTable(state->left, {"20260101120000.000000+060"});
  start(itemClass());
  for (const auto& [type, calls] : {std::pair(CIMTYPE_DATETIME, 2), std::pair(CIMTYPE_STRING, 1)}) {
    TestHost again;
    again.add(makeClass("T_Item", {declared("Name", type, Key::kYes)}));
    use(again);
    state->calls = 0;
    EXPECT_EQ(enumerate("root/t:T_Item").events.size(), 3u);
    EXPECT_EQ(state->calls, calls);
  }
}

TEST_F(Enumerate, OneBadInstanceLeavesTheOthers) {
  setTable(state->left, {"a", nullptr, "\xff", "d"});
  host.add(makeClass("T_Item", {kName}));
  start(itemClass());
  EXPECT_THAT(enumerate("root/t:T_Item").events,
              ElementsAre("processing", "root/t:T_Item.Name=\"a\" {Name=string a}",
                          "root/t:T_Item.Name=\"d\" {Name=string d}", "complete"));
}

TEST_F(Enumerate, FaultyPropertiesDropTheInstance) {
  setTable(state->left, {"\xff"});
  const struct {
    CIMProperty declaration;
    std::string definition;
    bool isDefinitionError;
    const char* message;
  } faults[] = {
      {declared("Fault", CIMTYPE_STRING, Key::kUnqualified), constant("string", "x"), false,
       "Unknown exception\n"},
      // Not UTF-8.
      {declared("Fault", CIMTYPE_STRING), call("leftText", "getSi"), false, "Unknown exception\n"},
      // An array of another size.
      {declared("Fault", CIMTYPE_UINT8, Key::kNo, true, 3), call("numbers", "getAIi"), false,
       "Unknown exception\n"},
      {declared("Fault", CIMTYPE_UINT8), call("nowhere", "getIi"), true,
       "Couldn't load function nowhere\n"}};
  for (const auto& fault : faults) {
    TestHost other;
    other.add(makeClass("T_Item", {kName, fault.declaration}));
    use(other);
    start(definedClass(
        "T_Item", constant("int", "1"),
        property("Name", constant("string", "n")) + property("Fault", fault.definition)));
    {
      const LogLevel level(9);
      StdoutCapture capture;
      EXPECT_THAT(enumerate("root/t:T_Item").events, ElementsAre("processing", "complete"));
      EXPECT_EQ(capture.text().find("ProviderDefError $s\n") != std::string::npos,
                fault.isDefinitionError);
    }
    EXPECT_THAT(tree.log(), HasSubstr(fault.message)) << fault.definition;
    std::filesystem::remove(tree.logs() / "CommonProvider.log");
    stop();
  }
}

}  // namespace
