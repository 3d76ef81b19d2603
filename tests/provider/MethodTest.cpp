// invokeMethod: what the plug-in is given, what comes back, which errors pass.

#include <cstring>

#include "ProviderTest.h"
#include "conversion/ValueTable.h"

using namespace Pegasus;

namespace {

/// The output list of a plug-in, as bytes.
class OutputList {
 public:
  OutputList& number(int value) { return word(0).word(value); }
  OutputList& text(const std::string& value) {
    word(1).word(static_cast<int>(value.size()));
    bytes_ += value + '\0';
    return *this;
  }
  OutputList& numbers(std::initializer_list<int> values) {
    word(2).word(static_cast<int>(values.size()));
    for (const int value : values) number(value);
    return *this;
  }
  OutputList& texts(std::initializer_list<const char*> values) {
    word(3).word(static_cast<int>(values.size()));
    for (const char* value : values) text(value).bytes_.append(24, '\0');
    return *this;
  }

  void copyTo(char* buffer) {
    word(99);
    std::memcpy(buffer, bytes_.data(), bytes_.size());
  }

 private:
  OutputList& word(int value) {
    bytes_.append(reinterpret_cast<const char*>(&value), sizeof value);
    return *this;
  }

  std::string bytes_;
};

CIMParameter parameter(const char* name, CIMType type, bool isArray, const char* flags) {
  CIMParameter declaration(CIMName(name), type, isArray, 0,
                           type == CIMTYPE_REFERENCE ? CIMName("T_Any") : CIMName());
  const std::string text = flags;
  const auto add = [&](const char* qualifier, char yes, char no) {
    const bool isYes = text.find(yes) != std::string::npos;
    if (!isYes && text.find(no) == std::string::npos) return;
    declaration.addQualifier(CIMQualifier(CIMName(qualifier), CIMValue(Boolean(isYes))));
  };
  // An upper-case letter is a qualifier that is true, a lower-case one that is false.
  add("In", 'I', 'i');
  add("Out", 'O', 'o');
  return declaration;
}

class Method : public ProviderTest {
 protected:
  void startItems(std::initializer_list<CIMParameter> parameters, const char* isStatic = "no") {
    CIMMethod method(CIMName("Run"), CIMTYPE_SINT32);
    if (*isStatic != '\0') {
      method.addQualifier(
          CIMQualifier(CIMName("Static"), CIMValue(Boolean(std::string(isStatic) == "yes"))));
    }
    for (const CIMParameter& declaration : parameters) method.addParameter(declaration);
    CIMClass item = makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)});
    item.addMethod(method);
    host.add(item);
    setTable(state->left, {"a", "b", "c"});
    OutputList().copyTo(state->output);
    start(itemClass("<method name=\"Run\">" +
                    call("run", "execCi",
                         "<argument type=\"index\"/><argument type=\"input\"/>"
                         "<argument type=\"output\"/>") +
                    "</method><method name=\"Lost\">" + call("nowhere", "execA", "") +
                    "</method><method name=\"Undeclared\">" + call("run", "execCi") + "</method>"));
  }

  std::vector<std::string> invoke(const char* path, const char* method,
                                  std::initializer_list<CIMParamValue> parameters = {}) {
    Array<CIMParamValue> sent;
    for (const CIMParamValue& value : parameters) sent.append(value);
    RecordingHandler handler;
    provider->invokeMethod(context, pathOf(path), CIMName(method), sent, handler);
    return handler.events;
  }
};

const char kItem[] = "root/t:T_Item.Name=\"a\"";

class MethodInput : public Method, public testing::WithParamInterface<ValueCase> {};

// The declared type does not matter.
TEST_P(MethodInput, IsReadByTheTypeSent) {
  startItems({parameter("P", CIMTYPE_UINT8, false, "I")});
  state->result = -3;
  EXPECT_THAT(invoke(kItem, "Run", {CIMParamValue(String("P"), GetParam().value)}),
              ElementsAre("processing", "out", "returns sint32 -3", "complete"));
  EXPECT_EQ(state->record, "run " + GetParam().expected + "@0\n");
}

