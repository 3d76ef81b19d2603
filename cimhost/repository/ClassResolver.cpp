#include "cimhost/repository/ClassResolver.h"

#include "cimhost/repository/QualifierMerge.h"

namespace cimhost {
namespace {

using Pegasus::CIMClass;
using Pegasus::CIMConstClass;
using Pegasus::CIMConstMethod;
using Pegasus::CIMConstParameter;
using Pegasus::CIMConstProperty;
using Pegasus::CIMMethod;
using Pegasus::CIMName;
using Pegasus::CIMParameter;
using Pegasus::CIMProperty;
using Pegasus::String;
using Pegasus::Uint32;
using Part = ClassDeclarationError::Part;
using Scope = QualifierScope;

[[noreturn]] void fail(const String& message, Part part) {
  throw ClassDeclarationError(Pegasus::CIM_ERR_INVALID_PARAMETER, message, std::move(part));
}

template <class Element>
bool isTrue(const Element& element, const char* qualifierName) {
  const Uint32 index = element.findQualifier(CIMName(qualifierName));
  if (index == PEG_NOT_FOUND) return false;
  const Pegasus::CIMValue& value = element.getQualifier(index).getValue();
  bool result = false;
  if (value.getType() == Pegasus::CIMTYPE_BOOLEAN && !value.isArray()) value.get(result);
  return result;
}

// The name in an Override qualifier, older texts also write it as "CLASS.NAME"; "" for none.
template <class Element>
String overriddenName(const Element& element) {
  const Uint32 index = element.findQualifier(CIMName("Override"));
  if (index == PEG_NOT_FOUND) return String();
  const Pegasus::CIMValue& value = element.getQualifier(index).getValue();
  String name;
  if (value.getType() == Pegasus::CIMTYPE_STRING && !value.isArray()) value.get(name);
  const Uint32 dot = name.reverseFind('.');
  return dot == PEG_NOT_FOUND ? name : name.subString(dot + 1);
}

template <class Element>
void checkOverride(const Element& element, bool isOverriding) {
  const String overridden = overriddenName(element);
  if (overridden.size() == 0) return;
  const Part part{element.getName(), CIMName(), CIMName("Override")};
  if (!String::equalNoCase(overridden, element.getName().getString())) {
    fail("qualifier 'Override' must give the same name", part);
  }
  if (!isOverriding) fail("there is nothing to override in the superclass", part);
}

unsigned scopeOf(const CIMConstProperty& property) {
  const bool isReference = property.getType() == Pegasus::CIMTYPE_REFERENCE;
  return isReference ? Scope::kReference | Scope::kProperty : Scope::kProperty;
}

/// Resolves the features of one class; see ClassResolver.
class FeatureResolver {
 public:
  FeatureResolver(const QualifierTable& table, const CIMName& className)
      : table_(table), className_(className) {}

  CIMProperty inheritable(const CIMProperty& property) const {
    return property.getPropagated() ? property : makeProperty(property, nullptr, property);
  }

  CIMMethod inheritable(const CIMConstMethod& method) const {
    return method.getPropagated() ? method.clone() : makeMethod(method, nullptr, method);
  }

  CIMProperty declare(const CIMConstProperty& own, const CIMConstProperty& overridden) const {
    checkOverride(own, !overridden.isUninitialized());
    if (!overridden.isUninitialized()) {
      const bool same =
          own.getType() == overridden.getType() && own.isArray() == overridden.isArray();
      if (!same) fail("the overridden property has another type", {own.getName(), {}, {}});
    }
    return makeProperty(own, &own, overridden);
  }

  CIMMethod declare(const CIMConstMethod& own, const CIMConstMethod& overridden) const {
    checkOverride(own, !overridden.isUninitialized());
    if (!overridden.isUninitialized() && own.getType() != overridden.getType()) {
      fail("the overridden method has another return type", {own.getName(), {}, {}});
    }
    return makeMethod(own, &own, overridden);
  }

 private:
  // `shape` gives everything but qualifiers and origin; without `own` the result is propagated.
  CIMProperty makeProperty(const CIMConstProperty& shape, const CIMConstProperty* own,
                           const CIMConstProperty& inherited) const {
    const bool isNew = inherited.isUninitialized();
    CIMProperty property(shape.getName(), shape.getValue(), shape.getArraySize(),
                         shape.getReferenceClassName(),
                         isNew ? className_ : inherited.getClassOrigin(), own == nullptr);
    QualifierMerge(table_, scopeOf(shape), {shape.getName(), {}, {}})
        .run(property, own, isNew ? nullptr : &inherited);
    return property;
  }

  CIMMethod makeMethod(const CIMConstMethod& shape, const CIMConstMethod* own,
                       const CIMConstMethod& inherited) const {
    const bool isNew = inherited.isUninitialized();
    CIMMethod method(shape.getName(), shape.getType(),
                     isNew ? className_ : inherited.getClassOrigin(), own == nullptr);
    QualifierMerge(table_, Scope::kMethod, {shape.getName(), {}, {}})
        .run(method, own, isNew ? nullptr : &inherited);
    for (Uint32 i = 0; i < shape.getParameterCount(); ++i) {
      const CIMConstParameter parameter = shape.getParameter(i);
      method.addParameter(makeParameter(shape.getName(), parameter, own != nullptr,
                                        isNew ? CIMConstParameter() : find(inherited, parameter)));
    }
    return method;
  }

