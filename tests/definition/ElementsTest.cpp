// The objects that well-formed elements become.

#include <gmock/gmock.h>

#include <climits>
#include <string>
#include <vector>

#include "definition/DefinitionRegistry.h"
#include "engine/ProviderDefClass.h"
#include "engine/ProviderDefFunctionCall.h"
#include "tests/definition/Reading.h"

namespace {

using testing::ElementsAre;

std::string shown(const ProviderDefValue& value) {
  switch (value.getType()) {
    case ProviderDefValue::kInteger:
      return "int " + std::to_string(value.getIntValue());
    case ProviderDefValue::kBoolean:
      return value.getBoolValue() ? "true" : "false";
    default:
      return (value.getType() == ProviderDefValue::kString ? "string " : "indexstring ") +
             value.getStringValue();
  }
}

class Elements : public Registered {};

// Arguments, get sides and instance counts read the same constants.
TEST_F(Elements, ConstantsBecomeValues) {
  const struct {
    const char *type, *text;
    std::string shown;
  } cases[] = {
      {"int", " 42 ", "int 42"},
      {"int", "12abc", "int 12"},
      {"int", "0x10", "int 0"},
      {"int", "", "int 0"},
      {"int", "4294967296", "int " + std::to_string(INT_MAX)},
      {"int", "-2147483649", "int " + std::to_string(INT_MIN)},
      {"string", "  a  b\n", "string a  b"},
      {"string", " ", "string "},
      {"indexstring", "disk", "indexstring disk"},
      {"boolean", " true ", "true"},
      {"boolean", "TRUE", "false"},
      {"real64", "5", "int 0"},
      {"INT", "5", "int 0"},
  };
  for (const auto& c : cases) {
    const std::string constant =
        "<constant type='" + std::string(c.type) + "'>" + c.text + "</constant>";
    SCOPED_TRACE(constant);
    const auto argument =
        element<ProviderDefArgument>("<argument type='element'>" + constant + "</argument>");
    EXPECT_EQ(argument.getElementType(), ProviderDefArgument::kConstant);
    EXPECT_EQ(shown(argument.getConstant()), c.shown);
    const auto property =
        element<ProviderDefProperty>("<property name='P'><get>" + constant + "</get></property>");
    EXPECT_EQ(shown(property.getValue(7)), c.shown);
    const auto counted =
        element<ProviderDefClass>("<class><instances>" + constant + "</instances></class>");
    EXPECT_EQ("int " + std::to_string(counted.getNumberOfInstances()),
              c.type == std::string("int") ? c.shown : "int 0");
  }
}

ProviderDefModule module(const std::string& text) {
  int used = 0;
  ProviderDefModule built(text.data(), static_cast<int>(text.size()), &used);
  EXPECT_EQ(used, static_cast<int>(text.size())) << text;
  return built;
}

TEST_F(Elements, ModulesTakePathTypeAndInitialisationCall) {
  struct {
    std::string text;
    int path;
    bool needInit;
  } const cases[] = {
      {"<module name='m' path='short'/>", 1, false},
      {"<module path='Short' name='m'/>", 0, false},
      {"<module name='m' path='fullpath'></module>", 0, false},
      {"<module name='m' other='x'/>", 0, false},
      {"<module name='m'><functioncall><function name='i' type='getI'/></functioncall></module>", 0,
       true},
  };
  for (const auto& c : cases) {
    const ProviderDefModule built = module(c.text);
    EXPECT_EQ(built.getName(), "m") << c.text;
    EXPECT_EQ(built.getPath(), c.path) << c.text;
    EXPECT_EQ(built.getNeedInit(), c.needInit) << c.text;
    EXPECT_EQ(built.getInit() != nullptr, c.needInit) << c.text;
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