INSTANTIATE_TEST_SUITE_P(Types, MethodInput, testing::ValuesIn(valueCases()));
INSTANTIATE_TEST_SUITE_P(References, MethodInput,
                         testing::Values(ValueCase{arrayValue<CIMObjectPath>({pathOf("A.k=1"),
                                                                              pathOf("x:B")}),
                                                   "['A.k=1' 'x:B']"},
                                         ValueCase{CIMValue(), "0"}));

TEST_F(Method, InputsKeepTheDeclaredOrderAndMoveUp) {
  startItems({parameter("A", CIMTYPE_UINT8, false, "I"), parameter("B", CIMTYPE_UINT8, false, "Io"),
              parameter("Off", CIMTYPE_UINT8, false, "i"),
              parameter("Unqualified", CIMTYPE_UINT8, false, ""),
              parameter("C", CIMTYPE_UINT8, false, "I")});
  const auto value = [](const char* name, int number) {
    return CIMParamValue(String(name), CIMValue(Sint32(number)));
  };
  invoke(kItem, "Run",
         {value("C", 3), value("Off", 8), value("Unqualified", 9), value("B", 2), value("A", 1),
          value("A", 7)});
  invoke(kItem, "Run", {value("C", 3), value("a", 1)});
  invoke(kItem, "Run");
  EXPECT_STREQ(state->record, "run 1 2 3@0\nrun 3@0\nrun@0\n");
}

struct OutputCase {
  CIMType type;
  bool isArray;
  OutputList list;
  const char* value;
};

std::ostream& operator<<(std::ostream& out, const OutputCase& given) {
  return out << cimTypeToString(given.type) << (given.isArray ? "[]" : "");
}

class MethodOutput : public Method, public testing::WithParamInterface<OutputCase> {};

TEST_P(MethodOutput, HasTheDeclaredType) {
  startItems({parameter("P", GetParam().type, GetParam().isArray, "O")});
  OutputList(GetParam().list).copyTo(state->output);
  EXPECT_THAT(invoke(kItem, "Run"),
              ElementsAre("processing",
                          "out P=(" + std::string(cimTypeToString(GetParam().type)) +
                              (GetParam().isArray ? "[] " : " ") + GetParam().value + ")",
                          "returns sint32 0", "complete"));
}

OutputList oneNumber(int value) {
  return OutputList().number(value);
}
OutputList oneText(const char* value) {
  return OutputList().text(value);
}
const OutputList kTwo = OutputList().numbers({65, -1});
const char kDate[] = "20260101120000.000000+060";

INSTANTIATE_TEST_SUITE_P(
    Scalars, MethodOutput,
    testing::Values(OutputCase{CIMTYPE_BOOLEAN, false, oneNumber(2), "TRUE"},
                    OutputCase{CIMTYPE_UINT8, false, oneNumber(511), "255"},
                    OutputCase{CIMTYPE_SINT8, false, oneNumber(255), "-1"},
                    OutputCase{CIMTYPE_UINT16, false, oneNumber(-1), "65535"},
                    OutputCase{CIMTYPE_SINT16, false, oneNumber(0x18000), "-32768"},
                    OutputCase{CIMTYPE_UINT32, false, oneNumber(-1), "4294967295"},
                    OutputCase{CIMTYPE_SINT32, false, oneNumber(-1), "-1"},
                    OutputCase{CIMTYPE_UINT64, false, oneNumber(-1), "18446744073709551615"},
                    OutputCase{CIMTYPE_SINT64, false, oneNumber(-1), "-1"},
                    OutputCase{CIMTYPE_REAL32, false, oneNumber(3), "3.0000000000000000e+00"},
                    OutputCase{CIMTYPE_REAL64, false, oneNumber(-2), "-2.0000000000000000e+00"},
                    OutputCase{CIMTYPE_CHAR16, false, oneNumber(0x10041), "A"},
                    OutputCase{CIMTYPE_STRING, false, oneText("x y"), "x y"},
                    OutputCase{CIMTYPE_STRING, false, oneNumber(5), ""},
                    OutputCase{CIMTYPE_DATETIME, false, oneText(kDate), kDate},
                    OutputCase{CIMTYPE_REFERENCE, false, oneText("x:B.k=1"), "x:B.k=1"}));

