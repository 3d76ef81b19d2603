#include "cimhost/mof/MofDiagnostic.h"

#include "cimhost/mof/Printable.h"

namespace cimhost {

std::string MofDiagnostic::toString() const {
  const std::string name = printable(file);
  if (line == 0) return name + ": error: " + message;
  const std::string place = ':' + std::to_string(line) + ':' + std::to_string(column);
  const std::string padding(caret > 0 ? static_cast<std::size_t>(caret - 1) : 0, ' ');
  return name + place + ": error: " + message + '\n' + source + '\n' + padding + '^';
}

MofDiagnostic wholeFileDiagnostic(const std::string& file, const std::string& message) {
  MofDiagnostic diagnostic;
  diagnostic.file = file;
  diagnostic.message = printable(message);
  return diagnostic;
}

}  // namespace cimhost
