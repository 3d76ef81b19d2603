#pragma once

#include <string>
#include <vector>

namespace cimhost {

/// One problem in a file of the home directory.
struct Diagnostic {
  enum class Severity { error, warning };

  Severity severity = Severity::error;
  std::string file;     ///< As the user knows it: relative to the home directory.
  int line = 0;         ///< From 1; 0: the file as a whole.
  int column = 0;       ///< From 1, in bytes; 0: the line as a whole.
  std::string message;  ///< Without the place; may have several lines.
  std::string source;   ///< The text of the line, or a part of it; empty: no caret line.
  int caret = 0;        ///< The place in `source`, from 1, in bytes; 0: that of the column.

  /// "file:line:column: error: message", and the source line with a caret line under the column
  /// where both are known. Safe for a terminal; no line end after the last line.
  std::string toString() const;
};

/// The source line and the caret line below it, each with a line end in front; a long line is cut
/// to what stands around the column (from 1, in bytes).
std::string caretLines(const std::string& source, int column);

}  // namespace cimhost
