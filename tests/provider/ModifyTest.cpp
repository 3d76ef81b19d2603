// modifyInstance: which properties are written, to which instance, with which value.

#include "ProviderTest.h"
#include "conversion/ValueTable.h"

using namespace Pegasus;

namespace {

class Modify : public ProviderTest {
 protected:
  std::vector<std::string> modify(const char* path, const CIMInstance& sent) {
    RecordingHandler handler;
    provider->modifyInstance(context, pathOf(path), sent, true, CIMPropertyList(), handler);
    return handler.events;
  }

  static std::string setterFor(CIMType type, bool isArray) {
    const bool isText =
        type == CIMTYPE_STRING || type == CIMTYPE_DATETIME || type == CIMTYPE_REFERENCE;
    if (isArray) return isText ? call("setTexts", "setASi") : call("setNumbers", "setAIi");
    return isText ? call("setText", "setSi") : call("setNumber", "setIi");
  }

  /// T_Value has one instance, `K="k"`, and a property P of the type.
  void startValue(CIMType type, bool isArray) {
    host.add(makeClass("T_Value", {declared("K", CIMTYPE_STRING, Key::kYes),
                                   declared("P", type, Key::kNo, isArray)}));
    const bool isText = type == CIMTYPE_DATETIME || type == CIMTYPE_REFERENCE;
    setTable(state->left, {type == CIMTYPE_DATETIME ? "20260101120000.000000+000" : "T_Any"});
    start(definedClass(
        "T_Value", constant("int", "1"),
        property("K", constant("string", "k")) +
            property("P",
                     isArray  ? call(isText ? "texts" : "numbers", isText ? "getASi" : "getAIi")
                     : isText ? call("leftText", "getSi")
                              : constant("int", "0"),
                     setterFor(type, isArray))));
  }

  static CIMInstance valueInstance(const CIMValue& value) {
    CIMInstance sent(CIMName("T_Value"));
    sent.addProperty(CIMProperty(CIMName("p"), value));
    return sent;
  }
};

class ModifyValue : public Modify, public testing::WithParamInterface<ValueCase> {};

TEST_P(ModifyValue, ReachesTheSetter) {
  const CIMValue& value = GetParam().value;
  startValue(value.getType(), value.isArray());
  EXPECT_THAT(modify("root/t:T_Value.K=\"k\"", valueInstance(value)),
              ElementsAre("processing", "complete"));
  const std::string& expected = GetParam().expected;
  const bool isText = expected.find('\'') != std::string::npos;
  EXPECT_EQ(state->record, (isText ? "text" : "number") +
                               std::string(value.isArray() ? "s " : " ") + expected + "@0\n");
}

INSTANTIATE_TEST_SUITE_P(Types, ModifyValue, testing::ValuesIn(valueCases()));

TEST_F(Modify, ValuesOfAnotherTypeAndNullAreLeftOut) {
  startValue(CIMTYPE_UINT8, false);
  const CIMValue kRefused[] = {
      CIMValue(Uint16(5)),    CIMValue(String("5")),          CIMValue(Boolean(true)),
      arrayValue<Uint8>({5}), CIMValue(CIMTYPE_UINT8, false), CIMValue(CIMTYPE_STRING, false)};
  for (const CIMValue& value : kRefused) {
    EXPECT_THAT(modify("root/t:T_Value.K=\"k\"", valueInstance(value)),
                ElementsAre("processing", "complete"));
    EXPECT_STREQ(state->record, "") << textOf(value);
  }
}

class ModifyItem : public Modify {
 protected:
  void SetUp() override {
    setTable(state->left, {"a", "b", "b"});
    host.add(makeClass(
        "T_Item", {declared("Size", CIMTYPE_UINT8), declared("Lost", CIMTYPE_UINT8),
                   declared("Undefined", CIMTYPE_UINT8), declared("ReadOnly", CIMTYPE_UINT8),
                   declared("Text", CIMTYPE_STRING), declared("Name", CIMTYPE_STRING, Key::kYes)}));
    start(itemClass(property("Text", constant("string", "t"), call("setText", "setSi")) +
                    property("Lost", constant("int", "0"), call("nowhere", "setIi")) +
                    property("ReadOnly", constant("int", "0")) +
                    property("Size", constant("int", "0"), call("setNumber", "setIi"))));
    sent.addProperty(CIMProperty(CIMName("Text"), CIMValue(String("new"))));
    for (const char* name : {"Undefined", "ReadOnly", "Lost", "Size", "NotInTheClass"}) {
      sent.addProperty(CIMProperty(CIMName(name), CIMValue(Uint8(9))));
    }
  }

  CIMInstance sent{CIMName("T_Item")};
};

TEST_F(ModifyItem, WritesInTheOrderOfTheClassAndLogsWhatFails) {
  LogLevel level(1);
  EXPECT_THAT(modify("root/t:T_Item.Name=\"b\"", sent), ElementsAre("processing", "complete"));
  EXPECT_STREQ(state->record, "number 9@1\ntext 'new'@1\n");
  EXPECT_EQ(tree.log(), "Couldn't load function nowhere\n");
  EXPECT_EQ(host.calls.back(), "getClass root/t T_Item 0 1 1 null");
}

TEST_F(ModifyItem, OnlyWhatIsSentIsWritten) {
  CIMInstance one(CIMName("T_Item"));
  one.addProperty(CIMProperty(CIMName("Size"), CIMValue(Uint8(1))));
  // Host and namespace of the path do not tell instances apart; the letter case of its key does.
  EXPECT_THAT(modify("//h/root/x:t_item.NAME=\"a\"", one), ElementsAre("processing", "complete"));
  EXPECT_STREQ(state->record, "number 1@0\n");
}

TEST_F(ModifyItem, InstancesThatDoNotExist) {
  for (const char* path : {"root/t:T_Item.Name=\"A\"", "root/t:T_Item", "root/t:T_Item.N=\"a\""}) {
    EXPECT_THAT(modify(path, sent), ElementsAre("processing", "complete")) << path;
  }
  EXPECT_THAT(modify("root/t:T_Nothing.Name=\"a\"", sent), ElementsAre("complete"));
  EXPECT_STREQ(state->record, "");
}

TEST_F(ModifyItem, ErrorOfTheHostPasses) {
  TestHost empty;
  use(empty);
  // Nothing can be enumerated, so nothing is found.
  EXPECT_THAT(modify("root/t:T_Item.Name=\"a\"", sent), ElementsAre("processing", "complete"));
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
