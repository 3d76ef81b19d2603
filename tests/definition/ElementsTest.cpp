// What the objects that well-formed elements become do not show in data/every_element.dump.

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <tuple>
#include <vector>

#include "definition/DefinitionRegistry.h"
#include "engine/ProviderDefClass.h"
#include "engine/ProviderDefFunctionCall.h"
#include "tests/definition/Reading.h"
#include "tests/engine/ValueText.h"

namespace {

class Elements : public Registered {};

// Arguments, get sides and instance counts read the same constants.
TEST_F(Elements, ConstantsBecomeValues) {
  const std::tuple<std::string, const char*, std::string> cases[] = {
      {"int", " 42 ", "0 42"},
      {"int", "12abc", "0 12"},
      {"int", "0x10", "0 0"},
      {"int", "", "0 0"},
      {"int", "4294967296", "0 " + std::to_string(INT_MAX)},
      {"int", "-2147483649", "0 " + std::to_string(INT_MIN)},
      {"string", "  a  b\n", "1 a  b"},
      {"string", " ", "1 "},
      {"indexstring", "disk", "4 disk"},
      {"boolean", " true ", "5 true"},
      {"boolean", "TRUE", "5 false"},
      {"real64", "5", "0 0"},
      {"INT", "5", "0 0"},
      {"string' type='int", "5", "0 5"},
  };
  for (const auto& [type, text, expected] : cases) {
    const std::string constant = "<constant type='" + type + "'>" + text + "</constant>";
    SCOPED_TRACE(constant);
    const auto argument =
        element<ProviderDefArgument>("<argument type='element'>" + constant + "</argument>");
    EXPECT_EQ(argument.getElementType(), ProviderDefArgument::kConstant);
    EXPECT_EQ(valueText(argument.getConstant()), expected);
    const auto property =
        element<ProviderDefProperty>("<property name='P'><get>" + constant + "</get></property>");
    EXPECT_EQ(valueText(property.getValue(7)), expected);
    const auto counted =
        element<ProviderDefClass>("<class><instances>" + constant + "</instances></class>");
    EXPECT_EQ("0 " + std::to_string(counted.getNumberOfInstances()),
              expected[0] == '0' ? expected : "0 0");
  }
}

TEST_F(Elements, TheFirstDeclarationFixesTypeAndModuleOfAFunction) {
  ProviderDefModule first("first", true);
  ProviderDefModule second("second", true);
  const auto call = [](const std::string& attributes, ProviderDefModule* from) {
    return element<ProviderDefFunctionCall>(
        "<functioncall><function " + attributes + "/></functioncall>", from);
  };
  const ProviderDefFunction* f = call("name='f' type='getI'", &first).getDefFunction();
  EXPECT_EQ(call("type='getS' name='f'", &second).getDefFunction(), f);
  EXPECT_EQ(f, getFunction("f"));
  EXPECT_EQ(f->getType(), 100);
  EXPECT_EQ(f->getModule(), &first);
  // Function names are case-sensitive.
  EXPECT_NE(call("name='F' type='execAv'", &second).getDefFunction(), f);
  EXPECT_EQ(getFunction("F")->getType(), 203);
  EXPECT_EQ(call("name='g' type='geti'", &first).getDefFunction()->getType(), -1);
  EXPECT_EQ(functionCount(), 3u);
}

TEST_F(Elements, ACopyOfAnArgumentHasANestedCallOfItsOwn) {
  const auto call = element<ProviderDefFunctionCall>(
      "<functioncall><function name='f' type='getIv'></function><argument type='element'>"
      "<functioncall><function name='g' type='getI'/><argument type='input'/></functioncall>"
      "</argument></functioncall>");
  const ProviderDefArgument copy = call.getArguments()[0];
  EXPECT_NE(copy.getFunctionCall(), call.getArguments()[0].getFunctionCall());
  EXPECT_EQ(copy.getFunctionCall()->getDefFunction(), getFunction("g"));
  EXPECT_EQ(copy.evaluate(0).getStringValue(), "Not Supported");
}

TEST_F(Elements, ClassesFindTheFirstPropertyOfExactlyTheName) {
  const auto built = element<ProviderDefClass>(
      "<class namespace='root/n' name='C'>" + kOneInstance +
      "<property name='P'><get><constant type='int'>1</constant><conversion type='other'/></get>"
      "<set><constant type='int'>2</constant></set></property><property name='P'><get>"
      "<constant type='int'>3</constant><conversion type='valuemap'/></get></property></class>");
  ASSERT_EQ(built.getProperties().size(), 2u);
  EXPECT_EQ(built.getProperty("P"), &built.getProperties()[0]);
  EXPECT_FALSE(built.getProperty("P")->getGetValuemap());
  EXPECT_EQ(built.getProperty("p"), nullptr);
  // A constant is no set call: nothing to write through.
  EXPECT_EQ(built.getProperty("P")->setValue(ProviderDefValue(5), 0), 0);
}

TEST_F(Elements, AssociationsHoldThePropertiesOfTheFirstEntryOfAClass) {
  const auto built = element<ProviderDefAssociation>(
      "<association name='A' x='y'><classname name='B'><propertyname name='b1'/>"
      "<propertyname name='b2'></propertyname></classname><classname name='B'>"
      "<propertyname name='b3'/></classname><condition><true/></condition></association>");
  EXPECT_EQ(built.getClassProperties("b"), (std::vector<std::string>{"b1", "b2"}));
}

}  // namespace
