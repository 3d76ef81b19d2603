#include "cimhost/mof/MofCompiler.h"

#include "cimhost/Text.h"
#include "cimhost/mof/MofKeywords.h"
#include "cimhost/mof/MofValue.h"
#include "cimhost/mof/Printable.h"
#include "cimhost/repository/ClassDeclarationError.h"

namespace cimhost {
namespace {

using Pegasus::CIMClass;
using Pegasus::CIMFlavor;
using Pegasus::CIMMethod;
using Pegasus::CIMName;
using Pegasus::CIMNamespaceName;
using Pegasus::CIMParameter;
using Pegasus::CIMProperty;
using Pegasus::CIMQualifier;
using Pegasus::CIMValue;
using Pegasus::Uint32;

std::string quoted(const MofName& name) {
  return '\'' + shortened(name.text, 60) + '\'';
}

void apply(CIMFlavor& flavors, MofFlavor change) {
  const auto replace = [&flavors](const CIMFlavor& added, const CIMFlavor& removed) {
    flavors.removeFlavor(removed);
    flavors.addFlavor(added);
  };
  switch (change) {
    case MofFlavor::enableOverride:
      return replace(CIMFlavor::OVERRIDABLE, CIMFlavor::DISABLEOVERRIDE);
    case MofFlavor::disableOverride:
      return replace(CIMFlavor::DISABLEOVERRIDE, CIMFlavor::OVERRIDABLE);
    case MofFlavor::toSubclass:
      return replace(CIMFlavor::TOSUBCLASS, CIMFlavor::RESTRICTED);
    case MofFlavor::restricted:
      return replace(CIMFlavor::RESTRICTED, CIMFlavor::TOSUBCLASS);
    case MofFlavor::translatable:
      return flavors.addFlavor(CIMFlavor::TRANSLATABLE);
    case MofFlavor::toInstance:
      return flavors.addFlavor(CIMFlavor::TOINSTANCE);
  }
}

CIMFlavor changed(CIMFlavor flavors, const std::vector<MofFlavor>& changes) {
  for (const MofFlavor change : changes) apply(flavors, change);
  return flavors;
}

/// Builds the CIM objects of one declaration; see MofCompiler.
class DeclarationBuilder {
 public:
  DeclarationBuilder(const ClassRepository& repository, const MofSource& source,
                     const CIMNamespaceName& nameSpace)
      : repository_(repository), source_(source), nameSpace_(nameSpace) {}

  CIMClass makeClass(const MofClassDeclaration& declaration) const {
    const MofName& superclass = declaration.superclass;
    CIMClass result(toCimName(declaration.name),
                    superclass.text.empty() ? CIMName() : toCimName(superclass));
    addQualifiers(result, declaration.qualifiers);
    for (const MofFeature& feature : declaration.features) {
      if (feature.isMethod) {
        addNew(result, &CIMClass::findMethod, &CIMClass::addMethod, feature, makeMethod(feature));
      } else {
        addProperty(result, feature);
      }
    }
    return result;
  }

  /// The written value, else `otherwise`.
  CIMValue valueOf(const MofElement& element, const CIMValue& otherwise) const {
    return element.value ? makeMofValue(source_, *element.value, element) : otherwise;
  }

 private:
  [[noreturn]] void fail(std::size_t offset, const std::string& message) const {
    throw MofError(source_, offset, message);
  }

  // What the API still refuses, such as too many elements, is reported at `offset`.
  template <class Action>
  auto guarded(std::size_t offset, Action action) const {
    try {
      return action();
    } catch (const Pegasus::Exception& exception) {
      fail(offset, shortened(toUtf8(exception.getMessage()), 200));
    }
  }

  template <class Owner, class Find, class Add, class Made>
  void addNew(Owner& owner, Find find, Add add, const MofElement& element, Made made) const {
    if ((owner.*find)(made.getName()) != PEG_NOT_FOUND) {
      fail(element.name.offset, quoted(element.name) + " is declared twice");
    }
    guarded(element.name.offset, [&] { (owner.*add)(made); });
  }

  void addProperty(CIMClass& owner, const MofFeature& feature) const {
    if (feature.type == Pegasus::CIMTYPE_REFERENCE && feature.isArray) {
      fail(feature.name.offset, "a property cannot be an array of references");
    }
    const CIMValue value = valueOf(feature, makeNullValue(feature));
    CIMProperty property = guarded(feature.name.offset, [&] {
      return CIMProperty(toCimName(feature.name), value, feature.arraySize,
                         referenceClass(feature));
    });
    addQualifiers(property, feature.qualifiers);
    addNew(owner, &CIMClass::findProperty, &CIMClass::addProperty, feature, property);
  }

  CIMMethod makeMethod(const MofFeature& feature) const {
    CIMMethod method(toCimName(feature.name), feature.type);
    addQualifiers(method, feature.qualifiers);
    for (const MofElement& element : feature.parameters) {
      CIMParameter parameter(toCimName(element.name), element.type, element.isArray,
                             element.arraySize, referenceClass(element));
      addQualifiers(parameter, element.qualifiers);
      addNew(method, &CIMMethod::findParameter, &CIMMethod::addParameter, element, parameter);
    }
    return method;
  }

  static CIMName referenceClass(const MofElement& element) {
    return element.referenceClass.text.empty() ? CIMName() : toCimName(element.referenceClass);
  }

