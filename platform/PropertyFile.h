#pragma once

#include "platform/Path.h"

#include <map>
#include <stdexcept>
#include <string>

namespace Vaneth {

/// Raised by PropertyFile when the file or a key is not there.
class PropertyFileError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// A text file of `key = value` lines.
///
/// UTF-8, or Latin-1 where a line is not valid UTF-8. Blanks around key and value are dropped;
/// lines that start with '#' or ';', `[section]` lines and lines without '=' are skipped; of a key
/// that stands twice the last value counts. Not for use by several threads at once.
class PropertyFile {
 public:
  /// The only mode there is: existing file, read only.
  static constexpr int kReadExisting = 3;

  explicit PropertyFile(const File::Path& path) : path_(path) {}

  /// Reads the whole file (regular files of at most 1 MiB; else PropertyFileError).
  void open(int mode);

  /// The value of `key`; PropertyFileError when the file is not open or has no such key.
  std::wstring getValue(const std::wstring& key) const;

  void close();

 private:
  void addLine(const std::string& line);

  File::Path path_;
  bool isOpen_ = false;
  std::map<std::wstring, std::wstring> values_;
};

}  // namespace Vaneth
