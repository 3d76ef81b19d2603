#include "cimhost/mof/MofLexer.h"

#include "cimhost/Text.h"
#include "cimhost/mof/MofKeywords.h"
#include "cimhost/mof/MofNumber.h"
#include "cimhost/mof/Printable.h"

namespace cimhost {
namespace {

constexpr std::size_t kMaxNameLength = 1024;
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

bool isBlank(char c) {
  return c == ' ' || (c >= '\t' && c <= '\r');
}
bool isDigit(char c) {
  return c >= '0' && c <= '9';
}

// The characters of CIM names: the same set that Pegasus::CIMName takes.
bool startsName(std::uint32_t c) {
  return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_' || (c >= 0x80 && c <= 0xFFEF);
}

bool continuesName(std::uint32_t c) {
  return startsName(c) || (c >= '0' && c <= '9');
}

std::string hexadecimal(std::uint32_t value, int digits) {
  std::string text;
  for (int shift = 4 * (digits - 1); shift >= 0; shift -= 4) {
    text += "0123456789ABCDEF"[value >> shift & 0xF];
  }
  return text;
}

std::string quoted(std::uint32_t character) {
  if (character < 0x20 || (character >= 0x7F && character < 0xA0)) {
    return "character U+" + hexadecimal(character, 4);
  }
  std::string text = "'";
  appendUtf8(text, character);
  return text + '\'';
}

}  // namespace

MofLexer::MofLexer(const MofSource& source) : source_(source) {
  if (at(kByteOrderMark)) offset_ = kByteOrderMark.size();
}

void MofLexer::fail(std::size_t offset, const std::string& message) const {
  throw MofError(source_, offset, message);
}

// Every character that is not plain ASCII passes here, in comments too.
std::uint32_t MofLexer::takeCharacter() {
  const std::size_t start = offset_;
  const std::int32_t codePoint = nextCodePoint(source_.text, offset_);
  if (codePoint < 0) {
    const auto byte = static_cast<unsigned char>(source_.text[start]);
    fail(start, "byte 0x" + hexadecimal(byte, 2) + " is not valid UTF-8");
  }
  if (codePoint == 0) fail(start, "NUL byte in the text");
  return static_cast<std::uint32_t>(codePoint);
}

void MofLexer::skipLineComment() {
  while (!atEnd() && source_.text[offset_] != '\n' && source_.text[offset_] != '\r') {
    takeCharacter();
  }
}

void MofLexer::skipBlockComment() {
  const std::size_t start = offset_;
  offset_ += 2;
  while (!at("*/")) {
    if (atEnd()) fail(start, "unterminated comment");
    takeCharacter();
  }
  offset_ += 2;
}

void MofLexer::skipBlanksAndComments() {
  for (;;) {
    if (at("//")) {
      skipLineComment();
    } else if (at("/*")) {
      skipBlockComment();
    } else if (!atEnd() && isBlank(source_.text[offset_])) {
      ++offset_;
    } else {
      return;
    }
  }
}

MofToken MofLexer::next() {
  skipBlanksAndComments();
  MofToken token;
  token.offset = offset_;
  if (atEnd()) return token;
  const char c = source_.text[offset_];
  if (isDigit(c) || c == '+' || c == '-' || c == '.') {
    readNumber(token);
  } else if (c == '"') {
    readString(token);
  } else if (c == '\'') {
    readCharacter(token);
  } else if (c == '$') {
    readAlias(token);
  } else if (c == '#') {
    readPragma(token);
  } else if (c != '\0' && std::string_view("{}()[];:,=").find(c) != std::string_view::npos) {
    ++offset_;
    token.kind = MofTokenKind::punctuation;
    token.mark = c;
  } else {
    readName(token);
  }
  return token;
}

void MofLexer::readName(MofToken& token) {
  const std::size_t start = offset_;
  const std::uint32_t first = takeCharacter();
  if (!startsName(first)) fail(start, "unexpected " + quoted(first));
  std::size_t end = offset_;
  while (!atEnd() && continuesName(takeCharacter())) end = offset_;
  offset_ = end;
  if (end - start > kMaxNameLength) fail(start, "name of more than 1024 bytes");
  token.kind = MofTokenKind::name;
  token.text = source_.text.substr(start, end - start);
}

void MofLexer::readAlias(MofToken& token) {
  ++offset_;
  if (atEnd()) fail(token.offset, "expected a name after '$'");
  readName(token);
  token.kind = MofTokenKind::alias;
}

void MofLexer::readPragma(MofToken& token) {
  ++offset_;
  while (!atEnd() && (source_.text[offset_] == ' ' || source_.text[offset_] == '\t')) ++offset_;
  if (!atEnd()) readName(token);
  if (!isMofKeyword(token.text, "pragma")) fail(token.offset, "expected '#pragma'");
  token.kind = MofTokenKind::pragma;
}

// Takes everything that cannot stand apart from a number, so that "08" or "1.2.3" is one error.
void MofLexer::readNumber(MofToken& token) {
  const std::string& text = source_.text;
  std::size_t end = offset_ + 1;
  const auto belongs = [&text](std::size_t i) {
    const char c = text[i];
    const bool exponentSign = (c == '+' || c == '-') && (text[i - 1] == 'e' || text[i - 1] == 'E');
    return (c >= 0 && continuesName(static_cast<std::uint32_t>(c))) || c == '.' || exponentSign;
  };
  while (end < text.size() && belongs(end)) ++end;
  const std::string_view literal = rest().substr(0, end - offset_);
  const MofNumberResult result = parseMofNumber(literal, token);
  if (result == MofNumberResult::malformed) {
    fail(token.offset, "malformed number '" + shortened(literal, 40) + "'");
  }
  if (result == MofNumberResult::tooLarge) {
    fail(token.offset, "number '" + shortened(literal, 40) + "' is too large");
  }
  offset_ = end;
}

std::uint32_t MofLexer::readQuoted(std::size_t start, const char* what) {
  const bool ends = atEnd() || source_.text[offset_] == '\n' || source_.text[offset_] == '\r';
  if (ends) fail(start, std::string("unterminated ") + what);
  return source_.text[offset_] == '\\' ? readEscape() : takeCharacter();
}

std::uint32_t MofLexer::readEscape() {
  const std::size_t start = offset_++;
  const char c = atEnd() ? '\0' : source_.text[offset_];
  if (c == 'x' || c == 'X') return readHexEscape(start);
  constexpr std::string_view kLetters = "btnfr\"'\\";
  constexpr std::string_view kMeanings = "\b\t\n\f\r\"'\\";
  const std::size_t index = c == '\0' ? std::string_view::npos : kLetters.find(c);
  if (index == std::string_view::npos) fail(start, "unknown escape sequence");
  ++offset_;
  return static_cast<unsigned char>(kMeanings[index]);
}

std::uint32_t MofLexer::readHexEscape(std::size_t start) {
  ++offset_;
  std::uint32_t value = 0;
  int digits = 0;
  for (; digits < 4 && !atEnd(); ++digits, ++offset_) {
    const char c = source_.text[offset_];
    const std::size_t digit = std::string_view("0123456789abcdefABCDEF").find(c);
    if (digit == std::string_view::npos) break;
    value = value << 4 | static_cast<std::uint32_t>(digit < 16 ? digit : digit - 6);
  }
  if (digits == 0) fail(start, "expected one to four hexadecimal digits after '\\x'");
  return value;
}

void MofLexer::readString(MofToken& token) {
  ++offset_;
  std::uint32_t high = 0;  // A high surrogate that waits for its low half: \xD83D\xDE00.
  const auto flush = [&] {
    if (high != 0) appendUtf8(token.text, high);
    high = 0;
  };
  while (atEnd() || source_.text[offset_] != '"') {
    const std::uint32_t character = readQuoted(token.offset, "string");
    if (high != 0 && character >= 0xDC00 && character <= 0xDFFF) {
      appendUtf8(token.text, 0x10000 + ((high - 0xD800) << 10) + (character - 0xDC00));
      high = 0;
      continue;
    }
    flush();
    if (character >= 0xD800 && character <= 0xDBFF) {
      high = character;
    } else {
      appendUtf8(token.text, character);
    }
  }
  flush();
  ++offset_;
  token.kind = MofTokenKind::string;
}

void MofLexer::readCharacter(MofToken& token) {
  ++offset_;
  if (at("'")) fail(token.offset, "empty character literal");
  const std::uint32_t character = readQuoted(token.offset, "character literal");
  if (character > 0xFFFF) fail(token.offset, "the character does not fit in 16 bits");
  if (!at("'")) fail(token.offset, "unterminated character literal");
  ++offset_;
  token.kind = MofTokenKind::character;
  token.unit = static_cast<std::uint16_t>(character);
}

}  // namespace cimhost
