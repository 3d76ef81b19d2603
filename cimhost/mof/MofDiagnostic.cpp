#include "cimhost/mof/MofDiagnostic.h"

namespace cimhost {

std::string MofDiagnostic::toString() const {
  if (line == 0) return file + ": error: " + message;
  const std::string place = ':' + std::to_string(line) + ':' + std::to_string(column);
  const std::string padding(caret > 0 ? static_cast<std::size_t>(caret - 1) : 0, ' ');
  return file + place + ": error: " + message + '\n' + source + '\n' + padding + '^';
}

MofDiagnostic wholeFileDiagnostic(const std::string& file, const std::string& message) {
  MofDiagnostic diagnostic;
  diagnostic.file = file;
  diagnostic.message = message;
  return diagnostic;
}

}  // namespace cimhost
