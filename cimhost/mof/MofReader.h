#pragma once

#include "cimhost/repository/ClassRepository.h"

#include <string>
#include <vector>

namespace cimhost {

/// One problem in a MOF text: where it is and what it is.
struct MofDiagnostic {
  std::string file;     ///< As it was named to the reader, or in the include.
  int line = 0;         ///< From 1.
  int column = 0;       ///< From 1, in bytes.
  std::string message;  ///< One sentence, without the place.
  std::string source;   ///< The text of the line, for the caret line; control characters replaced.

  /// "file:line:column: error: message", the source line and a caret line under the column.
  std::string toString() const;
};

/// Reads MOF v2 class and qualifier declarations (DSP0004) into a repository.
///
/// What stands before an error in a file is kept; the rest of that file is dropped and one diagnostic
/// tells why. Never throws for bad text.
class MofReader {
 public:
  explicit MofReader(ClassRepository& repository);

  /// Reads one file and what it includes (`#pragma include`, relative to the including file, at most
  /// 32 deep, each file at most 64 MiB) into `nameSpace`, which `#pragma namespace` may change.
  /// True when there was no error.
  bool readFile(const std::string& path, const Pegasus::CIMNamespaceName& nameSpace);

  /// The same for a text in memory, named `name` in diagnostics.
  bool readText(const std::string& text, const std::string& name,
                const Pegasus::CIMNamespaceName& nameSpace);

  /// Reads a tree: every *.mof file of `directory`, sorted by path. The folders below it name the
  /// namespace (mof/root/host/a.mof: root/host); files at the top go to `defaultNameSpace`.
  /// A class may stand before its superclass in another file: files are tried until none advances.
  bool readDirectory(const std::string& directory, const Pegasus::CIMNamespaceName& defaultNameSpace);

  const std::vector<MofDiagnostic>& diagnostics() const { return diagnostics_; }

 private:
  ClassRepository& repository_;
  std::vector<MofDiagnostic> diagnostics_;
};

}  // namespace cimhost
