// The elements association, classname, propertyname and condition with its operators.

#include "association/ProviderDefAssociation.h"
#include "definition/ElementReader.h"
#include "definition/ModuleElement.h"
#include "diagnostics/debug.h"

#include <iterator>

struct ProviderDefAssociation::Parser {
  static constexpr char kUnexpected[] = "Unexpected element: ";

  ProviderDefAssociation& association;
  ElementReader& reader;
  ProviderDefModule* module;

  void readAttributes() {
    for (const auto& [key, value] : reader.unit().getAttributes()) {
      if (key == "propertyname1") association.propertyName1_ = value;
      if (key == "propertyname2") association.propertyName2_ = value;
      if (key == "name") association.name_ = value;
      if (key == "namespace2") association.namespace_ = value;
    }
  }

  // Two classes and the condition that relates them.
  void readGroup() {
    static const char kClassMissing[] = "classname element is missing before : ";
    static const char kConditionMissing[] = "condition element is missing before : ";
    std::string first = readClass();
    reader.expectStart("classname", kClassMissing);
    std::string second = readClass();
    reader.expectStart("condition", kConditionMissing);
    association.conditions_.emplace_back(reader, module);
    association.classNamePairs_.emplace_back(std::move(first), std::move(second));
    reader.advance();
  }

  std::string readClass() {
    std::string name = attribute(reader, "name");
    std::vector<std::string> properties;
    if (!reader.isEmptyElement()) {
      reader.advance();
      while (reader.isStart("propertyname")) {
        properties.push_back(attribute(reader, "name"));
        reader.skipEmpty("propertyname", kUnexpected);
      }
      reader.expectEnd("classname", kUnexpected);
    }
    reader.advance();
    association.classProperties_.emplace_back(name, std::move(properties));
    return name;
  }
};

ProviderDefAssociation::ProviderDefAssociation(const char* text, int length, int* consumed,
                                               ProviderDefModule* module) {
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefAssociation::ProviderDefAssociation(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefAssociation::read(ElementReader& reader, ProviderDefModule* module) {
  debug(9, "ProviderDefAssociation Constructor\n");
  reader.retrace();
  withContext("association", name_, [&] {
    Parser parser{*this, reader, module};
    parser.readAttributes();
    reader.enter(Parser::kUnexpected);
    if (reader.isStart("module")) parser.module = readModule(reader);
    while (!reader.isEnd("association")) {
      if (reader.isStart("condition")) reader.fail("classname element is missing before : ");
      reader.expectStart("classname", Parser::kUnexpected);
      parser.readGroup();
    }
  });
}

struct ProviderDefCondition::Parser {
  ProviderDefCondition& condition;
  ElementReader& reader;
  ProviderDefModule* module;

  static int operatorCode(const std::string& name) {
    static const char* const kOperators[] = {"equal", "partof", "include", "and",
                                             "or",    "true",   "false"};
    for (size_t i = 0; i < std::size(kOperators); ++i) {
      if (name == kOperators[i]) return static_cast<int>(i);
    }
    return kUnread;
  }

  void readOperator() {
    static const char kUnexpected[] = "Unexpected element in condition: ";
    const std::string name = reader.unit().getName();
    condition.type_ = operatorCode(name);
    if (condition.type_ == kUnread || !reader.isStart(name)) reader.fail(kUnexpected);
    if (condition.type_ == kTrue || condition.type_ == kFalse) {
      reader.skipEmpty(name, kUnexpected);
      return;
    }
    reader.enter(kUnexpected);
    if (condition.type_ == kAnd || condition.type_ == kOr) {
      condition.condition1_ = readCondition();
      condition.condition2_ = readCondition();
    } else {
      const std::string text = readOperand(condition.operand1_);
      readSecondOperand(text);
    }
    reader.expectEnd(name, kUnexpected);
    reader.advance();
  }

  ClonePointer<ProviderDefCondition> readCondition() {
    auto nested = std::make_unique<ProviderDefCondition>(reader, module);
    reader.advance();
    return nested;
  }

  // Gives what a text operand holds behind its first word.
  std::string readOperand(Operand& operand) {
    if (reader.isStart("constant")) {
      operand.kind = kConstant;
      operand.constant = readConstant(reader);
    } else if (reader.isStart("functioncall")) {
      operand.kind = kFunctionCall;
      operand.call = ProviderDefFunctionCall(reader, module);
      reader.advance();
    } else if (reader.isText() && !reader.unit().getName().empty()) {
      const std::string text = reader.unit().getName();
      setPropertyIndex(operand, text);
      reader.advance();
      return behindFirstWord(text);
    } else {
      reader.fail("Unexpected element in condition: ");
    }
    return std::string();
  }

  // Two property indexes cannot be told apart as units: "0 1" is one text. The second word of the
  // first operand's text is the second operand where no other one follows.
  void readSecondOperand(const std::string& text) {
    if (!text.empty() && reader.unit().isEnd() && !reader.unit().isStart()) {
      setPropertyIndex(condition.operand2_, text);
    } else {
      readOperand(condition.operand2_);
    }
  }

  static void setPropertyIndex(Operand& operand, const std::string& text) {
    operand.kind = kPropertyIndex;
    operand.propertyIndex = decimalInteger(text);
  }

  static std::string behindFirstWord(const std::string& text) {
    const auto space = [](char c) { return isSpace(static_cast<unsigned char>(c)); };
    size_t position = 0;
    while (position < text.size() && !space(text[position])) ++position;
    while (position < text.size() && space(text[position])) ++position;
    return text.substr(position);
  }
};

ProviderDefCondition::ProviderDefCondition(const char* text, int length, int* consumed,
                                           ProviderDefModule* module) {
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefCondition::ProviderDefCondition(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefCondition::read(ElementReader& reader, ProviderDefModule* module) {
  debug(9, "ProviderDefCondition Constructor\n");
  reader.retrace();
  withContext("condition", std::string(), [&] {
    const NestingGuard guard(reader);
    reader.enter("Unexpected element in condition: ");
    Parser{*this, reader, module}.readOperator();
    reader.expectEnd("condition", "Unexpected element in condition: ");
  });
}
