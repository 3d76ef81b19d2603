#pragma once

#include <string>

namespace cimhost {

/// One problem in a MOF text: where it is and what it is.
struct MofDiagnostic {
  std::string file;     ///< As it was named to the reader, or in the include.
  int line = 0;         ///< From 1; 0 when the file as a whole could not be read.
  int column = 0;       ///< From 1, in bytes; 0 when the file as a whole could not be read.
  std::string message;  ///< One sentence, without the place; no control characters.
  std::string source;   ///< The line's text, of a long line the part around the place; control
                        ///< characters and invalid UTF-8 replaced.
  int caret = 0;        ///< From 1: the character of `source` that the caret stands under.

  /// "file:line:column: error: message", the source line and a caret line under the place. Without
  /// a line number only "file: error: message". No newline at the end.
  std::string toString() const;
};

/// One without a place, for a file that cannot be read at all.
MofDiagnostic wholeFileDiagnostic(const std::string& file, const std::string& message);

}  // namespace cimhost
