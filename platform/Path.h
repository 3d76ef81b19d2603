#pragma once

#include <string>
#include <utility>

namespace Vaneth::File {

/// The name of a file as given, relative to the working directory unless it starts with "/".
class Path {
 public:
  explicit Path(std::string name) : name_(std::move(name)) {}
  const std::string& getName() const { return name_; }

 private:
  std::string name_;
};

}  // namespace Vaneth::File
