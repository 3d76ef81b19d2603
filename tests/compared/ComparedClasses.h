#pragma once

#include <filesystem>

/// Makes `home` a home directory of the classes of namespace root/compare, which a CIM server and
/// cimhost serve alike: every type, arrays, properties that clients set, methods, an abstract class
/// above and a subclass below, and associations. The plug-in is compare.c; the declarations, for
/// cimmof and for cimhost, use standard qualifiers.
void writeComparedHome(const std::filesystem::path& home);
