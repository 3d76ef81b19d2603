#include "definition/ElementReader.h"

#include <algorithm>
#include <climits>
#include <cstdlib>

namespace {

thread_local const char* errorPosition = nullptr;
thread_local int nesting = 0;

}  // namespace

void ElementReader::advance() {
  position_ += unit_.getLength();
  unit_.parse(rest(), restLength());
}

void ElementReader::failAt(const std::string& message) const {
  const char* place = rest();
  while (place != text_ + length_ && isSpace(static_cast<unsigned char>(*place))) ++place;
  errorPosition = place;
  throw ProviderDefXMLError(message);
}

const char* ElementReader::lastErrorPosition() {
  return errorPosition;
}

void ElementReader::enter(const char* text) {
  if (!unit_.isStart()) fail(text);
  const bool hasContent = !unit_.isEnd();
  advance();
  if (!hasContent) fail(text);
}

void ElementReader::skipEmpty(std::string_view name, const char* text) {
  if (!isEmptyElement()) {
    advance();
    expectEnd(name, text);
  }
  advance();
}

NestingGuard::NestingGuard(const ElementReader& reader) {
  if (nesting >= kMaxDepth) reader.fail("elements are nested too deeply before: ");
  ++nesting;
}

NestingGuard::~NestingGuard() {
  --nesting;
}

ProviderDefValue readConstant(ElementReader& reader) {
  static const char kEndMissing[] = "the end of constant element missing before: ";
  const std::string type = attribute(reader, "type");
  std::string text;
  if (!reader.isEmptyElement()) {
    reader.advance();
    if (reader.isText()) {
      text = reader.unit().getName();
      reader.advance();
    }
    reader.expectEnd("constant", kEndMissing);
  }
  reader.advance();

  if (type == "int") return ProviderDefValue(decimalInteger(text));
  if (type == "boolean") return ProviderDefValue(text == "true");
  if (type != "string" && type != "indexstring") return ProviderDefValue();
  ProviderDefValue value(std::move(text));
  if (type == "indexstring") value.setIndexStringType();
  return value;
}

std::string attribute(const ElementReader& reader, std::string_view name) {
  std::string value;
  for (const auto& [key, text] : reader.unit().getAttributes()) {
    if (key == name) value = text;
  }
  return value;
}

int decimalInteger(const std::string& text) {
  const long number = std::strtol(text.c_str(), nullptr, 10);
  return static_cast<int>(std::clamp<long>(number, INT_MIN, INT_MAX));
}
