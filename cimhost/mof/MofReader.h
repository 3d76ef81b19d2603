#pragma once

#include "cimhost/mof/MofSource.h"
#include "cimhost/repository/ClassRepository.h"

#include <string>
#include <vector>

namespace cimhost {

/// Reads MOF v2 class and qualifier declarations (DSP0004) into a repository.
///
/// What stands before an error in a file is kept; the rest of that file is dropped and one
/// diagnostic tells why. Never throws for bad text or unreadable files.
///
/// Within one call a file is read once for a namespace, however many files include it; the texts
/// together may be 256 MiB. Instances are checked for form and skipped.
class MofReader {
 public:
  explicit MofReader(ClassRepository& repository);

  /// Reads one file and what it includes (`#pragma include`, relative to the including file, at
  /// most 32 deep, each file at most 64 MiB) into `nameSpace`, which `#pragma namespace` may
  /// change. True when there was no error.
  bool readFile(const std::string& path, const Pegasus::CIMNamespaceName& nameSpace);

  /// The same for a text in memory, named `name` in diagnostics.
  bool readText(const std::string& text, const std::string& name,
                const Pegasus::CIMNamespaceName& nameSpace);

  /// Reads a tree: every *.mof file of `directory`, sorted by path. The folders below it name the
  /// namespace (mof/root/host/a.mof: root/host); files at the top go to `defaultNameSpace`.
  /// A class may stand before its superclass in another file, a qualifier's use before its
  /// declaration: such a file waits at that place. Diagnostics are in the order of the files.
  /// Symbolic links to folders are not followed.
  bool readDirectory(const std::string& directory,
                     const Pegasus::CIMNamespaceName& defaultNameSpace);

  const std::vector<MofDiagnostic>& diagnostics() const { return diagnostics_; }

 private:
  bool readSource(MofSourcePtr source, const Pegasus::CIMNamespaceName& nameSpace);

  ClassRepository& repository_;
  std::vector<MofDiagnostic> diagnostics_;
};

}  // namespace cimhost