  template <class Owner>
  void addQualifiers(Owner& owner, const std::vector<MofQualifier>& qualifiers) const {
    for (const MofQualifier& qualifier : qualifiers) {
      if (owner.findQualifier(toCimName(qualifier.name)) != PEG_NOT_FOUND) {
        fail(qualifier.name.offset, "qualifier " + quoted(qualifier.name) + " is given twice");
      }
      const CIMQualifier made = makeQualifier(qualifier);
      guarded(qualifier.name.offset, [&] { owner.addQualifier(made); });
    }
  }

  CIMQualifier makeQualifier(const MofQualifier& qualifier) const {
    const CIMName name = toCimName(qualifier.name);
    const CIMQualifier declared = repository_.findQualifier(nameSpace_, name);
    if (declared.isUninitialized()) {
      throw MofUnresolvedName(source_, qualifier.name.offset,
                              "unknown qualifier " + quoted(qualifier.name),
                              mofQualifierKey(nameSpace_, qualifier.name.text));
    }
    CIMFlavor flavor = CIMFlavor::NONE;
    if (!qualifier.flavors.empty()) flavor = changed(declared.getFlavor(), qualifier.flavors);
    return CIMQualifier(name, qualifierValue(qualifier, declared), flavor);
  }

  // Without a value a boolean qualifier is TRUE and any other is null (DSP0004, 4.4).
  CIMValue qualifierValue(const MofQualifier& qualifier, const CIMQualifier& declared) const {
    MofElement shape;
    shape.type = declared.getType();
    shape.isArray = declared.isArray();
    if (qualifier.value) return makeMofValue(source_, *qualifier.value, shape);
    const bool isFlag = shape.type == Pegasus::CIMTYPE_BOOLEAN && !shape.isArray;
    return isFlag ? CIMValue(true) : makeNullValue(shape);
  }

  const ClassRepository& repository_;
  const MofSource& source_;
  const CIMNamespaceName& nameSpace_;
};

bool isSame(const MofName& written, const CIMName& name) {
  return !name.isNull() && toCimName(written).equal(name);
}

template <class Element>
const Element* find(const std::vector<Element>& elements, const CIMName& name) {
  for (const Element& element : elements) {
    if (isSame(element.name, name)) return &element;
  }
  return nullptr;
}

// Where the part that the repository complains about is written.
std::size_t placeOf(const ClassDeclarationError::Part& part,
                    const MofClassDeclaration& declaration) {
  std::size_t place = declaration.name.offset;
  const std::vector<MofQualifier>* qualifiers = &declaration.qualifiers;
  const auto enter = [&](const MofElement& element) {
    place = element.name.offset;
    qualifiers = &element.qualifiers;
  };
  if (const MofFeature* feature = find(declaration.features, part.feature)) {
    enter(*feature);
    const MofElement* parameter = find(feature->parameters, part.parameter);
    if (parameter != nullptr) enter(*parameter);
  }
  const MofQualifier* qualifier = find(*qualifiers, part.qualifier);
  return qualifier != nullptr ? qualifier->name.offset : place;
}

[[noreturn]] void refuse(const MofSource& source, const CIMNamespaceName& nameSpace,
                         const MofClassDeclaration& declaration,
                         const ClassDeclarationError& error) {
  if (error.getCode() == Pegasus::CIM_ERR_INVALID_SUPERCLASS) {
    throw MofUnresolvedName(source, declaration.superclass.offset,
                            "unknown superclass " + quoted(declaration.superclass),
                            mofClassKey(nameSpace, declaration.superclass.text));
  }
  if (error.getCode() == Pegasus::CIM_ERR_ALREADY_EXISTS) {
    throw MofError(source, declaration.name.offset,
                   "class " + quoted(declaration.name) + " is declared already");
  }
  throw MofError(source, placeOf(error.part(), declaration), toUtf8(error.getMessage()));
}

}  // namespace

std::string mofClassKey(const CIMNamespaceName& nameSpace, const std::string& name) {
  return asciiLowered(toUtf8(nameSpace.getString()) + ":class:" + name);
}

std::string mofQualifierKey(const CIMNamespaceName& nameSpace, const std::string& name) {
  return asciiLowered(toUtf8(nameSpace.getString()) + ":qualifier:" + name);
}

void MofCompiler::add(const MofUnit::Item& item) {
  const auto* qualifier = std::get_if<MofQualifierDeclaration>(&item.declaration);
  const auto* cimClass = std::get_if<MofClassDeclaration>(&item.declaration);
  const MofName& name = qualifier != nullptr ? qualifier->element.name : cimClass->name;
  try {
    repository_.addNamespace(item.nameSpace);
    if (qualifier != nullptr) {
      addQualifier(item, *qualifier);
    } else {
      addClass(item, *cimClass);
    }
  } catch (const Pegasus::Exception& exception) {
    throw MofError(*item.source, name.offset, toUtf8(exception.getMessage()));
  }
}

void MofCompiler::addQualifier(const MofUnit::Item& item,
                               const MofQualifierDeclaration& declaration) {
  const DeclarationBuilder builder(repository_, *item.source, item.nameSpace);
  const CIMFlavor flavor = changed(CIMFlavor::DEFAULTS, declaration.flavors);
  const MofElement& element = declaration.element;
  const CIMValue value = builder.valueOf(element, makeNullValue(element));
  repository_.addQualifier(item.nameSpace, CIMQualifier(toCimName(element.name), value, flavor),
                           declaration.scope);
}

void MofCompiler::addClass(const MofUnit::Item& item, const MofClassDeclaration& declaration) {
  const DeclarationBuilder builder(repository_, *item.source, item.nameSpace);
  try {
    repository_.addClass(item.nameSpace, builder.makeClass(declaration));
  } catch (const ClassDeclarationError& error) {
    refuse(*item.source, item.nameSpace, declaration, error);
  }
}

}  // namespace cimhost
