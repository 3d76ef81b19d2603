#include "cimhost/repository/ClassRepository.h"

#include "cimhost/repository/ClassDeclarationError.h"
#include "cimhost/repository/ClassResolver.h"

#include <algorithm>
#include <unordered_map>

namespace cimhost {
namespace {

using Pegasus::CIMClass;
using Pegasus::CIMException;
using Pegasus::CIMName;
using Pegasus::CIMNamespaceName;
using Pegasus::CIMPropertyList;
using Pegasus::Uint32;

// Inherited features make the memory for a class independent of the length of its text.
constexpr std::size_t kMaxElements = 2000000;
constexpr std::size_t kMaxClasses = 65536;
constexpr std::size_t kMaxNamespaces = 4096;

struct ClassEntry {
  CIMClass resolved;
  CIMClass inheritable;  // Made for the first subclass.
  const ClassEntry* superclass = nullptr;
  std::vector<const ClassEntry*> subclasses;  // Direct ones, in order of declaration.
  std::size_t order = 0;                      // Of declaration in the namespace.
};

struct NamespaceEntry {
  CIMNamespaceName name;
  QualifierTable qualifiers;
  std::unordered_map<CIMName, ClassEntry, NameHash, NameEqual> classes;  // Node addresses stay.
  std::vector<const ClassEntry*> roots;

  const ClassEntry* find(const CIMName& className) const {
    const auto found = classes.find(className);
    return found != classes.end() ? &found->second : nullptr;
  }
};

// Features, parameters and qualifiers that the class does not share with its superclass, roughly.
std::size_t elementsOf(const CIMClass& resolved) {
  std::size_t count = resolved.getQualifierCount() + resolved.getPropertyCount();
  for (Uint32 i = 0; i < resolved.getPropertyCount(); ++i) {
    const Pegasus::CIMConstProperty property = resolved.getProperty(i);
    if (!property.getPropagated()) count += property.getQualifierCount();
  }
  for (Uint32 i = 0; i < resolved.getMethodCount(); ++i) {
    const Pegasus::CIMConstMethod method = resolved.getMethod(i);
    ++count;
    if (method.getPropagated()) continue;
    count += method.getQualifierCount();
    for (Uint32 j = 0; j < method.getParameterCount(); ++j) {
      count += 1 + method.getParameter(j).getQualifierCount();
    }
  }
  return count;
}

template <class Element>
void removeQualifiers(Element&& element) {
  for (Uint32 i = element.getQualifierCount(); i > 0; --i) element.removeQualifier(i - 1);
}

void removeQualifiersOfFeatures(CIMClass& target) {
  for (Uint32 i = 0; i < target.getPropertyCount(); ++i) removeQualifiers(target.getProperty(i));
  for (Uint32 i = 0; i < target.getMethodCount(); ++i) {
    Pegasus::CIMMethod method = target.getMethod(i);
    removeQualifiers(method);
    for (Uint32 j = 0; j < method.getParameterCount(); ++j) {
      removeQualifiers(method.getParameter(j));
    }
  }
}

void removeClassOrigins(CIMClass& target) {
  for (Uint32 i = 0; i < target.getPropertyCount(); ++i) {
    target.getProperty(i).setClassOrigin(CIMName());
  }
  for (Uint32 i = 0; i < target.getMethodCount(); ++i) {
    target.getMethod(i).setClassOrigin(CIMName());
  }
}

bool isListed(const CIMPropertyList& list, const CIMName& name) {
  for (Uint32 i = 0; i < list.size(); ++i) {
    if (list[i].equal(name)) return true;
  }
  return false;
}

void keepProperties(CIMClass& target, bool localOnly, const CIMPropertyList& list) {
  const CIMClass& reader = target;  // Reading through a const handle copies nothing.
  for (Uint32 i = target.getPropertyCount(); i > 0; --i) {
    const Pegasus::CIMConstProperty property = reader.getProperty(i - 1);
    const bool kept = !(localOnly && property.getPropagated()) &&
                      (list.isNull() || isListed(list, property.getName()));
    if (!kept) target.removeProperty(i - 1);
  }
}

void keepLocalMethods(CIMClass& target) {
  const CIMClass& reader = target;
  for (Uint32 i = target.getMethodCount(); i > 0; --i) {
    if (reader.getMethod(i - 1).getPropagated()) target.removeMethod(i - 1);
  }
}

}  // namespace

struct ClassRepository::Impl {
  std::unordered_map<CIMNamespaceName, NamespaceEntry, NameHash, NameEqual> byName;
  std::vector<const NamespaceEntry*> inOrder;
  std::size_t classCount = 0;
  std::size_t elementCount = 0;

  NamespaceEntry& require(const CIMNamespaceName& name) {
    const auto found = byName.find(name);
    if (found == byName.end()) {
      throw CIMException(Pegasus::CIM_ERR_INVALID_NAMESPACE, name.getString());
    }
    return found->second;
  }

