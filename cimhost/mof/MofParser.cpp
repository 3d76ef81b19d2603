#include "cimhost/mof/MofParser.h"

#include "cimhost/mof/MofKeywords.h"
#include "cimhost/mof/Printable.h"

#include <algorithm>

namespace cimhost {
namespace {

constexpr std::size_t kMaxNodes = 1000000;
constexpr std::uint64_t kMaxArraySize = 65536;

std::string describe(const MofToken& token) {
  switch (token.kind) {
    case MofTokenKind::end:
      return "the end of the text";
    case MofTokenKind::name:
      return '\'' + shortened(token.text, 60) + '\'';
    case MofTokenKind::alias:
      return "'$" + shortened(token.text, 60) + '\'';
    case MofTokenKind::pragma:
      return "'#pragma'";
    case MofTokenKind::string:
      return "a string";
    case MofTokenKind::character:
      return "a character";
    case MofTokenKind::integer:
      return "an integer";
    case MofTokenKind::real:
      return "a real";
    case MofTokenKind::punctuation:
      return std::string("'") + token.mark + '\'';
  }
  return "?";
}

bool contradict(MofFlavor a, MofFlavor b) {
  const auto isPair = [a, b](MofFlavor x, MofFlavor y) {
    return (a == x && b == y) || (a == y && b == x);
  };
  return isPair(MofFlavor::enableOverride, MofFlavor::disableOverride) ||
         isPair(MofFlavor::toSubclass, MofFlavor::restricted);
}

}  // namespace

MofParser::MofParser(MofSourcePtr source) : source_(std::move(source)), lexer_(*source_) {}

void MofParser::fail(std::size_t offset, const std::string& message) const {
  throw MofError(*source_, offset, message);
}

void MofParser::failExpecting(const std::string& what) const {
  fail(current_.offset, "expected " + what + ", found " + describe(current_));
}

void MofParser::advance() {
  current_ = lexer_.next();
}

bool MofParser::at(char mark) const {
  return current_.kind == MofTokenKind::punctuation && current_.mark == mark;
}

bool MofParser::atKeyword(std::string_view keyword) const {
  return current_.kind == MofTokenKind::name && isMofKeyword(current_.text, keyword);
}

bool MofParser::accept(char mark) {
  if (!at(mark)) return false;
  advance();
  return true;
}

bool MofParser::acceptKeyword(std::string_view keyword) {
  if (!atKeyword(keyword)) return false;
  advance();
  return true;
}

void MofParser::expect(char mark) {
  if (!accept(mark)) failExpecting(std::string("'") + mark + '\'');
}

void MofParser::expectKeyword(std::string_view keyword) {
  if (!acceptKeyword(keyword)) failExpecting('\'' + std::string(keyword) + '\'');
}

MofName MofParser::expectName(const char* what) {
  if (current_.kind != MofTokenKind::name) failExpecting(what);
  MofName name{std::move(current_.text), current_.offset};
  advance();
  return name;
}

void MofParser::countNode() {
  if (++nodes_ > kMaxNodes) fail(current_.offset, "the declaration is too large");
}

std::optional<MofDeclaration> MofParser::next() {
  if (!started_) advance();
  started_ = true;
  while (current_.kind != MofTokenKind::end) {
    nodes_ = 0;
    if (current_.kind == MofTokenKind::pragma) return parsePragma();
    if (atKeyword("qualifier")) return parseQualifierDeclaration();
    if (auto declaration = parseClassOrInstance()) return declaration;
  }
  return std::nullopt;
}

// A directive that this reader does not know may hold any constants.
MofPragma MofParser::parsePragma() {
  advance();
  MofPragma pragma;
  pragma.name = expectName("the name of a pragma");
  if (!accept('(')) return pragma;
  pragma.parameter.offset = current_.offset;
  if (current_.kind == MofTokenKind::string) pragma.parameter.text = parseStrings();
  while (!at(')')) {
    if (current_.kind == MofTokenKind::end || at(';') || at('{')) failExpecting("')'");
    advance();
  }
  advance();
  return pragma;
}

MofQualifierDeclaration MofParser::parseQualifierDeclaration() {
  advance();
  MofQualifierDeclaration declaration;
  MofElement& element = declaration.element;
  element.name = expectName("the name of a qualifier");
  expect(':');
  const auto type = mofTypeFromKeyword(
      current_.kind == MofTokenKind::name ? std::string_view(current_.text) : std::string_view());
  if (!type) failExpecting("a data type");
  element.type = *type;
  advance();
  parseArray(element);
  if (accept('=')) element.value = parseInitializer();
  while (accept(',')) parseQualifierScopeOrFlavor(declaration);
  if (declaration.scope == 0) failExpecting("', scope(...)'");
  expect(';');
  return declaration;
}

void MofParser::parseQualifierScopeOrFlavor(MofQualifierDeclaration& declaration) {
  const bool isScope = acceptKeyword("scope");
  if (!isScope && !acceptKeyword("flavor")) failExpecting("'scope' or 'flavor'");
  expect('(');
  do {
    if (isScope) {
      const auto scope = mofScopeFromKeyword(current_.text);
      if (current_.kind != MofTokenKind::name || !scope) failExpecting("a kind of element");
      declaration.scope |= *scope;
      advance();
    } else {
      parseFlavor(declaration.flavors);
    }
  } while (accept(','));
  expect(')');
}

std::optional<MofDeclaration> MofParser::parseClassOrInstance() {
  std::vector<MofQualifier> qualifiers;
  const bool hasQualifiers = at('[');
  if (hasQualifiers) qualifiers = parseQualifierList();
  if (acceptKeyword("class")) return parseClass(std::move(qualifiers));
  if (!acceptKeyword("instance")) {
    failExpecting(hasQualifiers ? "'class' or 'instance'" : "a declaration");
  }
  skipInstance();
  return std::nullopt;
}

void MofParser::skipAlias() {
  if (!acceptKeyword("as")) return;
  if (current_.kind != MofTokenKind::alias) failExpecting("an alias ('$name')");
  advance();
}

MofClassDeclaration MofParser::parseClass(std::vector<MofQualifier> qualifiers) {
  MofClassDeclaration declaration;
  declaration.qualifiers = std::move(qualifiers);
  declaration.name = expectName("the name of a class");
  skipAlias();
  if (accept(':')) declaration.superclass = expectName("the name of the superclass");
  expect('{');
  while (!accept('}')) declaration.features.push_back(parseFeature());
  expect(';');
  return declaration;
}

void MofParser::skipInstance() {
  expectKeyword("of");
  expectName("the name of a class");
  skipAlias();
  expect('{');
  while (!accept('}')) {
    nodes_ = 0;
    if (at('[')) parseQualifierList();
    expectName("the name of a property or '}'");
    expect('=');
    parseInitializer();
    expect(';');
  }
  expect(';');
}

MofFeature MofParser::parseFeature() {
  countNode();
  MofFeature feature;
  if (at('[')) feature.qualifiers = parseQualifierList();
  parseTypeAndName(feature, "the name of a property or method");
  feature.isMethod = at('(');
  if (feature.isMethod) {
    if (feature.type == Pegasus::CIMTYPE_REFERENCE) {
      fail(feature.referenceClass.offset, "a method cannot return a reference");
    }
    feature.parameters = parseParameters();
  } else {
    parseArray(feature);
    if (accept('=')) feature.value = parseInitializer();
  }
  expect(';');
  return feature;
}

std::vector<MofElement> MofParser::parseParameters() {
  std::vector<MofElement> parameters;
  expect('(');
  if (accept(')')) return parameters;
  do {
    countNode();
    MofElement& parameter = parameters.emplace_back();
    if (at('[')) parameter.qualifiers = parseQualifierList();
    parseTypeAndName(parameter, "the name of a parameter");
    parseArray(parameter);
  } while (accept(','));
  expect(')');
  return parameters;
}

void MofParser::parseTypeAndName(MofElement& element, const char* what) {
  MofName type = expectName("a data type");
  if (const auto known = mofTypeFromKeyword(type.text)) {
    element.type = *known;
  } else if (acceptKeyword("ref")) {
    element.type = Pegasus::CIMTYPE_REFERENCE;
    element.referenceClass = std::move(type);
  } else {
    fail(type.offset, "unknown data type '" + shortened(type.text, 60) +
                          "' (a reference is written CLASS REF name)");
  }
  element.name = expectName(what);
}

void MofParser::parseArray(MofElement& element) {
  if (!accept('[')) return;
  element.isArray = true;
  if (accept(']')) return;
  const bool isInteger = current_.kind == MofTokenKind::integer;
  if (!isInteger) failExpecting("an array size or ']'");
  if (current_.negative || current_.magnitude == 0 || current_.magnitude > kMaxArraySize) {
    fail(current_.offset, "array size outside 1 to 65536");
  }
  element.arraySize = static_cast<std::uint32_t>(current_.magnitude);
  advance();
  expect(']');
}

std::vector<MofQualifier> MofParser::parseQualifierList() {
  std::vector<MofQualifier> qualifiers;
  expect('[');
  do {
    qualifiers.push_back(parseQualifier());
  } while (accept(','));
  expect(']');
  return qualifiers;
}

MofQualifier MofParser::parseQualifier() {
  countNode();
  MofQualifier qualifier;
  qualifier.name = expectName("the name of a qualifier");
  if (at('{')) {
    qualifier.value = parseInitializer();
  } else if (accept('(')) {
    qualifier.value.emplace();
    qualifier.value->offset = current_.offset;
    qualifier.value->literals.push_back(parseLiteral());
    expect(')');
  }
  if (accept(':')) {
    do {
      parseFlavor(qualifier.flavors);
    } while (current_.kind == MofTokenKind::name);
  }
  return qualifier;
}

void MofParser::parseFlavor(std::vector<MofFlavor>& flavors) {
  const auto flavor = mofFlavorFromKeyword(current_.text);
  if (current_.kind != MofTokenKind::name || !flavor) failExpecting("a flavor");
  for (const MofFlavor other : flavors) {
    if (contradict(*flavor, other)) {
      fail(current_.offset, "flavor " + describe(current_) + " contradicts an earlier one");
    }
  }
  if (std::find(flavors.begin(), flavors.end(), *flavor) == flavors.end()) {
    flavors.push_back(*flavor);
  }
  advance();
}

MofInitializer MofParser::parseInitializer() {
  MofInitializer initializer;
  initializer.offset = current_.offset;
  initializer.isArray = accept('{');
  if (initializer.isArray) {
    parseBraces(initializer);
  } else {
    initializer.literals.push_back(parseLiteral());
  }
  return initializer;
}

void MofParser::parseBraces(MofInitializer& initializer) {
  if (accept('}')) return;
  do {
    initializer.literals.push_back(parseLiteral());
  } while (accept(','));
  expect('}');
}

MofLiteral MofParser::parseLiteral() {
  countNode();
  MofLiteral literal;
  literal.offset = current_.offset;
  if (current_.kind == MofTokenKind::string) {
    literal.kind = MofLiteral::Kind::string;
    literal.text = parseStrings();
    return literal;
  }
  if (current_.kind == MofTokenKind::integer) {
    literal.kind = MofLiteral::Kind::integer;
    literal.negative = current_.negative;
    literal.magnitude = current_.magnitude;
  } else if (current_.kind == MofTokenKind::real) {
    literal.kind = MofLiteral::Kind::real;
    literal.real = current_.real;
  } else if (current_.kind == MofTokenKind::character) {
    literal.kind = MofLiteral::Kind::character;
    literal.unit = current_.unit;
  } else if (current_.kind == MofTokenKind::alias) {
    literal.kind = MofLiteral::Kind::alias;
    literal.text = current_.text;
  } else if (atKeyword("true") || atKeyword("false")) {
    literal.kind = MofLiteral::Kind::boolean;
    literal.boolean = atKeyword("true");
  } else if (!atKeyword("null")) {
    failExpecting("a value");
  }
  advance();
  return literal;
}

std::string MofParser::parseStrings() {
  std::string text;
  for (; current_.kind == MofTokenKind::string; advance()) text += current_.text;
  return text;
}

}  // namespace cimhost
