#pragma once

#include "cimhost/mof/MofParser.h"

#include <Pegasus/Common/CIMName.h>

#include <memory>
#include <optional>
#include <set>
#include <string>
#include <variant>
#include <vector>

namespace cimhost {

/// The files that one run has read, so that each is read once for a namespace even when several
/// files include it, and the length of their texts.
class MofFileSet {
 public:
  /// False when the file was added before for that namespace.
  bool add(const std::string& path, const Pegasus::CIMNamespaceName& nameSpace);

  /// Throws std::runtime_error when the texts of the run exceed 256 MiB together.
  void countBytes(std::size_t size);

 private:
  std::set<std::string> files_;
  std::size_t bytes_ = 0;
};

/// A file with all that it includes, as one sequence of declarations.
///
/// `#pragma namespace` holds to the end of its own file, included files within that too.
class MofUnit {
 public:
  struct Item {
    MofSourcePtr source;
    Pegasus::CIMNamespaceName nameSpace;
    std::variant<MofQualifierDeclaration, MofClassDeclaration> declaration;
  };

  /// `files` must outlive the unit.
  MofUnit(MofSourcePtr source, const Pegasus::CIMNamespaceName& nameSpace, MofFileSet& files);

  /// The next declaration; nothing at the end. Throws MofError, after which the unit is of no
  /// further use.
  std::optional<Item> next();

 private:
  struct Level {
    MofSourcePtr source;
    std::string path;  // Canonical, to recognize a file that includes itself.
    Pegasus::CIMNamespaceName nameSpace;
    std::unique_ptr<MofParser> parser;
  };

  void push(MofSourcePtr source, std::string path, const Pegasus::CIMNamespaceName& nameSpace);
  void obey(const MofPragma& pragma);
  void include(const MofPragma& pragma);
  void changeNamespace(const MofPragma& pragma);

  MofFileSet& files_;
  std::vector<Level> levels_;
};

/// The path without symbolic links and dots; `path` itself when there is no such file.
std::string canonicalPath(const std::string& path);

}  // namespace cimhost
