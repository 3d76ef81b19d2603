// invokeMethod: what the plug-in is given, what comes back, which errors pass. What each CIM type
// becomes is shown with the conversions.

#include <commonprovider/plugin.h>

#include "ProviderTest.h"

using namespace Pegasus;

namespace {

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
    cp_finish(&outputs);
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

  cp_writer outputs = cp_write_list(state->output);
};

const char kItem[] = "root/t:T_Item.Name=\"a\"";

TEST_F(Method, InputsAreReadByTheTypeSentNotByTheDeclared) {
  startItems({parameter("P", CIMTYPE_UINT8, false, "I")});
  state->result = -3;
  EXPECT_THAT(invoke(kItem, "Run", {CIMParamValue(String("P"), Array<String>(2u, String("x")))}),
              ElementsAre("processing", "out", "returns sint32 -3", "complete"));
  invoke(kItem, "Run", {CIMParamValue(String("P"), CIMValue(CIMTYPE_SINT64, false))});
  EXPECT_STREQ(state->record, "run ['x' 'x']@0\nrun 0@0\n");
}

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

TEST_F(Method, OutputsGoToTheOutParametersInTurnAsTheDeclaredTypes) {
  startItems(
      {parameter("A", CIMTYPE_UINT8, false, "IO"), parameter("B", CIMTYPE_UINT8, false, "I"),
       parameter("C", CIMTYPE_UINT8, false, "Io"), parameter("D", CIMTYPE_STRING, false, "iO"),
       parameter("E", CIMTYPE_REFERENCE, true, "O"), parameter("F", CIMTYPE_STRING, false, "O"),
       parameter("G", CIMTYPE_UINT8, false, "O")});
  const char* const paths[] = {"A.k=1", "x:B"};
  outputs = cp_write_list(state->output);
  cp_put_int(&outputs, 511);
  cp_put_string(&outputs, "two");
  cp_put_strings(&outputs, paths, 2);
  cp_put_int(&outputs, 5);
  cp_finish(&outputs);
  // There is no output for G.
  EXPECT_THAT(invoke(kItem, "Run", {CIMParamValue(String("A"), CIMValue(Uint8(5)))}),
              ElementsAre("processing",
                          "out A=(uint8 255) D=(string two) E=(reference[] A.k=1 x:B ) F=(string )",
                          "returns sint32 0", "complete"));
  EXPECT_STREQ(state->record, "run 5@0\n");
}

TEST_F(Method, OutputThatDoesNotFitPassesItsError) {
  startItems({parameter("P", CIMTYPE_DATETIME, false, "O")});
  outputs = cp_write_list(state->output);
  cp_put_string(&outputs, "yesterday");
  cp_finish(&outputs);
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
