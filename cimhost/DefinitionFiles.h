#pragma once

#include "cimhost/Diagnostic.h"
#include "cimhost/ServedClasses.h"

#include <string>
#include <vector>

namespace cimhost {

/// The names of the files of `directory` that the provider reads as definitions: all whose name
/// contains ".xml", in the directory's order, which decides between two definitions of one class.
std::vector<std::string> findDefinitionFiles(const std::string& directory);

/// Reads the definition files of the working directory and adds what they define to `served`;
/// returns what is wrong with them, each file named below `folder`. A definition whose namespace or
/// class name is not valid CIM is an error and serves nothing. Functions and libraries that cannot
/// be called or loaded are warnings.
///
/// Uses the definition registries that are linked into this program, not those of a loaded provider
/// library, and leaves them empty. Not for several threads.
std::vector<Diagnostic> readDefinitions(const std::string& folder, ServedClasses& served);

/// Dumps on standard output what definition files define, and returns what is wrong with them. As
/// for readDefinitions().
std::vector<Diagnostic> dumpDefinitions(const std::vector<std::string>& files,
                                        const std::string& folder);

}  // namespace cimhost
