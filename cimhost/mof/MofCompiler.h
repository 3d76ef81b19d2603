#pragma once

#include "cimhost/mof/MofUnit.h"
#include "cimhost/repository/ClassRepository.h"

#include <string>

namespace cimhost {

/// What a class waits for, or what a declaration provides: a class or qualifier of a namespace.
/// Equal names in any letter case give equal keys.
std::string mofClassKey(const Pegasus::CIMNamespaceName& nameSpace, const std::string& name);
std::string mofQualifierKey(const Pegasus::CIMNamespaceName& nameSpace, const std::string& name);

/// A name that is not declared yet; the declaration may succeed after `key` has been.
class MofUnresolvedName : public MofError {
 public:
  MofUnresolvedName(const MofSource& source, std::size_t offset, std::string message,
                    std::string key)
      : MofError(source, offset, std::move(message)), key_(std::move(key)) {}

  const std::string& key() const { return key_; }

 private:
  std::string key_;
};

/// Turns parsed declarations into CIM objects and adds them to a repository.
class MofCompiler {
 public:
  explicit MofCompiler(ClassRepository& repository) : repository_(repository) {}

  /// Throws MofError, with the place of the part at fault; nothing is added then but perhaps the
  /// namespace.
  void add(const MofUnit::Item& item);

 private:
  void addQualifier(const MofUnit::Item& item, const MofQualifierDeclaration& declaration);
  void addClass(const MofUnit::Item& item, const MofClassDeclaration& declaration);

  ClassRepository& repository_;
};

}  // namespace cimhost
