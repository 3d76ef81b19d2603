#include "cimhost/Diagnostic.h"

#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

#include <algorithm>

namespace cimhost {

namespace {

constexpr std::size_t kShownBefore = 60;
constexpr std::size_t kShownAfter = 40;

// Each line is made safe on its own, so that a message may have several.
std::string displayLines(const std::string& text) {
  std::string result;
  std::size_t start = 0;
  while (start <= text.size()) {
    const std::size_t end = std::min(text.find('\n', start), text.size());
    if (start > 0 && end > start) result += "\n  ";
    result += displayText(text.substr(start, end - start));
    start = end + 1;
  }
  return result;
}

std::string withBlanks(std::string text) {
  std::replace(text.begin(), text.end(), '\t', ' ');
  return text;
}

}  // namespace

std::string Diagnostic::toString() const {
  std::string text = displayText(file);
  if (line > 0) text += ":" + std::to_string(line);
  if (line > 0 && column > 0) text += ":" + std::to_string(column);
  text += severity == Severity::error ? ": error: " : ": warning: ";
  text += displayLines(message);
  if (!source.empty() && column > 0) text += caretLines(source, caret > 0 ? caret : column);
  return text;
}

std::string caretLines(const std::string& source, int column) {
  const std::size_t position = std::min(static_cast<std::size_t>(column) - 1, source.size());
  std::size_t first = position > kShownBefore ? position - kShownBefore : 0;
  while (first > 0 && isContinuation(source[first])) --first;
  const std::string before = displayText(withBlanks(source.substr(first, position - first)));
  const std::string after = displayText(withBlanks(source.substr(position, kShownAfter)));
  return "\n  " + before + after + "\n  " + std::string(displayWidth(before), ' ') + "^";
}

}  // namespace cimhost