INSTANTIATE_TEST_SUITE_P(
    Arrays, MethodOutput,
    testing::Values(
        OutputCase{CIMTYPE_BOOLEAN, true, kTwo, "TRUE TRUE "},
        OutputCase{CIMTYPE_UINT8, true, kTwo, "65 255 "},
        OutputCase{CIMTYPE_SINT32, true, kTwo, "65 -1 "},
        OutputCase{CIMTYPE_UINT64, true, kTwo, "65 18446744073709551615 "},
        OutputCase{CIMTYPE_REAL32, true, OutputList().numbers({}), ""},
        OutputCase{CIMTYPE_CHAR16, true, OutputList().numbers({65, 66}), "A B "},
        OutputCase{CIMTYPE_STRING, true, OutputList().texts({"a b", "", "c"}), "a b  c "},
        OutputCase{CIMTYPE_DATETIME, true, OutputList().texts({kDate}),
                   "20260101120000.000000+060 "},
        OutputCase{CIMTYPE_REFERENCE, true, OutputList().texts({"A.k=1", "x:B"}), "A.k=1 x:B "}));

TEST_F(Method, OutputsGoToTheOutParametersInTurn) {
  startItems({parameter("A", CIMTYPE_UINT8, false, "IO"), parameter("B", CIMTYPE_UINT8, false, "I"),
              parameter("C", CIMTYPE_UINT8, false, "Io"),
              parameter("D", CIMTYPE_STRING, false, "iO"),
              parameter("E", CIMTYPE_UINT8, false, "O")});
  OutputList().number(1).text("two").copyTo(state->output);
  // There is no third output for E.
  EXPECT_THAT(
      invoke(kItem, "Run", {CIMParamValue(String("A"), CIMValue(Uint8(5)))}),
      ElementsAre("processing", "out A=(uint8 1) D=(string two)", "returns sint32 0", "complete"));
  EXPECT_STREQ(state->record, "run 5@0\n");
}

TEST_F(Method, OutputThatDoesNotFitPassesItsError) {
  startItems({parameter("P", CIMTYPE_DATETIME, false, "O")});
  OutputList().text("yesterday").copyTo(state->output);
  EXPECT_THROW(invoke(kItem, "Run"), InvalidDateTimeFormatException);
}

TEST_F(Method, StaticLooksTheInstanceUp) {
  startItems({}, "yes");
  invoke("//h/root/x:T_Item.Name=\"c\"", "Run");
  invoke("root/t:T_Item.Name=\"z\"", "Run");
  EXPECT_STREQ(state->record, "run@2\nrun@3\n");
}

TEST_F(Method, NotStaticIsAlwaysTheFirst) {
  startItems({}, "no");
  EXPECT_THAT(invoke("root/t:T_Item.Name=\"c\"", "Run"),
              ElementsAre("processing", "out", "returns sint32 0", "complete"));
  EXPECT_STREQ(state->record, "run@0\n");
  EXPECT_THAT(host.calls, ElementsAre("getClass root/t T_Item 0 1 1 null"));
}

TEST_F(Method, WithoutStaticOrDeclarationTheServersErrorPasses) {
  startItems({}, "");
  EXPECT_THROW(invoke(kItem, "Run"), IndexOutOfBoundsException);
  EXPECT_THROW(invoke(kItem, "Undeclared"), IndexOutOfBoundsException);
  EXPECT_STREQ(state->record, "");
}

TEST_F(Method, UnknownClassesAndMethodsAreSilent) {
  startItems({});
  EXPECT_THAT(invoke("root/t:T_Nothing", "Run"), ElementsAre());
  EXPECT_THAT(invoke(kItem, "Walk"), ElementsAre());
  EXPECT_THAT(invoke(kItem, "run"), ElementsAre());
}

TEST_F(Method, FailureOfThePluginEndsWithoutDelivery) {
  startItems({});
  CIMClass item = makeClass("T_Item", {});
  CIMMethod lost(CIMName("Lost"), CIMTYPE_SINT32);
  lost.addQualifier(CIMQualifier(CIMName("Static"), CIMValue(Boolean(false))));
  item.addMethod(lost);
  TestHost other;
  other.add(item);
  use(other);
  LogLevel level(1);
  EXPECT_THAT(invoke(kItem, "Lost"), ElementsAre("processing", "complete"));
  EXPECT_EQ(tree.log(), "Couldn't load function nowhere\n");
}

}  // namespace
