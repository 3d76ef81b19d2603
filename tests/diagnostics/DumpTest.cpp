// Dumps byte for byte: the objects are read from definition text, as in the provider.

#include "association/ProviderDefAssociation.h"
#include "engine/ProviderDefClass.h"
#include "engine/Registry.h"
#include "tests/support/StdoutCapture.h"

#include <gtest/gtest.h>

namespace {

class Dump : public testing::Test {
 protected:
  ~Dump() override {
    releaseFunctions();
    releaseModules();
  }

  template <class Object>
  static std::string dumped(const Object& object) {
    StdoutCapture capture;
    object.dump();
    return capture.text();
  }

  template <class Object>
  std::string read(const std::string& text) {
    int used = 0;
    return dumped(Object(text.data(), static_cast<int>(text.size()), &used, module_));
  }

  ProviderDefModule* module_ = registerModule(std::make_unique<ProviderDefModule>("disk", true));
};

const char kModule[] =
    "*** Start of ProviderDefModule Dump ***\nModule Name: disk\nPath type: short\n"
    "Need Init: false\n*** End   of ProviderDefModule Dump ***\n";

std::string framed(const std::string& name, const std::string& body) {
  return "*** Start of " + name + " Dump ***\n" + body + "*** End   of " + name + " Dump ***\n";
}

std::string function(const std::string& name, int type, const std::string& module = kModule) {
  return framed("ProviderDefFunction", "Function Name: " + name + "\nFunction Type: " +
                                           std::to_string(type) + "\n" + module);
}

std::string call(const std::string& content) {
  return framed("ProviderDefFunctionCall", content);
}

std::string argument(const std::string& content) {
  return framed("ProviderDefArgument", content);
}

std::string value(const std::string& content) {
  return framed("ProviderDefValue", content);
}

}  // namespace

TEST_F(Dump, ValuesOfEveryType) {
  ProviderDefValue indexString("Disk");
  indexString.setIndexStringType();
  const std::pair<ProviderDefValue, std::string> cases[] = {
      {-5, "Value Type: int, Value: -5\n"},
      {"100%n %s", "Value Type: string, Value: 100%n %s\n"},
      {std::vector<int>{7, 8}, "Value Type: int array\n0 : 7, 1 : 8, "},
      {std::vector<int>{}, "Value Type: int array\n"},
      {std::vector<std::string>{"a", ""}, "Value Type: string array\n0 : a, 1 : , "},
      {indexString, "Value Type: index string, Value: Disk\n"},
      {true, "Value Type: boolean, Value: true\n"},
      {false, "Value Type: boolean, Value: false\n"},
      {5L, ""},
  };
  for (const auto& [object, content] : cases) EXPECT_EQ(dumped(object), value(content));
}

TEST_F(Dump, ModuleLeavesItsInitCallOutInsideItself) {
  const std::string text =
      "<module name='/opt/m.so' path='fullpath'><functioncall><function name='start' "
      "type='getI'/></functioncall></module>";
  int used = 0;
  const ProviderDefModule module(text.data(), static_cast<int>(text.size()), &used);
  const std::string head = "Module Name: /opt/m.so\nPath type: fullpath\nNeed Init: true\n";
  const std::string inner = framed("ProviderDefModule", head);
  const std::string whole = framed("ProviderDefModule", head + call(function("start", 100, inner)));
  EXPECT_EQ(dumped(module), whole);
  EXPECT_EQ(dumped(module), whole) << "the guard is set back";
}

