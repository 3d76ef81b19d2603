// Malformed text and the whole message that it gives: the error, then the elements around it.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "engine/ProviderDefFunctionCall.h"
#include "tests/definition/Reading.h"

namespace {

struct ErrorCase {
  const char* name;
  std::string text, message;
};

void PrintTo(const ErrorCase& value, std::ostream* out) {
  *out << value.text;
}

class SyntaxError : public Registered, public testing::WithParamInterface<ErrorCase> {};

TEST_P(SyntaxError, GivesTheWholeMessage) {
  EXPECT_EQ(errorOfReading(GetParam().text), GetParam().message);
}

// Lines of context.
const std::string kInModule = "\nmodule:m\n";
const std::string kInCall = "\nfunctioncall:\n";
const std::string kInClass = "\nclass:C\n";
const std::string kInProperty = "\nproperty:P\n" + kInClass;
const std::string kInMethod = "\nmethod:M\n" + kInClass;
const std::string kInAssociation = "\nassociation:A\n";
const std::string kInCondition = "\ncondition:\n";

const std::string kInit = "<plugin><module name='m'><functioncall>";
const std::string kFunction = "<function name='f' type='getI'/>";

INSTANTIATE_TEST_SUITE_P(
    Module, SyntaxError,
    testing::Values(ErrorCase{"OtherElement", "<plugin><module name='m'><class/>",
                              "the end of module element missing before: class" + kInModule},
                    ErrorCase{"Text", "<plugin><module name='m'> some text <b>",
                              "the end of module element missing before: some text" + kInModule},
                    ErrorCase{"EndOfFile", "<plugin><module>",
                              "the end of module element missing before: \nmodule:\n"}),
    kCaseName);

INSTANTIATE_TEST_SUITE_P(
    Call, SyntaxError,
    testing::Values(ErrorCase{"ArgumentFirst", kInit + "<argument type='index'/>",
                              "function elememt is missing before: argument" + kInCall + kInModule},
                    ErrorCase{"NoContent", "<plugin><module name='m'><functioncall/></module>",
                              "function elememt is missing before: module" + kInCall + kInModule},
                    ErrorCase{"Text", kInit + kFunction + "5",
                              "Unexpected elememt before: 5" + kInCall + kInModule},
                    ErrorCase{"FunctionEnd", kInit + "<function name='f' type='getI'><argument/>",
                              "end of the function element missing before: argument\nfunction:f\n" +
                                  kInCall + kInModule},
                    ErrorCase{
                        "ModuleOfFunction", kInit + "<function name='f'><module name='n'>x",
                        "the end of module element missing before: x\nmodule:n\n\nfunction:f\n" +
                            kInCall + kInModule}),
    kCaseName);

struct ArgumentCase {
  const char* name;
  std::string text, error;
};

class ArgumentError : public Registered, public testing::WithParamInterface<ArgumentCase> {};

TEST_P(ArgumentError, GivesTheWholeMessage) {
  EXPECT_EQ(errorOfReading(kInit + kFunction + GetParam().text),
            GetParam().error + "\nargument:\n" + kInCall + kInModule);
}

INSTANTIATE_TEST_SUITE_P(
    Argument, ArgumentError,
    testing::Values(
        ArgumentCase{"Kind", "<argument type='inout'/>", "invalid attribute: inout"},
        ArgumentCase{"NoKind", "<argument/>", "invalid attribute: "},
        ArgumentCase{"OtherElement", "<argument type='element'><string>",
                     "Unexpected element in the function element: string"},
        ArgumentCase{"NoElement", "<argument type='element'/></functioncall>",
                     "Unexpected element in the function element: functioncall"},
        ArgumentCase{"TwoConstants",
                     "<argument type='element'><constant type='int'>1</constant><constant>",
                     "the end of argument element missing before: constant"},
        ArgumentCase{"ContentOfIndex", "<argument type='index'>1</argument>",
                     "the end of argument element missing before: 1"},
        ArgumentCase{"ConstantEnd", "<argument type='element'><constant type='int'>1<b/>",
                     "the end of constant element missing before: b"},
        ArgumentCase{"QueryEnd", "<argument type='element'><cimproperty>A.B<b/>",
                     "the end of cimproperty element missing before: b"},
        ArgumentCase{"NestedCall",
                     "<argument type='element'><functioncall><function name='g'/><argument "
                     "type='x'/>",
                     "invalid attribute: x\nargument:\n\nfunctioncall:\n"}),
    kCaseName);

INSTANTIATE_TEST_SUITE_P(
    Class, SyntaxError,
    testing::Values(
        ErrorCase{"PropertyFirst", kClass + "<property name='P'>",
                  "instance elememt is missing in class element before: property" + kInClass},
        ErrorCase{"NoContent", kModule + "<class name='C'/></plugin>",
                  "instance elememt is missing in class element before: plugin" + kInClass},
        ErrorCase{"EndOfFile", kClass,
                  "instance elememt is missing in class element before: " + kInClass},
        ErrorCase{
            "InstancesText", kClass + "<instances>3</instances>",
            "constant or functioncall elememt is missing in class element before: 3" + kInClass},
        ErrorCase{"NoInstancesContent", kClass + "<instances/><property name='P'>",
                  "constant or functioncall elememt is missing in class element before: property" +
                      kInClass},
        ErrorCase{"InstancesEnd", kClass + "<instances><constant type='int'>1</constant>2",
                  "end of the instances element is missing before: 2" + kInClass},
        ErrorCase{"OtherChild", kClassBody + "<association name='A'>",
                  "Unexpected elememt: association" + kInClass}),
    kCaseName);

const std::string kProperty = kClassBody + "<property name='P'>";
const std::string kConstant = "<constant type='int'>1</constant>";
const std::string kGet = "<get>" + kConstant + "</get>";

INSTANTIATE_TEST_SUITE_P(
    Member, SyntaxError,
    testing::Values(
        ErrorCase{"NoGet", kProperty + "<set>", "get element is missing before: set" + kInProperty},
        ErrorCase{"NoContent", kClassBody + "<property name='P'/><method>",
                  "get element is missing before: method" + kInProperty},
        ErrorCase{"SetInGet", kProperty + "<get><set>",
                  "constant or functioncall elememt is missing in property element before: set" +
                      kInProperty},
        ErrorCase{"TextInSet", kProperty + kGet + "<set>1",
                  "constant or functioncall elememt is missing in property element before: 1" +
                      kInProperty},
        ErrorCase{"GetEnd", kProperty + "<get>" + kConstant + "<set>",
                  "end of the get element is missing before: set" + kInProperty},
        ErrorCase{"TwoConversions",
                  kProperty + "<get>" + kConstant + "<conversion type='valuemap'/><conversion/>",
                  "end of the get element is missing before: conversion" + kInProperty},
        ErrorCase{"SetEnd", kProperty + kGet + "<set>" + kConstant + "<conversion/>",
                  "end of the set element is missing before: conversion" + kInProperty},
        ErrorCase{"ConversionAfterSet",
                  kProperty + kGet + "<set>" + kConstant + "</set><conversion type='valuemap'/>",
                  "end of the property element is missing before: conversion" + kInProperty},
        ErrorCase{"MethodWithConstant", kClassBody + "<method name='M'>" + kConstant,
                  "functioncall element is missing before: constant" + kInMethod},
        ErrorCase{
            "MethodEnd",
            kClassBody + "<method name='M'><functioncall>" + kFunction + "</functioncall></get>",
            "end of the method element is missing before: get" + kInMethod}),
    kCaseName);

const std::string kAssociation = kModule + "<association name='A'>";
const std::string kPair = "<classname name='X'/><classname name='Y'/>";
const std::string kCondition = kAssociation + kPair + "<condition>";

INSTANTIATE_TEST_SUITE_P(
    Association, SyntaxError,
    testing::Values(ErrorCase{"OneClass", kAssociation + "<classname name='X'/></association>",
                              "classname element is missing before : association" + kInAssociation},
                    ErrorCase{"ConditionAfterOneClass",
                              kAssociation + "<classname name='X'/><condition>",
                              "classname element is missing before : condition" + kInAssociation},
                    ErrorCase{"ThreeClasses", kAssociation + kPair + "<classname name='Z'/>",
                              "condition element is missing before : classname" + kInAssociation},
                    ErrorCase{"NoCondition", kAssociation + kPair + "</association>",
                              "condition element is missing before : association" + kInAssociation},
                    ErrorCase{"OtherElement", kAssociation + "<class name='C'>",
                              "Unexpected element: class" + kInAssociation},
                    ErrorCase{"OtherInClassname", kAssociation + "<classname name='X'><property/>",
                              "Unexpected element: property" + kInAssociation},
                    ErrorCase{"EndOfFile", kCondition + "<true/></condition>",
                              "Unexpected element: " + kInAssociation}),
    kCaseName);

INSTANTIATE_TEST_SUITE_P(
    Condition, SyntaxError,
    testing::Values(
        ErrorCase{"Operator", kCondition + "<equals>",
                  "Unexpected element in condition: equals" + kInCondition + kInAssociation},
        ErrorCase{"NoOperator", kCondition + "</condition>",
                  "Unexpected element in condition: condition" + kInCondition + kInAssociation},
        ErrorCase{"ElementForOperand", kCondition + "<equal><argument/>",
                  "Unexpected element in condition: argument" + kInCondition + kInAssociation},
        ErrorCase{"OneOperand", kCondition + "<partof>0</partof>",
                  "Unexpected element in condition: partof" + kInCondition + kInAssociation},
        ErrorCase{"OtherClosing", kCondition + "<include>0 1</equal>",
                  "Unexpected element in condition: equal" + kInCondition + kInAssociation},
        ErrorCase{
            "OneSubCondition", kCondition + "<and><condition><true/></condition></and>",
            "Unexpected element in condition: and" + kInCondition + kInCondition + kInAssociation},
        ErrorCase{"Nested", kCondition + "<or><condition><and><condition><xor>",
                  "Unexpected element in condition: xor" + kInCondition + kInCondition +
                      kInCondition + kInAssociation},
        ErrorCase{
            "CallOfOperand", kCondition + "<equal><functioncall>1",
            "function elememt is missing before: 1" + kInCall + kInCondition + kInAssociation}),
    kCaseName);

// The elements around a call look at its name before they build it.
TEST(CallElement, ChecksItsOwnName) {
  int used = 0;
  try {
    ProviderDefFunctionCall("<call>", 6, &used, nullptr);
    FAIL() << "no error";
  } catch (const ProviderDefXMLError& error) {
    EXPECT_EQ(error.getMessage(), "functioncall elememt is missing before: call" + kInCall);
  }
}

}  // namespace
