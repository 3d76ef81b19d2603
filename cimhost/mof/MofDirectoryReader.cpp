#include "cimhost/mof/MofDirectoryReader.h"

#include "cimhost/Text.h"
#include "cimhost/mof/MofValue.h"

#include <algorithm>
#include <filesystem>

namespace cimhost {
namespace {

namespace fs = std::filesystem;

std::string keyOf(const MofUnit::Item& item) {
  if (const auto* qualifier = std::get_if<MofQualifierDeclaration>(&item.declaration)) {
    return mofQualifierKey(item.nameSpace, qualifier->element.name.text);
  }
  return mofClassKey(item.nameSpace, std::get<MofClassDeclaration>(item.declaration).name.text);
}

}  // namespace

MofDirectoryReader::MofDirectoryReader(ClassRepository& repository,
                                       std::vector<MofDiagnostic>& diagnostics)
    : repository_(repository), diagnostics_(diagnostics), compiler_(repository) {}

bool MofDirectoryReader::read(const std::string& directory,
                              const Pegasus::CIMNamespaceName& defaultNameSpace) {
  const std::size_t before = diagnostics_.size();
  findFiles(directory, defaultNameSpace);
  for (std::size_t i = 0; i < files_.size(); ++i) {
    ready_.push_back(i);
    for (; !ready_.empty(); ready_.pop_front()) advance(ready_.front());
  }
  for (const File& file : files_) {
    if (file.diagnostic) diagnostics_.push_back(*file.diagnostic);
  }
  return diagnostics_.size() == before;
}

void MofDirectoryReader::findFiles(const std::string& directory,
                                   const Pegasus::CIMNamespaceName& defaultNameSpace) {
  std::error_code error;
  fs::recursive_directory_iterator entry(directory, error);
  std::vector<std::string> paths;
  for (; !error && entry != fs::recursive_directory_iterator(); entry.increment(error)) {
    std::error_code ignored;
    const bool isFolder = entry->is_directory(ignored);
    if (entry->path().extension() == ".mof" && !isFolder) paths.push_back(entry->path().string());
  }
  if (error)
    diagnostics_.push_back(
        wholeFileDiagnostic(directory, "cannot read the folder: " + error.message()));
  std::sort(paths.begin(), paths.end());
  for (const std::string& path : paths) {
    const fs::path folder = fs::path(path).lexically_relative(directory).parent_path();
    addFile(path, folder.generic_string(), defaultNameSpace);
  }
}

void MofDirectoryReader::addFile(const std::string& path, const std::string& folder,
                                 const Pegasus::CIMNamespaceName& defaultNameSpace) {
  File& file = files_.emplace_back();
  file.path = path;
  file.nameSpace = defaultNameSpace;
  if (folder.empty()) return;
  try {
    file.nameSpace = Pegasus::CIMNamespaceName(fromUtf8(folder));
  } catch (const Pegasus::Exception&) {  // A file name need not even be UTF-8.
    file.diagnostic = wholeFileDiagnostic(path, "the names of its folders are not a namespace");
  }
}

void MofDirectoryReader::open(File& file) {
  if (!read_.add(canonicalPath(file.path), file.nameSpace)) return;  // It was included.
  try {
    MofSourcePtr source = readMofFile(file.path);
    read_.countBytes(source->text.size());
    repository_.addNamespace(file.nameSpace);
    file.unit.emplace(std::move(source), file.nameSpace, read_);
  } catch (const std::runtime_error& error) {
    file.diagnostic = wholeFileDiagnostic(file.path, error.what());
  } catch (const Pegasus::Exception& exception) {
    file.diagnostic = wholeFileDiagnostic(file.path, toUtf8(exception.getMessage()));
  }
}

// Goes on with one file until its end, an error or a name that is missing.
void MofDirectoryReader::advance(std::size_t index) {
  File& file = files_[index];
  if (file.blocked) {
    file.diagnostic.reset();
  } else if (!file.diagnostic) {
    open(file);
  }
  try {
    while (file.unit && (file.blocked || (file.blocked = file.unit->next()))) {
      compiler_.add(*file.blocked);
      wake(keyOf(*file.blocked));
      file.blocked.reset();
    }
    file.unit.reset();
  } catch (const MofUnresolvedName& error) {
    file.diagnostic = error.diagnostic();
    waiting_[error.key()].push_back(index);
  } catch (const MofError& error) {
    file.diagnostic = error.diagnostic();
    file.blocked.reset();
    file.unit.reset();
  }
}

void MofDirectoryReader::wake(const std::string& key) {
  const auto found = waiting_.find(key);
  if (found == waiting_.end()) return;
  ready_.insert(ready_.end(), found->second.begin(), found->second.end());
  waiting_.erase(found);
}

}  // namespace cimhost