TEST_F(Dump, CallWithEveryKindOfArgument) {
  EXPECT_EQ(
      read<ProviderDefFunctionCall>(
          "<functioncall><function name='f' type='execCv'/><argument type='index'/>"
          "<argument type='input'/><argument type='output'/><argument type='element'>"
          "<constant type='int'>3</constant></argument><argument type='element'><functioncall>"
          "<function name='g' type='none'/></functioncall></argument><argument type='element'>"
          "<cimproperty>SELECT %s</cimproperty></argument></functioncall>"),
      call(function("f", 233) + argument("Argument Type: index\n") +
           argument("Argument Type: input\n") + argument("Argument Type: output\n") +
           argument("Argument Type: element\nArgument Element Type: constant\n" +
                    value("Value Type: int, Value: 3\n")) +
           argument("Argument Type: element\nArgument Element Type: functioncall\n" +
                    call(function("g", -1))) +
           argument("Argument Type: element\nArgument Element Type: cimproperty\n"
                    "WQL Query: SELECT %s\n")));
}

TEST_F(Dump, ClassWithPropertiesAndMethods) {
  const std::string constant = "<constant type='boolean'>true</constant>";
  const std::string count = "<functioncall><function name='count' type='getI'/></functioncall>";
  const std::string countCall = call(function("count", 100));
  const std::string yes = value("Value Type: boolean, Value: true\n");
  const std::string p =
      "Property Name: P\nGet Valuemap conversion true\nGet Type: constant\n" + yes;
  const std::string q = "Property Name: Q\nGet Valuemap conversion false\nGet Type: function\n" +
                        countCall + "Set Type: constant\n" + yes;
  EXPECT_EQ(
      read<ProviderDefClass>("<class name='C' namespace='root/c'><instances>" + count +
                             "</instances><property name='P'><get>" + constant +
                             "<conversion type='valuemap'/></get></property>"
                             "<property name='Q'><get>" +
                             count + "</get><set>" + constant +
                             "</set></property><method name='M'>" + count + "</method></class>"),
      framed("ProviderDefClass",
             "Class Name: C\nNamespaces Name: root/c\nNumber of Instances Type: function\n" +
                 countCall + framed("ProviderDefProperty", p) + framed("ProviderDefProperty", q) +
                 framed("ProviderDefMethod", "Method Name: M\n" + countCall)));
  EXPECT_EQ(read<ProviderDefClass>("<class name='E' namespace='n'><instances><constant "
                                   "type='int'>4</constant></instances></class>"),
            framed("ProviderDefClass",
                   "Class Name: E\nNamespaces Name: n\nNumber of Instances Type: constant\n"
                   "Number of Instances : 4\n"));
}

TEST_F(Dump, AssociationWithItsConditions) {
  const std::string constant = "<constant type='string'>x</constant>";
  const std::string text =
      "<association name='L' namespace2='root/l' propertyname1='A' propertyname2='B'>"
      "<classname name='K'><propertyname name='a'/><propertyname name='b'/></classname>"
      "<classname name='T'/><condition><or><condition><partof>1" +
      constant +
      "</partof></condition><condition><false/></condition></or></condition>"
      "<classname name='T'/><classname name='T'/><condition><true/></condition></association>";
  const std::string partof =
      framed("ProviderDefCondition",
             "Condition Type : 1\nValueType 1: 2 \nproperty index : 1\nValueType 2: 0 \n" +
                 value("Value Type: string, Value: x\n"));
  const auto logical = [](const std::string& type, const std::string& first,
                          const std::string& second) {
    return framed("ProviderDefCondition", "Condition Type : " + type + "\nCondition 1\n" + first +
                                              "Condition 2\n" + second);
  };
  EXPECT_EQ(read<ProviderDefAssociation>(text),
            framed("ProviderDefAssociation",
                   "Class Name: L\nNamespaces Name: root/l\nProperty Name 1: A\n"
                   "Property Name 2: B\nClass Name Pair[0] Class Name 1: K\n"
                   "Class Name Pair[0] Class Name 2: T\n" +
                       logical("4", partof, logical("6", "", "")) +
                       "Class Name Pair[1] Class Name 1: T\nClass Name Pair[1] Class Name 2: T\n" +
                       logical("5", "", "") +
                       "Class properties\nClass : K -  a  b Class : T - Class : T - Class : T - "));
}
