#pragma once

#include <filesystem>
#include <string>

/// The classes of namespace root/compare, which a CIM server and cimhost serve alike: every type,
/// arrays, properties that clients set, methods, an abstract class above and a subclass below, and
/// associations. The plug-in is compare.c.

/// Class declarations, for cimmof and for cimhost. They use standard qualifiers.
std::string comparedDeclarations();

/// The definition file.
std::string comparedDefinitions();

/// Makes `home` a home directory of these classes.
void writeComparedHome(const std::filesystem::path& home);
