// The objects that well-formed elements become.

#include <gmock/gmock.h>

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

using testing::ElementsAre;

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

TEST_F(Elements, ModulesTakePathTypeAndInitialisationCall) {
  const std::string call = "<functioncall><function name='i' type='getI'/></functioncall>";
  const std::tuple<std::string, int, bool> cases[] = {
      {"<module name='m' path='short'/>", 1, false},
      {"<module path='Short' name='m'/>", 0, false},
      {"<module name='m' path='fullpath'></module>", 0, false},
      {"<module name='m' other='x'/>", 0, false},
      {"<module name='m'>" + call + "</module>", 0, true},
  };
  for (const auto& [text, path, needInit] : cases) {
    SCOPED_TRACE(text);
    int used = 0;
    const ProviderDefModule built(text.data(), static_cast<int>(text.size()), &used);
    EXPECT_EQ(used, static_cast<int>(text.size()));
    EXPECT_EQ(built.getName(), "m");
    EXPECT_EQ(built.getPath(), path);
    EXPECT_EQ(built.getNeedInit(), needInit);
    EXPECT_EQ(built.getInit() != nullptr, needInit);
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

TEST_F(Elements, ArgumentsKeepTheirOrderAndKinds) {
  const auto call = element<ProviderDefFunctionCall>(
      "<functioncall><function name='f' type='getIv'></function>"
      "<argument type='output'/><argument type='index'></argument><argument type='input'/>"
      "<argument type='element'><cimproperty> A.B </cimproperty></argument>"
      "<argument type='element'><functioncall><function name='g' type='getI'/>"
      "<argument type='input'/></functioncall></argument></functioncall>");
  std::vector<int> types;
  for (const auto& argument : call.getArguments()) types.push_back(argument.getType());
  EXPECT_THAT(types, ElementsAre(3, 0, 1, 2, 2));
  const ProviderDefArgument& query = call.getArguments()[3];
  EXPECT_EQ(query.getElementType(), ProviderDefArgument::kCimProperty);
  EXPECT_EQ(query.getQueryString(), "A.B");

  // A copy has a nested call of its own.
  const ProviderDefArgument nested = call.getArguments()[4];
  EXPECT_EQ(nested.getElementType(), ProviderDefArgument::kFunctionCall);
  EXPECT_NE(nested.getFunctionCall(), call.getArguments()[4].getFunctionCall());
  EXPECT_EQ(nested.getFunctionCall()->getDefFunction(), getFunction("g"));
  EXPECT_EQ(nested.evaluate(0).getStringValue(), "Not Supported");
}

TEST_F(Elements, ClassesHoldPropertiesAndMethodsInOrder) {
  const auto built = element<ProviderDefClass>(
      "<class namespace='root/n' name='C'>" + kOneInstance +
      "<method name='M'><functioncall><function name='f' type='execA'/></functioncall></method>"
      "<property name='P'><get><constant type='int'>1</constant><conversion type='valuemap'/></get>"
      "<set><constant type='int'>2</constant></set></property>"
      "<property name='P'><get><constant type='int'>3</constant><conversion type='other'/></get>"
      "</property></class>");
  ASSERT_EQ(built.getProperties().size(), 2u);
  EXPECT_TRUE(built.getProperties()[0].getGetValuemap());
  EXPECT_FALSE(built.getProperties()[1].getGetValuemap());
  EXPECT_EQ(built.getProperty("P"), &built.getProperties()[0]);
  EXPECT_EQ(built.getProperty("p"), nullptr);
  // A constant is no set call: nothing to write through.
  EXPECT_EQ(built.getProperty("P")->setValue(ProviderDefValue(5), 0), 0);
  EXPECT_EQ(built.getMethod("M"), &built.getMethods()[0]);
  EXPECT_EQ(built.getMethod("m"), nullptr);
}

TEST_F(Elements, AssociationsHoldPairsConditionsAndProperties) {
  const auto built = element<ProviderDefAssociation>(
      "<association propertyname2='Right' name='A' namespace2='root/n' propertyname1='Left' x='y'>"
      "<classname name='B'><propertyname name='b1'/><propertyname name='b2'></propertyname>"
      "</classname><classname name='C'/><condition><false/></condition>"
      "<classname name='B'><propertyname name='b3'/></classname><classname name='D'></classname>"
      "<condition><true></true></condition></association>");
  EXPECT_EQ(built.getPropertyNamePair(), std::make_pair(std::string("Left"), std::string("Right")));
  using Pair = ProviderDefAssociation::NamePair;
  EXPECT_THAT(built.getClassNamePairs(), ElementsAre(Pair("B", "C"), Pair("B", "D")));
  ASSERT_EQ(built.getConditions().size(), 2u);
  EXPECT_EQ(built.getConditions()[0].getType(), ProviderDefCondition::kFalse);
  EXPECT_EQ(built.getConditions()[1].getType(), ProviderDefCondition::kTrue);
  // Those of the class's first entry.
  EXPECT_THAT(built.getClassProperties("b"), ElementsAre("b1", "b2"));
  EXPECT_EQ(built.getNamespace(), "root/n");
}

}  // namespace
