#include "cimhost/mof/MofNumber.h"

#include <limits>
#include <locale>
#include <sstream>

namespace cimhost {
namespace {

bool isDigit(char c) {
  return c >= '0' && c <= '9';
}

unsigned digitValue(char c) {
  if (isDigit(c)) return static_cast<unsigned>(c - '0');
  if (c >= 'a' && c <= 'f') return static_cast<unsigned>(c - 'a') + 10;
  if (c >= 'A' && c <= 'F') return static_cast<unsigned>(c - 'A') + 10;
  return 99;
}

std::size_t skipDigits(std::string_view text, std::size_t from) {
  while (from < text.size() && isDigit(text[from])) ++from;
  return from;
}

// *digit "." 1*digit [ ("e" / "E") [ "+" / "-" ] 1*digit ]
bool isReal(std::string_view text) {
  const std::size_t point = skipDigits(text, 0);
  if (point == text.size() || text[point] != '.') return false;
  std::size_t end = skipDigits(text, point + 1);
  if (end == point + 1) return false;
  if (end == text.size()) return true;
  if (text[end] != 'e' && text[end] != 'E') return false;
  ++end;
  if (end < text.size() && (text[end] == '+' || text[end] == '-')) ++end;
  return end < text.size() && skipDigits(text, end) == text.size();
}

MofNumberResult parseReal(std::string_view text, MofToken& token) {
  std::istringstream stream{std::string(text)};
  stream.imbue(std::locale::classic());
  stream >> token.real;
  if (!stream) return MofNumberResult::tooLarge;
  if (token.negative) token.real = -token.real;
  token.kind = MofTokenKind::real;
  return MofNumberResult::ok;
}

// Strips the radix mark.
unsigned takeRadix(std::string_view& digits) {
  const auto isMark = [](char c, char mark) { return c == mark || c == mark - 'a' + 'A'; };
  if (digits.size() > 2 && digits[0] == '0' && isMark(digits[1], 'x')) {
    digits.remove_prefix(2);
    return 16;
  }
  if (digits.size() > 1 && isMark(digits.back(), 'b')) {
    digits.remove_suffix(1);
    return 2;
  }
  return digits.size() > 1 && digits[0] == '0' ? 8 : 10;
}

MofNumberResult parseInteger(std::string_view digits, MofToken& token) {
  const unsigned radix = takeRadix(digits);
  bool tooLarge = false;
  for (const char c : digits) {
    const unsigned digit = digitValue(c);
    if (digit >= radix) return MofNumberResult::malformed;
    tooLarge =
        tooLarge || token.magnitude > (std::numeric_limits<std::uint64_t>::max() - digit) / radix;
    token.magnitude = token.magnitude * radix + digit;
  }
  token.kind = MofTokenKind::integer;
  return tooLarge ? MofNumberResult::tooLarge : MofNumberResult::ok;
}

}  // namespace

MofNumberResult parseMofNumber(std::string_view literal, MofToken& token) {
  const bool hasSign = !literal.empty() && (literal[0] == '+' || literal[0] == '-');
  token.negative = hasSign && literal[0] == '-';
  if (hasSign) literal.remove_prefix(1);
  if (literal.empty()) return MofNumberResult::malformed;
  return isReal(literal) ? parseReal(literal, token) : parseInteger(literal, token);
}

}  // namespace cimhost
