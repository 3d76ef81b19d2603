// Enumeration of defined classes: how many instances, which properties, what drops an instance.

#include <climits>

#include "ProviderTest.h"
#include "engine/ProviderDefError.h"

using namespace Pegasus;

namespace {

using Enumerate = ProviderTest;

TEST_F(Enumerate, EachIndexGivesAnInstanceAndFetchesTheClassAnew) {
  setTable(state->left, {"a", "b"});
  state->numbers[1] = 7;
  host.add(makeClass("T_Item", {declared("Undefined", CIMTYPE_STRING, Key::kUnqualified),
                                declared("Size", CIMTYPE_UINT8, Key::kYes),
                                declared("Name", CIMTYPE_STRING, Key::kYes)}));
  start(itemClass(property("Size", call("number", "getIi")) +
                  property("NotInTheClass", constant("int", "1"))));
  // The class's order, not the definition's; its name as the client spells it.
  EXPECT_THAT(
      enumerate("root/t:t_item").events,
      ElementsAre("processing", "root/t:t_item.Name=\"a\",Size=0 {Size=uint8 0, Name=string a}",
                  "root/t:t_item.Name=\"b\",Size=7 {Size=uint8 7, Name=string b}", "complete"));
  EXPECT_THAT(host.calls, ElementsAre("getClass root/t t_item 0 1 1 null",
                                      "getClass root/t t_item 0 1 1 null"));
}

TEST_F(Enumerate, DeliversPropertiesOfNameAndValueOnly) {
  setTable(state->left, {"a"});
  CIMProperty name(CIMName("Name"), CIMValue(CIMTYPE_STRING, false), 0, CIMName(),
                   CIMName("T_Origin"), true);
  name.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(true)));
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
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
  start(itemClass());
  for (const int count : {0, -1, INT_MIN}) {
    state->left.count = count;
    EXPECT_THAT(enumerate("root/t:T_Item").events, ElementsAre("processing", "complete")) << count;
  }
  EXPECT_THAT(host.calls, ElementsAre());
}

TEST_F(Enumerate, CountThatFailsLeavesAndIsLogged) {
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
  start(definedClass("T_Item", call("nowhere", "getI", ""), ""));
  const LogLevel errors(1);
  EXPECT_THROW(enumerate("root/t:T_Item"), ProviderDefError);
  EXPECT_EQ(tree.log(), "Couldn't load function nowhere\n");
}

TEST_F(Enumerate, UnknownClassIsSilent) {
  start(itemClass());
  EXPECT_THAT(enumerate("root/t:T_Nothing").events, ElementsAre());
}

TEST_F(Enumerate, IndexStringsTellInstancesApart) {
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
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

// What keeps an instance from being built; the second property of T_Item, next to its key.
struct Fault {
  const char* name;
  CIMProperty declaration;
  std::string definition;
  const char* message;  ///< Of the log; null when it is not a ProviderDefError.
};

std::ostream& operator<<(std::ostream& out, const Fault& fault) {
  return out << fault.name;
}

class FaultyProperty : public ProviderTest, public testing::WithParamInterface<Fault> {};

TEST_P(FaultyProperty, DropsTheInstance) {
  setTable(state->left, {"\xff"});
  state->numbersCount = 2;
  const Fault& fault = GetParam();
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes), fault.declaration}));
  start(definedClass(
      "T_Item", constant("int", "1"),
      property("Name", constant("string", "n")) + property("Fault", fault.definition)));
  LogLevel level(9);
  StdoutCapture capture;
  EXPECT_THAT(enumerate("root/t:T_Item").events, ElementsAre("processing", "complete"));
  const std::string output = capture.text();
  if (fault.message == nullptr) {
    EXPECT_THAT(tree.log(), HasSubstr("Unknown exception\n"));
    EXPECT_THAT(output, Not(HasSubstr("ProviderDefError")));
  } else {
    EXPECT_THAT(tree.log(), HasSubstr(fault.message));
    EXPECT_THAT(output, HasSubstr("ProviderDefError $s\n"));
  }
}

INSTANTIATE_TEST_SUITE_P(
    Enumerate, FaultyProperty,
    testing::Values(
        Fault{"NoKeyQualifier", declared("Fault", CIMTYPE_STRING, Key::kUnqualified),
              constant("string", "x"), nullptr},
        Fault{"NotUtf8", declared("Fault", CIMTYPE_STRING), call("leftText", "getSi"), nullptr},
        Fault{"FixedArrayOfAnotherSize", declared("Fault", CIMTYPE_UINT8, Key::kNo, true, 3),
              call("numbers", "getAIi"), nullptr},
        Fault{"NoSuchFunction", declared("Fault", CIMTYPE_UINT8), call("nowhere", "getIi"),
              "Couldn't load function nowhere\n"}),
    kByName);

TEST_F(Enumerate, OneBadInstanceLeavesTheOthers) {
  setTable(state->left, {"a", nullptr, "\xff", "d"});
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
  start(itemClass());
  EXPECT_THAT(enumerate("root/t:T_Item").events,
              ElementsAre("processing", "root/t:T_Item.Name=\"a\" {Name=string a}",
                          "root/t:T_Item.Name=\"d\" {Name=string d}", "complete"));
}

}  // namespace
