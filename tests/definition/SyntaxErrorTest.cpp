// Malformed text and the whole message that it gives: the error, then the elements around it. More
// errors, without the elements, stand in the table of docs/definition-files.md, which is tested
// too.

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "engine/ProviderDefFunctionCall.h"
#include "tests/definition/Reading.h"

namespace {

/// Texts behind `before` and their messages, all of which end with the lines `context`.
struct Errors {
  std::string before, context;
  std::vector<std::pair<std::string, std::string>> cases;
};

const std::string kConstant = "<constant type='int'>1</constant>";
const std::string kFunction = "<function name='f' type='getI'/>";
const std::string kInit = "<plugin><module name='m'><functioncall>";
const std::string kElement = "<argument type='element'>";
const std::string kAssociation = kModule + "<association name='A'>";
const std::string kPair = "<classname name='X'/><classname name='Y'/>";
const std::string kGet = "<get>" + kConstant + "</get>";

const std::string kInModule = "\nmodule:m\n";
const std::string kInCall = "\nfunctioncall:\n";
const std::string kInClass = "\nclass:C\n";
const std::string kInAssociation = "\nassociation:A\n";
const std::string kInCondition = "\ncondition:\n";

const std::string kNoInstances = "instance elememt is missing in class element before: ";
const std::string kNoValue = "constant or functioncall elememt is missing in ";
const std::string kNoCount = kNoValue + "class element before: ";
const std::string kNoProperty = kNoValue + "property element before: ";
const std::string kUnexpected = "Unexpected element in condition: ";

const Errors kErrors[] = {
    {"<plugin><module name='m'>",
     kInModule,
     {{" some text <b>", "the end of module element missing before: some text"},
      {"<functioncall/></module>", "function elememt is missing before: module" + kInCall},
      {"", "the end of module element missing before: "}}},
    {kInit,
     kInCall + kInModule,
     {{kFunction + "5", "Unexpected elememt before: 5"},
      {"<function name='f'><module name='n'>x",
       "the end of module element missing before: x\nmodule:n\n\nfunction:f\n"}}},
    {kInit + kFunction,
     "\nargument:\n" + kInCall + kInModule,
     {{"<argument/>", "invalid attribute: "},
      {"<argument type='element'/></functioncall>",
       "Unexpected element in the function element: functioncall"},
      {"<argument type='index'>1</argument>", "the end of argument element missing before: 1"},
      {kElement + "<constant type='int'>1<b/>", "the end of constant element missing before: b"},
      {kElement + "<functioncall><function name='g'/><argument type='x'/>",
       "invalid attribute: x\nargument:\n" + kInCall}}},
    {kClass,
     kInClass,
     {{"", kNoInstances},
      {"<instances/><property name='P'>", kNoCount + "property"},
      {"<instances>" + kConstant + "2", "end of the instances element is missing before: 2"},
      {kOneInstance + "<method name='M'><functioncall>" + kFunction + "</functioncall></get>",
       "end of the method element is missing before: get\nmethod:M\n"}}},
    {kModule + "<class name='C'/></plugin>", kInClass, {{"", kNoInstances + "plugin"}}},
    {kClassBody + "<property name='P'>",
     "\nproperty:P\n" + kInClass,
     {{"<get/>" + kConstant + "</get>", kNoProperty + "constant"},
      {kGet + "<set>1", kNoProperty + "1"},
      {"<get>" + kConstant + "<conversion type='valuemap'/><conversion/>",
       "end of the get element is missing before: conversion"}}},
    {kAssociation,
     kInAssociation,
     {{"<classname name='X'/></association>", "classname element is missing before : association"},
      {kPair + "</association>", "condition element is missing before : association"},
      {kPair + "<condition><true/></condition>", "Unexpected element: "}}},
    {kAssociation + kPair + "<condition>",
     kInCondition + kInAssociation,
     {{"</condition>", kUnexpected + "condition"},
      {"<partof>0</partof>", kUnexpected + "partof"},
      {"<and><condition><true/></condition></and>", kUnexpected + "and" + kInCondition},
      {"<or><condition><and><condition><xor>", kUnexpected + "xor" + kInCondition + kInCondition},
      {"<equal><functioncall>1", "function elememt is missing before: 1" + kInCall}}},
};

class SyntaxError : public Registered {};

TEST_F(SyntaxError, GivesTheWholeMessage) {
  for (const Errors& errors : kErrors) {
    for (const auto& [text, message] : errors.cases) {
      EXPECT_EQ(errorOfReading(errors.before + text), message + errors.context) << text;
      release();
    }
  }
}

// The elements around a call look at its name before they build it.
TEST_F(SyntaxError, CallsCheckTheirOwnName) {
  int used = 0;
  try {
    ProviderDefFunctionCall("<call>", 6, &used, nullptr);
    FAIL() << "no error";
  } catch (const ProviderDefXMLError& error) {
    EXPECT_EQ(error.getMessage(), "functioncall elememt is missing before: call" + kInCall);
  }
}

}  // namespace
