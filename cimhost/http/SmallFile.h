#pragma once

#include <string>

namespace cimhost {

/// What a file of settings holds, at most 1 MiB. Throws HostError, with the file's name, for one
/// that is no regular file (opening a pipe would wait for a writer), larger, or unreadable.
std::string readSmallFile(const std::string& file);

}  // namespace cimhost