  const ClassEntry* find(const CIMNamespaceName& nameSpace, const CIMName& name) const {
    const auto found = byName.find(nameSpace);
    return found == byName.end() ? nullptr : found->second.find(name);
  }
};

ClassRepository::ClassRepository() : impl_(std::make_unique<Impl>()) {}

ClassRepository::~ClassRepository() = default;

void ClassRepository::addNamespace(const CIMNamespaceName& nameSpace) {
  if (hasNamespace(nameSpace)) return;
  if (nameSpace.isNull() || impl_->inOrder.size() == kMaxNamespaces) {
    throw CIMException(
        nameSpace.isNull() ? Pegasus::CIM_ERR_INVALID_NAMESPACE : Pegasus::CIM_ERR_FAILED,
        nameSpace.isNull() ? "" : "more than 4096 namespaces");
  }
  NamespaceEntry& added = impl_->byName[nameSpace];
  added.name = nameSpace;
  impl_->inOrder.push_back(&added);
}

void ClassRepository::addClass(const CIMNamespaceName& nameSpace, const CIMClass& declared) {
  NamespaceEntry& entry = impl_->require(nameSpace);
  const CIMName& name = declared.getClassName();
  if (entry.find(name) != nullptr) {
    throw ClassDeclarationError(Pegasus::CIM_ERR_ALREADY_EXISTS, name.getString(), {});
  }
  const CIMName& superName = declared.getSuperClassName();
  const auto super = superName.isNull() ? entry.classes.end() : entry.classes.find(superName);
  if (!superName.isNull() && super == entry.classes.end()) {
    throw ClassDeclarationError(Pegasus::CIM_ERR_INVALID_SUPERCLASS, superName.getString(), {});
  }
  if (impl_->classCount == kMaxClasses) {
    throw ClassDeclarationError(Pegasus::CIM_ERR_FAILED, "more than 65536 classes", {});
  }
  const ClassResolver resolver(entry.qualifiers);
  ClassEntry* parent = superName.isNull() ? nullptr : &super->second;
  if (parent != nullptr && parent->inheritable.isUninitialized()) {
    parent->inheritable = resolver.inheritable(parent->resolved);
  }
  const CIMClass resolved =
      resolver.resolve(declared, parent == nullptr ? CIMClass() : parent->inheritable);
  const std::size_t elements = elementsOf(resolved);
  if (impl_->elementCount + elements > kMaxElements) {
    throw ClassDeclarationError(Pegasus::CIM_ERR_FAILED,
                                "more than 2000000 features and qualifiers of all classes", {});
  }

  impl_->elementCount += elements;
  ClassEntry& added = entry.classes[name];
  added.resolved = resolved;
  added.superclass = parent;
  added.order = impl_->classCount++;
  (parent == nullptr ? entry.roots : parent->subclasses).push_back(&added);
}

void ClassRepository::addQualifier(const CIMNamespaceName& nameSpace,
                                   const Pegasus::CIMQualifier& declaration, unsigned scope) {
  impl_->require(nameSpace).qualifiers.add({declaration.clone(), scope});
}

bool ClassRepository::hasNamespace(const CIMNamespaceName& nameSpace) const {
  return impl_->byName.count(nameSpace) != 0;
}

std::vector<CIMNamespaceName> ClassRepository::namespaces() const {
  std::vector<CIMNamespaceName> names;
  names.reserve(impl_->inOrder.size());
  for (const NamespaceEntry* entry : impl_->inOrder) names.push_back(entry->name);
  return names;
}

Pegasus::CIMQualifier ClassRepository::findQualifier(const CIMNamespaceName& nameSpace,
                                                     const CIMName& name) const {
  const QualifierDeclaration* found = impl_->require(nameSpace).qualifiers.find(name);
  return found == nullptr ? Pegasus::CIMQualifier() : found->qualifier.clone();
}

std::vector<QualifierDeclaration> ClassRepository::qualifiers(
    const CIMNamespaceName& nameSpace) const {
  return impl_->require(nameSpace).qualifiers.all();
}

bool ClassRepository::hasClass(const CIMNamespaceName& nameSpace, const CIMName& name) const {
  return impl_->find(nameSpace, name) != nullptr;
}

CIMClass ClassRepository::getClass(const CIMNamespaceName& nameSpace, const CIMName& name,
                                   bool localOnly, bool includeQualifiers, bool includeClassOrigin,
                                   const CIMPropertyList& propertyList) const {
  const ClassEntry* entry = impl_->require(nameSpace).find(name);
  if (entry == nullptr) throw CIMException(Pegasus::CIM_ERR_NOT_FOUND, name.getString());
  CIMClass result = entry->resolved.clone();
  if (localOnly || !propertyList.isNull()) keepProperties(result, localOnly, propertyList);
  if (localOnly) keepLocalMethods(result);
  if (!includeQualifiers) {
    removeQualifiers(result);
    removeQualifiersOfFeatures(result);
  }
  if (!includeClassOrigin) removeClassOrigins(result);
  return result;
}

std::vector<CIMName> ClassRepository::subclassNames(const CIMNamespaceName& nameSpace,
                                                    const CIMName& name, bool deep) const {
  const NamespaceEntry& space = impl_->require(nameSpace);
  const ClassEntry* top = space.find(name);
  if (top == nullptr && !name.isNull()) {
    throw CIMException(Pegasus::CIM_ERR_NOT_FOUND, name.getString());
  }
  std::vector<const ClassEntry*> found = top == nullptr ? space.roots : top->subclasses;
  for (std::size_t i = 0; deep && i < found.size(); ++i) {
    const std::vector<const ClassEntry*>& next = found[i]->subclasses;
    found.insert(found.end(), next.begin(), next.end());
  }
  std::sort(found.begin(), found.end(), [](auto* a, auto* b) { return a->order < b->order; });
  std::vector<CIMName> names;
  names.reserve(found.size());
  for (const ClassEntry* entry : found) names.push_back(entry->resolved.getClassName());
  return names;
}

bool ClassRepository::isSubclass(const CIMNamespaceName& nameSpace, const CIMName& name,
                                 const CIMName& ancestor) const {
  const ClassEntry* wanted = impl_->find(nameSpace, ancestor);
  const ClassEntry* entry = impl_->find(nameSpace, name);
  while (entry != nullptr && entry != wanted) entry = entry->superclass;
  return entry != nullptr && wanted != nullptr;
}

}  // namespace cimhost
