// modifyInstance: which properties are written, to which instance, with which value. What each CIM
// type becomes is shown with the conversions.

#include "ProviderTest.h"

using namespace Pegasus;

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
                    property("Texts", call("texts", "getASi"), call("setTexts", "setASi"))));
  }

  std::vector<std::string> modify(
      const char* path, std::initializer_list<std::pair<const char*, CIMValue>> properties) {
    CIMInstance sent(CIMName("T_Item"));
    for (const auto& [name, value] : properties) {
      sent.addProperty(CIMProperty(CIMName(name), value));
    }
    RecordingHandler handler;
    provider->modifyInstance(context, pathOf(path), sent, true, CIMPropertyList(), handler);
    return handler.events;
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

TEST_F(Modify, ValuesOfAnotherTypeAndNullAreLeftOut) {
  const CIMValue kRefused[] = {Uint16(5),
                               String("5"),
                               Boolean(true),
                               Array<Uint8>(1, Uint8(5)),
                               {CIMTYPE_UINT8, false},
                               {CIMTYPE_STRING, false}};
  for (const CIMValue& value : kRefused) {
    EXPECT_THAT(modify("root/t:T_Item.Name=\"a\"", {{"Size", value}}),
                ElementsAre("processing", "complete"));
    EXPECT_STREQ(state->record, "") << textOf(value);
  }
}

TEST_F(Modify, FindsItsInstanceByTheKeys) {
  for (const char* path : {"root/t:T_Item.Name=\"A\"", "root/t:T_Item", "root/t:T_Item.N=\"a\""}) {
    EXPECT_THAT(modify(path, {{"Size", Uint8(1)}}), ElementsAre("processing", "complete")) << path;
  }
  EXPECT_THAT(modify("root/t:T_Nothing.Name=\"a\"", {{"Size", Uint8(1)}}), ElementsAre("complete"));
  EXPECT_STREQ(state->record, "");
  // Host and namespace of the path do not tell instances apart.
  modify("//h/root/x:t_item.NAME=\"a\"", {{"Size", Uint8(1)}});
  EXPECT_STREQ(state->record, "number 1@0\n");
}

using ValueMapProperty = ProviderTest;

// No attribute of a definition names the mapping property, so none is ever found.
TEST_F(ValueMapProperty, ReadsAsUnknownAndIsNotWritten) {
  host.add(makeClass(
      "T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes), declared("Size", CIMTYPE_UINT8)}));
  start(definedClass("T_Item", constant("int", "1"),
                     property("Name", constant("int", "1") + "<conversion type=\"valuemap\"/>",
                              call("setText", "setSi")) +
                         property("Size", constant("int", "3") + "<conversion type=\"valuemap\"/>",
                                  call("setNumber", "setIi"))));
  EXPECT_THAT(enumerate("root/t:T_Item").events,
              ElementsAre("processing",
                          "root/t:T_Item.Name=\"Unknown\" {Name=string Unknown, Size=uint8 3}",
                          "complete"));
  CIMInstance sent(CIMName("T_Item"));
  sent.addProperty(CIMProperty(CIMName("Name"), CIMValue(String("OK"))));
  sent.addProperty(CIMProperty(CIMName("Size"), CIMValue(Uint8(4))));
  RecordingHandler handler;
  provider->modifyInstance(context, pathOf("root/t:T_Item.Name=\"Unknown\""), sent, false,
                           CIMPropertyList(), handler);
  EXPECT_STREQ(state->record, "number 4@0\n");
}

}  // namespace
