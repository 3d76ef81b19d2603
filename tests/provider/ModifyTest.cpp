// modifyInstance: which properties are written, to which instance, with which value. What each CIM
// type becomes is shown with the conversions.

#include "ProviderTest.h"

namespace {

class Modify : public ProviderTest {
 protected:
  void SetUp() override {
    setTable(state->left, {"a", "b", "b"});
    host.add(makeClass(
        "T_Item", {declared("Size", CIMTYPE_UINT8), declared("Lost", CIMTYPE_UINT8),
                   declared("Undefined", CIMTYPE_UINT8), declared("ReadOnly", CIMTYPE_UINT8),
                   declared("Text", CIMTYPE_STRING), declared("Name", CIMTYPE_STRING, Key::kYes),
                   declared("Numbers", CIMTYPE_UINT16, Key::kNo, true),
                   declared("Texts", CIMTYPE_STRING, Key::kNo, true)}));
    start(itemClass(property("Text", constant("string", "t"), call("setText", "setSi")) +
                    property("Lost", constant("int", "0"), call("nowhere", "setIi")) +
                    property("ReadOnly", constant("int", "0")) +
                    property("Size", constant("int", "0"), call("setNumber", "setIi")) +
                    property("Numbers", call("numbers", "getAIi"), call("setNumbers", "setAIi")) +
                    property("Texts", constant("string", ""), call("setTexts", "setASi"))));
  }
};

TEST_F(Modify, WritesInTheOrderOfTheClassAndLogsWhatFails) {
  LogLevel level(1);
  const CIMValue nine{Uint8(9)};
  Array<Uint16> numbers;
  numbers.append(65535);
  numbers.append(1);
  EXPECT_THAT(modify("root/t:T_Item.Name=\"b\"", {{"Text", String("new")},
                                                  {"Undefined", nine},
                                                  {"ReadOnly", nine},
                                                  {"Lost", nine},
                                                  {"size", nine},
                                                  {"NotInTheClass", nine},
                                                  {"Texts", Array<String>(2u, String("x"))},
                                                  {"Numbers", numbers}}),
              ElementsAre("processing", "complete"));
  EXPECT_STREQ(state->record, "number 9@1\ntext 'new'@1\nnumbers [65535 1]@1\ntexts ['x' 'x']@1\n");
  EXPECT_EQ(tree.log(), "Couldn't load function nowhere\n");
  EXPECT_EQ(host.calls.back(), "getClass root/t T_Item 0 1 1 null");
}

TEST_F(Modify, LeavesOutOtherTypesNullAndOtherInstances) {
  const char* const kItem = "root/t:T_Item.Name=\"a\"";
  const CIMValue one{Uint8(1)};
  const std::pair<const char*, CIMValue> cases[] = {{kItem, Uint16(5)},
                                                    {kItem, String("5")},
                                                    {kItem, Boolean(true)},
                                                    {kItem, Array<Uint8>(1, Uint8(5))},
                                                    {kItem, {CIMTYPE_UINT8, false}},
                                                    {kItem, {CIMTYPE_STRING, false}},
                                                    {"root/t:T_Item.Name=\"A\"", one},
                                                    {"root/t:T_Item", one},
                                                    {"root/t:T_Item.N=\"a\"", one}};
  for (const auto& [path, value] : cases) {
    EXPECT_THAT(modify(path, {{"Size", value}}), ElementsAre("processing", "complete"));
    EXPECT_STREQ(state->record, "") << path << textOf(value);
  }
  EXPECT_THAT(modify("root/t:T_Nothing.Name=\"a\"", {{"Size", one}}), ElementsAre("complete"));
  // Host and namespace of the path do not tell instances apart.
  modify("//h/root/x:t_item.NAME=\"a\"", {{"Size", one}});
  EXPECT_STREQ(state->record, "number 1@0\n");
}

using ValueMapProperty = ProviderTest;

// No attribute of a definition names the mapping property, so none is ever found.
TEST_F(ValueMapProperty, ReadsAsUnknownAndIsNotWritten) {
  host.add(makeClass(
      "T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes), declared("Size", CIMTYPE_UINT8)}));
  const std::string map = "<conversion type=\"valuemap\"/>";
  start(definedClass("T_Item", constant("int", "1"),
                     property("Name", constant("int", "1") + map, call("setText", "setSi")) +
                         property("Size", constant("int", "3") + map, call("setNumber", "setIi"))));
  EXPECT_THAT(enumerate("root/t:T_Item").events,
              ElementsAre("processing",
                          "root/t:T_Item.Name=\"Unknown\" {Name=string Unknown, Size=uint8 3}",
                          "complete"));
  modify("root/t:T_Item.Name=\"Unknown\"", {{"Name", String("OK")}, {"Size", Uint8(4)}});
  EXPECT_STREQ(state->record, "number 4@0\n");
}

}  // namespace
