// invokeMethod: what the plug-in is given, what comes back, which errors pass. What each CIM type
// becomes is shown with the conversions.

#include <commonprovider/plugin.h>

#include "ProviderTest.h"

namespace {

class Method : public ProviderTest {
 protected:
  void startItems(std::initializer_list<CIMParameter> parameters, bool isStatic = false) {
    CIMMethod unqualified(CIMName("Unqualified"), CIMTYPE_SINT32);
    host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)},
                       {method("Run", isStatic, parameters), method("Lost", false), unqualified}));
    setTable(state->left, {"a", "b", "c"});
    cp_finish(&outputs);
    std::string methods = "<method name=\"Lost\">" + call("nowhere", "execA", "") + "</method>";
    for (const std::string name : {"Run", "Unqualified", "Undeclared"}) {
      methods += "<method name=\"" + name + "\">" +
                 call("run", "execCi",
                      "<argument type=\"index\"/><argument type=\"input\"/>"
                      "<argument type=\"output\"/>") +
                 "</method>";
    }
    start(itemClass(methods));
  }

  cp_writer outputs = cp_write_list(state->output);
};

const char kItem[] = "root/t:T_Item.Name=\"a\"";

TEST_F(Method, InputsAreReadByTheTypeSentNotByTheDeclared) {
  startItems({parameter("P", CIMTYPE_UINT8, "I")});
  state->result = -3;
  EXPECT_THAT(invoke(kItem, "Run", {{"P", Array<String>(2u, String("x"))}}),
              ElementsAre("processing", "out", "returns sint32 -3", "complete"));
  invoke(kItem, "Run", {{"P", {CIMTYPE_SINT64, false}}});
  EXPECT_STREQ(state->record, "run ['x' 'x']@0\nrun 0@0\n");
}

TEST_F(Method, InputsKeepTheDeclaredOrderAndMoveUp) {
  startItems({parameter("A", CIMTYPE_UINT8, "I"), parameter("B", CIMTYPE_UINT8, "Io"),
              parameter("Off", CIMTYPE_UINT8, "i"), parameter("Unqualified", CIMTYPE_UINT8, ""),
              parameter("C", CIMTYPE_UINT8, "I")});
  invoke(kItem, "Run",
         {{"C", Sint32(3)},
          {"Off", Sint32(8)},
          {"Unqualified", Sint32(9)},
          {"B", Sint32(2)},
          {"A", Sint32(1)},
          {"A", Sint32(7)}});
  invoke(kItem, "Run", {{"C", Sint32(3)}, {"a", Sint32(1)}});
  invoke(kItem, "Run");
  EXPECT_STREQ(state->record, "run 1 2 3@0\nrun 3@0\nrun@0\n");
}

TEST_F(Method, OutputsGoToTheOutParametersInTurnAsTheDeclaredTypes) {
  startItems({parameter("A", CIMTYPE_UINT8, "IO"), parameter("B", CIMTYPE_UINT8, "I"),
              parameter("C", CIMTYPE_UINT8, "Io"), parameter("D", CIMTYPE_STRING, "iO"),
              parameter("E", CIMTYPE_REFERENCE, "O", true), parameter("F", CIMTYPE_STRING, "O"),
              parameter("G", CIMTYPE_UINT8, "O")});
  const char* const paths[] = {"A.k=1", "x:B"};
  outputs = cp_write_list(state->output);
  cp_put_int(&outputs, 511);
  cp_put_string(&outputs, "two");
  cp_put_strings(&outputs, paths, 2);
  cp_put_int(&outputs, 5);
  cp_finish(&outputs);
  // There is no output for G.
  EXPECT_THAT(invoke(kItem, "Run", {{"A", Uint8(5)}}),
              ElementsAre("processing",
                          "out A=(uint8 255) D=(string two) E=(reference[] A.k=1 x:B ) F=(string )",
                          "returns sint32 0", "complete"));
  EXPECT_STREQ(state->record, "run 5@0\n");
}

TEST_F(Method, OutputThatDoesNotFitPassesItsError) {
  startItems({parameter("P", CIMTYPE_DATETIME, "O")});
  outputs = cp_write_list(state->output);
  cp_put_string(&outputs, "yesterday");
  cp_finish(&outputs);
  EXPECT_THROW(invoke(kItem, "Run"), InvalidDateTimeFormatException);
}

TEST_F(Method, StaticLooksTheInstanceUp) {
  startItems({}, true);
  invoke("//h/root/x:T_Item.Name=\"c\"", "Run");
  invoke("root/t:T_Item.Name=\"z\"", "Run");
  EXPECT_STREQ(state->record, "run@2\nrun@3\n");
}

TEST_F(Method, NotStaticIsAlwaysTheFirst) {
  startItems({});
  EXPECT_THAT(invoke("root/t:T_Item.Name=\"c\"", "Run"),
              ElementsAre("processing", "out", "returns sint32 0", "complete"));
  EXPECT_STREQ(state->record, "run@0\n");
  EXPECT_THAT(host.calls, ElementsAre("getClass root/t T_Item 0 1 1 null"));
}

TEST_F(Method, FailuresAreErrorsOfTheServerSilentOrLogged) {
  startItems({});
  EXPECT_THROW(invoke(kItem, "Unqualified"), IndexOutOfBoundsException);
  EXPECT_THROW(invoke(kItem, "Undeclared"), IndexOutOfBoundsException);
  EXPECT_THAT(invoke("root/t:T_Nothing", "Run"), ElementsAre());
  EXPECT_THAT(invoke(kItem, "Walk"), ElementsAre());
  EXPECT_THAT(invoke(kItem, "run"), ElementsAre());
  EXPECT_STREQ(state->record, "");
  LogLevel level(1);
  EXPECT_THAT(invoke(kItem, "Lost"), ElementsAre("processing", "complete"));
  EXPECT_EQ(tree.log(), "Couldn't load function nowhere\n");
}

}  // namespace
