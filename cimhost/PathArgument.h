#pragma once

#include <Pegasus/Common/CIMObjectPath.h>

#include <stdexcept>
#include <string>

namespace cimhost {

/// A malformed path on the command line: what() is the message with its column, the argument and a
/// caret line.
class PathArgumentError : public std::runtime_error {
 public:
  PathArgumentError(const std::string& argument, std::size_t position, const std::string& reason);
  int column() const { return column_; }  ///< From 1, in bytes.

 private:
  int column_;
};

// All of them want a namespace and refuse a host; `text` is UTF-8 from the command line. Written as
// WBEM URIs print them (DSP0207): root/host:Host_FileSystem.Name="/"

/// NS:CLASS
Pegasus::CIMObjectPath parseClassPath(const std::string& text);

/// NS:CLASS.KEY=VALUE,...; "NS:CLASS." names the instance of a class without keys.
Pegasus::CIMObjectPath parseInstancePath(const std::string& text);

/// Either of the two.
Pegasus::CIMObjectPath parseObjectPath(const std::string& text);

/// NS or NS:CLASS; the class is null for a bare namespace.
Pegasus::CIMObjectPath parseNamespaceOrClass(const std::string& text);

}  // namespace cimhost