  static CIMConstParameter find(const CIMConstMethod& method, const CIMConstParameter& parameter) {
    const Uint32 index = method.findParameter(parameter.getName());
    return index == PEG_NOT_FOUND ? CIMConstParameter() : method.getParameter(index);
  }

  CIMParameter makeParameter(const CIMName& methodName, const CIMConstParameter& shape, bool isOwn,
                             const CIMConstParameter& inherited) const {
    const Part part{methodName, shape.getName(), CIMName()};
    const bool isNew = inherited.isUninitialized();
    if (!isNew &&
        (shape.getType() != inherited.getType() || shape.isArray() != inherited.isArray())) {
      fail("the overridden method's parameter has another type", part);
    }
    CIMParameter parameter(shape.getName(), shape.getType(), shape.isArray(), shape.getArraySize(),
                           shape.getReferenceClassName());
    QualifierMerge(table_, Scope::kParameter, part)
        .run(parameter, isOwn ? &shape : nullptr, isNew ? nullptr : &inherited);
    return parameter;
  }

  const QualifierTable& table_;
  CIMName className_;
};

unsigned scopeOf(const CIMConstClass& declared, const CIMClass& superclass) {
  const auto has = [&](const char* qualifier) {
    return isTrue(declared, qualifier) ||
           (!superclass.isUninitialized() && isTrue(superclass, qualifier));
  };
  return Scope::kClass | (has("Association") ? Scope::kAssociation : 0) |
         (has("Indication") ? Scope::kIndication : 0);
}

void resolveProperties(CIMClass& result, const FeatureResolver& resolver, CIMClass& superclass,
                       const CIMConstClass& declared) {
  const bool isRoot = superclass.isUninitialized();
  for (Uint32 i = 0; !isRoot && i < superclass.getPropertyCount(); ++i) {
    const CIMProperty inherited = superclass.getProperty(i);
    if (declared.findProperty(inherited.getName()) != PEG_NOT_FOUND) continue;
    result.addProperty(inherited);
  }
  for (Uint32 i = 0; i < declared.getPropertyCount(); ++i) {
    const CIMConstProperty own = declared.getProperty(i);
    const Uint32 index = isRoot ? PEG_NOT_FOUND : superclass.findProperty(own.getName());
    result.addProperty(resolver.declare(
        own, index == PEG_NOT_FOUND ? CIMConstProperty() : superclass.getProperty(index)));
  }
}

// A method that lies in several classes could not be shared with the clones of a class, so each
// class has its own; what is in the method is shared.
void resolveMethods(CIMClass& result, const FeatureResolver& resolver, const CIMClass& superclass,
                    const CIMConstClass& declared) {
  const bool isRoot = superclass.isUninitialized();
  for (Uint32 i = 0; !isRoot && i < superclass.getMethodCount(); ++i) {
    const CIMConstMethod inherited = superclass.getMethod(i);
    if (declared.findMethod(inherited.getName()) != PEG_NOT_FOUND) continue;
    result.addMethod(inherited.clone());
  }
  for (Uint32 i = 0; i < declared.getMethodCount(); ++i) {
    const CIMConstMethod own = declared.getMethod(i);
    const Uint32 index = isRoot ? PEG_NOT_FOUND : superclass.findMethod(own.getName());
    result.addMethod(resolver.declare(
        own, index == PEG_NOT_FOUND ? CIMConstMethod() : superclass.getMethod(index)));
  }
}

}  // namespace

CIMClass ClassResolver::inheritable(CIMClass resolved) const {
  const CIMClass& reader = resolved;
  const CIMConstClass source = resolved;
  CIMClass result(reader.getClassName(), reader.getSuperClassName());
  QualifierMerge(qualifiers_, Scope::kAny, {})
      .run(result, static_cast<const CIMConstClass*>(nullptr), &source);
  const FeatureResolver resolver(qualifiers_, reader.getClassName());
  for (Uint32 i = 0; i < resolved.getPropertyCount(); ++i) {
    result.addProperty(resolver.inheritable(resolved.getProperty(i)));
  }
  for (Uint32 i = 0; i < reader.getMethodCount(); ++i) {
    result.addMethod(resolver.inheritable(reader.getMethod(i)));
  }
  return result;
}

CIMClass ClassResolver::resolve(const CIMConstClass& declared, CIMClass superclass) const {
  const bool isRoot = superclass.isUninitialized();
  CIMClass result(declared.getClassName(), isRoot ? CIMName() : superclass.getClassName());
  const CIMConstClass inherited = superclass;
  QualifierMerge(qualifiers_, scopeOf(declared, superclass), {})
      .run(result, &declared, isRoot ? nullptr : &inherited);
  const FeatureResolver resolver(qualifiers_, declared.getClassName());
  resolveProperties(result, resolver, superclass, declared);
  resolveMethods(result, resolver, superclass, declared);
  return result;
}

}  // namespace cimhost
