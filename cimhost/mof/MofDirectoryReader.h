#pragma once

#include "cimhost/mof/MofCompiler.h"
#include "cimhost/mof/MofUnit.h"

#include <deque>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace cimhost {

/// Reads the *.mof files of a tree in whatever order their declarations need; used for one tree.
///
/// A file that needs a class or qualifier of another file is left where it stands and goes on when
/// the name has been declared, so each file is parsed once.
class MofDirectoryReader {
 public:
  /// Both must outlive the reader; diagnostics are appended.
  MofDirectoryReader(ClassRepository& repository, std::vector<MofDiagnostic>& diagnostics);

  /// True when there was no error.
  bool read(const std::string& directory, const Pegasus::CIMNamespaceName& defaultNameSpace);

 private:
  struct File {
    std::string path;
    Pegasus::CIMNamespaceName nameSpace;
    std::optional<MofUnit> unit;
    std::optional<MofUnit::Item> blocked;     // What waits for a name.
    std::optional<MofDiagnostic> diagnostic;  // Of `blocked`, or the error that ended the file.
  };

  void findFiles(const std::string& directory, const Pegasus::CIMNamespaceName& defaultNameSpace);
  void addFile(const std::string& path, const std::string& folder,
               const Pegasus::CIMNamespaceName& defaultNameSpace);
  void advance(std::size_t index);
  void open(File& file);
  void compile(const MofUnit::Item& item);
  void wake(const std::string& key);

  ClassRepository& repository_;
  std::vector<MofDiagnostic>& diagnostics_;
  MofCompiler compiler_;
  MofFileSet read_;
  std::vector<File> files_;
  std::deque<std::size_t> ready_;                            // Indexes of files_.
  std::map<std::string, std::vector<std::size_t>> waiting_;  // By the key of the missing name.
};

}  // namespace cimhost
