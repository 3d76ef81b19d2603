// Malformed text and the whole message that it gives: the error, then the elements around it. More
// errors, without the elements, stand in the table of docs/definition-files.md, which is tested
// too.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "engine/ProviderDefFunctionCall.h"
#include "tests/definition/Reading.h"

namespace {

struct ErrorCase {
  std::string name, text, message;
};

class SyntaxError : public Registered, public testing::WithParamInterface<ErrorCase> {};

TEST_P(SyntaxError, GivesTheWholeMessage) {
  EXPECT_EQ(errorOfReading(GetParam().text), GetParam().message) << GetParam().text;
}

// Cases that stand behind `before`, with the same lines of context at the end of their messages.
auto within(const std::string& before, const std::string& context, std::vector<ErrorCase> cases) {
  for (ErrorCase& one : cases) {
    one.text = before + one.text;
    one.message += context;
  }
  return testing::ValuesIn(cases);
}

#define ERRORS(suite, cases) INSTANTIATE_TEST_SUITE_P(suite, SyntaxError, cases, kCaseName)

const std::string kCall = "\nfunctioncall:\n";
const std::string kInModule = "\nmodule:m\n";
const std::vector<ErrorCase> kModuleErrors = {
    {"Text", " some text <b>", "the end of module element missing before: some text"},
    {"NoCallContent", "<functioncall/></module>",
     "function elememt is missing before: module" + kCall},
    {"EndOfFile", "", "the end of module element missing before: "}};
ERRORS(Module, within("<plugin><module name='m'>", kInModule, kModuleErrors));

const std::string kInit = "<plugin><module name='m'><functioncall>";
const std::string kFunction = "<function name='f' type='getI'/>";
const std::vector<ErrorCase> kCallErrors = {
    {"Text", kFunction + "5", "Unexpected elememt before: 5"},
    {"FunctionEnd", "<function name='f' type='getI'><argument/>",
     "end of the function element missing before: argument\nfunction:f\n"},
    {"ModuleOfFunction", "<function name='f'><module name='n'>x",
     "the end of module element missing before: x\nmodule:n\n\nfunction:f\n"}};
ERRORS(Call, within(kInit, kCall + kInModule, kCallErrors));

const std::string kElement = "<argument type='element'>";
const std::vector<ErrorCase> kArgumentErrors = {
    {"NoKind", "<argument/>", "invalid attribute: "},
    {"OtherElement", kElement + "<string>", "Unexpected element in the function element: string"},
    {"NoElement", "<argument type='element'/></functioncall>",
     "Unexpected element in the function element: functioncall"},
    {"TwoConstants", kElement + "<constant type='int'>1</constant><constant>",
     "the end of argument element missing before: constant"},
    {"ContentOfIndex", "<argument type='index'>1</argument>",
     "the end of argument element missing before: 1"},
    {"ConstantEnd", kElement + "<constant type='int'>1<b/>",
     "the end of constant element missing before: b"},
    {"NestedCall", kElement + "<functioncall><function name='g'/><argument type='x'/>",
     "invalid attribute: x\nargument:\n" + kCall}};
ERRORS(Argument, within(kInit + kFunction, "\nargument:\n" + kCall + kInModule, kArgumentErrors));

const std::string kInClass = "\nclass:C\n";
const std::string kNoInstances = "instance elememt is missing in class element before: ";
const std::string kNoCount =
    "constant or functioncall elememt is missing in class element before: ";
const std::vector<ErrorCase> kClassErrors = {
    {"EndOfFile", "", kNoInstances},
    {"InstancesText", "<instances>3</instances>", kNoCount + "3"},
    {"NoInstancesContent", "<instances/><property name='P'>", kNoCount + "property"},
    {"InstancesEnd", "<instances><constant type='int'>1</constant>2",
     "end of the instances element is missing before: 2"},
    {"MethodWithConstant", kOneInstance + "<method name='M'><constant type='int'>",
     "functioncall element is missing before: constant\nmethod:M\n"},
    {"MethodEnd",
     kOneInstance + "<method name='M'><functioncall>" + kFunction + "</functioncall></get>",
     "end of the method element is missing before: get\nmethod:M\n"}};
ERRORS(Class, within(kClass, kInClass, kClassErrors));
ERRORS(EmptyClass, within(kModule + "<class name='C'/></plugin>", kInClass,
                          {{"NoContent", "", kNoInstances + "plugin"}}));

const std::string kConstant = "<constant type='int'>1</constant>";
const std::string kGet = "<get>" + kConstant + "</get>";
const std::string kNoValue =
    "constant or functioncall elememt is missing in property element before: ";
const std::vector<ErrorCase> kPropertyErrors = {
    {"NoGet", "<set>", "get element is missing before: set"},
    {"NoGetContent", "<get/></property>", kNoValue + "property"},
    {"TextInSet", kGet + "<set>1", kNoValue + "1"},
    {"TwoConversions", "<get>" + kConstant + "<conversion type='valuemap'/><conversion/>",
     "end of the get element is missing before: conversion"},
    {"SetEnd", kGet + "<set>" + kConstant + "<conversion/>",
     "end of the set element is missing before: conversion"}};
ERRORS(Property,
       within(kClassBody + "<property name='P'>", "\nproperty:P\n" + kInClass, kPropertyErrors));

const std::string kAssociation = kModule + "<association name='A'>";
const std::string kInAssociation = "\nassociation:A\n";
const std::string kPair = "<classname name='X'/><classname name='Y'/>";
const std::vector<ErrorCase> kAssociationErrors = {
    {"OneClass", "<classname name='X'/></association>",
     "classname element is missing before : association"},
    {"NoCondition", kPair + "</association>", "condition element is missing before : association"},
    {"EndOfFile", kPair + "<condition><true/></condition>", "Unexpected element: "}};
ERRORS(Association, within(kAssociation, kInAssociation, kAssociationErrors));

const std::string kInCondition = "\ncondition:\n";
const std::string kUnexpected = "Unexpected element in condition: ";
const std::vector<ErrorCase> kConditionErrors = {
    {"NoOperator", "</condition>", kUnexpected + "condition"},
    {"OneOperand", "<partof>0</partof>", kUnexpected + "partof"},
    {"OneSubCondition", "<and><condition><true/></condition></and>",
     kUnexpected + "and" + kInCondition},
    {"Nested", "<or><condition><and><condition><xor>",
     kUnexpected + "xor" + kInCondition + kInCondition},
    {"CallOfOperand", "<equal><functioncall>1", "function elememt is missing before: 1" + kCall}};
ERRORS(Condition, within(kAssociation + kPair + "<condition>", kInCondition + kInAssociation,
                         kConditionErrors));

// The elements around a call look at its name before they build it.
TEST(CallElement, ChecksItsOwnName) {
  int used = 0;
  try {
    ProviderDefFunctionCall("<call>", 6, &used, nullptr);
    FAIL() << "no error";
  } catch (const ProviderDefXMLError& error) {
    EXPECT_EQ(error.getMessage(), "functioncall elememt is missing before: call" + kCall);
  }
}

}  // namespace
