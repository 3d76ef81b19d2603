// The elements functioncall, function and argument.

#include "definition/ElementReader.h"
#include "definition/ModuleElement.h"
#include "diagnostics/debug.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/Registry.h"

#include <iterator>

ProviderDefFunction::ProviderDefFunction(const char* text, int length, int* consumed,
                                         ProviderDefModule* module)
    : type_(kInvalidFunctionType), module_(module) {
  ElementReader reader(text, length);
  read(reader);
  *consumed = reader.consumed();
}

ProviderDefFunction::ProviderDefFunction(ElementReader& reader, ProviderDefModule* module)
    : type_(kInvalidFunctionType), module_(module) {
  read(reader);
}

void ProviderDefFunction::read(ElementReader& reader) {
  debug(9, "ProviderDefFunction Constructor\n");
  reader.retrace();
  withContext("function", name_, [&] {
    for (const auto& [key, value] : reader.unit().getAttributes()) {
      if (key == "name") name_ = value;
      if (key == "type") type_ = functionTypeCode(value);
    }
    if (!reader.isEmptyElement()) {
      reader.advance();
      if (reader.isStart("module")) module_ = readModule(reader);
      reader.expectEnd("function", "end of the function element missing before: ");
    }
  });
}

namespace {

// Reads the `function` element that is the current unit and goes past it; gives the registered
// function of that name. The first declaration of a name fixes its type and module.
ProviderDefFunction* readFunction(ElementReader& reader, ProviderDefModule* module) {
  auto read = std::make_unique<ProviderDefFunction>(reader, module);
  reader.advance();
  return registerNewFunction(std::move(read));
}

}  // namespace

ProviderDefFunctionCall::ProviderDefFunctionCall(const char* text, int length, int* consumed,
                                                 ProviderDefModule* module) {
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefFunctionCall::ProviderDefFunctionCall(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefFunctionCall::read(ElementReader& reader, ProviderDefModule* module) {
  debug(9, "ProviderDefFunctionCall Constructor\n");
  reader.retrace();
  // The element has no name of its own.
  withContext("functioncall", std::string(), [&] {
    const NestingGuard guard(reader);
    reader.expectStart("functioncall", "functioncall elememt is missing before: ");
    reader.enter("function elememt is missing before: ");
    reader.expectStart("function", "function elememt is missing before: ");
    function_ = readFunction(reader, module);
    while (reader.isStart("argument")) {
      arguments_.emplace_back(reader, module);
      reader.advance();
    }
    reader.expectEnd("functioncall", "Unexpected elememt before: ");
  });
}

namespace {

const char kUnexpected[] = "Unexpected element in the function element: ";

// Reads the `cimproperty` element that is the current unit and goes past it; gives its text.
std::string readCimProperty(ElementReader& reader) {
  std::string query;
  if (!reader.isEmptyElement()) {
    reader.advance();
    if (reader.isText()) {
      query = reader.unit().getName();
      reader.advance();
    }
    reader.expectEnd("cimproperty", "the end of cimproperty element missing before: ");
  }
  reader.advance();
  return query;
}

}  // namespace

void ProviderDefArgument::readElement(ElementReader& reader, ProviderDefModule* module) {
  if (reader.isStart("constant")) {
    elementType_ = kConstant;
    constant_ = readConstant(reader);
  } else if (reader.isStart("functioncall")) {
    elementType_ = kFunctionCall;
    functionCall_ = std::make_unique<ProviderDefFunctionCall>(reader, module);
    reader.advance();
  } else if (reader.isStart("cimproperty")) {
    elementType_ = kCimProperty;
    queryString_ = readCimProperty(reader);
  } else {
    reader.fail(kUnexpected);
  }
}

ProviderDefArgument::ProviderDefArgument(const char* text, int length, int* consumed,
                                         ProviderDefModule* module) {
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefArgument::ProviderDefArgument(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefArgument::read(ElementReader& reader, ProviderDefModule* module) {
  static const char* const kTypes[] = {"index", "input", "element", "output"};
  debug(9, "ProviderDefArgument Constructor\n");
  reader.retrace();
  withContext("argument", std::string(), [&] {
    const std::string type = attribute(reader, "type");
    type_ = -1;
    for (size_t i = 0; i < std::size(kTypes); ++i) {
      if (type == kTypes[i]) type_ = static_cast<int>(i);
    }
    if (type_ == -1) reader.failAt("invalid attribute: " + type);
    const bool hasContent = type_ == kElement || !reader.isEmptyElement();
    if (type_ == kElement) {
      reader.enter(kUnexpected);
      readElement(reader, module);
    } else if (hasContent) {
      reader.advance();
    }
    if (hasContent) reader.expectEnd("argument", "the end of argument element missing before: ");
  });
}
