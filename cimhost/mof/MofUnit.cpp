#include "cimhost/mof/MofUnit.h"

#include "cimhost/Text.h"
#include "cimhost/mof/MofKeywords.h"
#include "cimhost/mof/MofValue.h"
#include "cimhost/mof/Printable.h"

#include <filesystem>
#include <stdexcept>

namespace cimhost {
namespace {

constexpr std::size_t kMaxDepth = 32;
constexpr std::size_t kMaxBytes = std::size_t{256} << 20;

std::string besideFile(const std::string& file, const std::string& relative) {
  return (std::filesystem::path(file).parent_path() / relative).string();
}

}  // namespace

std::string canonicalPath(const std::string& path) {
  std::error_code error;
  const std::filesystem::path canonical = std::filesystem::canonical(path, error);
  return error ? path : canonical.string();
}

bool MofFileSet::add(const std::string& path, const Pegasus::CIMNamespaceName& nameSpace) {
  return files_.insert(asciiLowered(toUtf8(nameSpace.getString())) + ':' + path).second;
}

void MofFileSet::countBytes(std::size_t size) {
  bytes_ += size;
  if (bytes_ > kMaxBytes) throw std::runtime_error("more than 256 MiB of declarations");
}

MofUnit::MofUnit(MofSourcePtr source, const Pegasus::CIMNamespaceName& nameSpace, MofFileSet& files)
    : files_(files) {
  std::string path = canonicalPath(source->name);
  files_.add(path, nameSpace);
  push(std::move(source), std::move(path), nameSpace);
}

void MofUnit::push(MofSourcePtr source, std::string path,
                   const Pegasus::CIMNamespaceName& nameSpace) {
  auto parser = std::make_unique<MofParser>(source);
  levels_.push_back({std::move(source), std::move(path), nameSpace, std::move(parser)});
}

std::optional<MofUnit::Item> MofUnit::next() {
  while (!levels_.empty()) {
    std::optional<MofDeclaration> declaration = levels_.back().parser->next();
    if (!declaration) {
      levels_.pop_back();
      continue;
    }
    const Level& level = levels_.back();
    if (auto* pragma = std::get_if<MofPragma>(&*declaration)) {
      obey(*pragma);
    } else if (auto* qualifier = std::get_if<MofQualifierDeclaration>(&*declaration)) {
      return Item{level.source, level.nameSpace, std::move(*qualifier)};
    } else {
      return Item{level.source, level.nameSpace,
                  std::move(std::get<MofClassDeclaration>(*declaration))};
    }
  }
  return std::nullopt;
}

void MofUnit::obey(const MofPragma& pragma) {
  const bool isInclude = isMofKeyword(pragma.name.text, "include");
  if (!isInclude && !isMofKeyword(pragma.name.text, "namespace")) return;
  if (pragma.parameter.text.empty()) {
    throw MofError(*levels_.back().source, pragma.name.offset,
                   "#pragma " + pragma.name.text + " needs a string in parentheses");
  }
  isInclude ? include(pragma) : changeNamespace(pragma);
}

void MofUnit::include(const MofPragma& pragma) {
  const Level& level = levels_.back();
  const auto fail = [&](const std::string& message) {
    throw MofError(*level.source, pragma.parameter.offset, message);
  };
  const std::string path = besideFile(level.source->name, pragma.parameter.text);
  std::string canonical = canonicalPath(path);
  for (const Level& open : levels_) {
    if (open.path == canonical) fail("the file includes itself");
  }
  if (levels_.size() == kMaxDepth) fail("includes are nested more than 32 deep");
  if (!files_.add(canonical, level.nameSpace)) return;
  try {
    MofSourcePtr source = readMofFile(path);
    files_.countBytes(source->text.size());
    push(std::move(source), std::move(canonical), level.nameSpace);
  } catch (const std::runtime_error& error) {
    fail("cannot read '" + shortened(pragma.parameter.text, 100) + "': " + error.what());
  }
}

void MofUnit::changeNamespace(const MofPragma& pragma) {
  Level& level = levels_.back();
  const Pegasus::String name = fromUtf8(pragma.parameter.text);
  if (!Pegasus::CIMNamespaceName::legal(name)) {
    throw MofError(*level.source, pragma.parameter.offset,
                   '\'' + shortened(pragma.parameter.text, 60) + "' is not a namespace");
  }
  level.nameSpace = Pegasus::CIMNamespaceName(name);
}

}  // namespace cimhost
