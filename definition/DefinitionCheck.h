#pragma once

#include <string>
#include <vector>

namespace definition {

/// Something wrong in a definition file, with its place. Line and column count from 1, the column
/// in bytes; both are 0 where the file as a whole is meant.
struct Problem {
  std::string file;
  int line = 0;
  int column = 0;
  std::string message;
  std::string source;  ///< The line's text, of a long line 200 bytes around the place; or "".
  int caret = 0;       ///< The place in `source`, from 1, in bytes.
};

/// A class or association class that a definition file declares.
struct Served {
  std::string nameSpace;
  std::string className;
  bool association = false;
  bool hasMethods = false;
  std::string file;
  std::vector<std::string> properties;  ///< Of a class: those that have a definition.
};

/// A module with at least one function.
struct UsedModule {
  std::string file;  ///< The definition file that declares it first.
  std::string name;
  std::string path;  ///< As the loader gets it: a path is relative to the working directory.
};

struct CheckResult {
  std::vector<Problem> problems;
  std::vector<Problem> uncallable;  ///< Functions that no call can reach, without a place.
  std::vector<Served> served;
  std::vector<UsedModule> modules;
};

/// Reads definition files as the provider does, for a program that wants to know what they declare.
///
/// Problems are syntax errors, files that cannot be read or are no definition files, and elements
/// behind which the rest of a file is not read. Uses the process's registries and leaves them
/// empty; switches this process's diagnostic log off. Not for use by several threads at once.
CheckResult checkDefinitionFiles(const std::vector<std::string>& files);

/// Reads definition files in the same way and dumps on standard output what they register: modules,
/// classes, associations. Returns the same problems.
std::vector<Problem> dumpDefinitionFiles(const std::vector<std::string>& files);

}  // namespace definition
