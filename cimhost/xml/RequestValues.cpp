#include "cimhost/xml/RequestValues.h"

#include "cimhost/Text.h"
#include "cimhost/xml/HttpError.h"
#include "cimhost/xml/XmlReader.h"

#include <strings.h>
#include <charconv>

namespace cimhost {

using namespace Pegasus;

namespace {

constexpr int kMaximumNesting = 8;
// A path within a path is a quoted text: each level doubles the quotes of the one below.
constexpr Uint32 kMaximumReference = 65536;

CIMName nameOf(const XmlElement& element, std::string_view attribute) {
  return CIMName(fromUtf8(element.attribute(attribute)));
}

CIMName optionalName(const XmlElement& element, std::string_view attribute) {
  const std::string* const text = element.findAttribute(attribute);
  return text == nullptr ? CIMName() : CIMName(fromUtf8(*text));
}

bool isTrue(const XmlElement& element, std::string_view attribute, bool otherwise) {
  const std::string* const text = element.findAttribute(attribute);
  return text == nullptr ? otherwise : strcasecmp(text->c_str(), "true") == 0;
}

Uint32 arraySizeOf(const XmlElement& element) {
  const std::string* const text = element.findAttribute("ARRAYSIZE");
  if (text == nullptr) return 0;
  Uint32 size = 0;
  const char* const end = text->data() + text->size();
  const auto read = std::from_chars(text->data(), end, size);
  if (read.ec != std::errc() || read.ptr != end) throwNotValid("ARRAYSIZE is no number");
  return size;
}

// VALUETYPE decides; without it TYPE, which newer clients add.
CIMKeyBinding::Type keyTypeOf(const XmlElement& keyValue) {
  const std::string* const valueType = keyValue.findAttribute("VALUETYPE");
  const std::string* const type = keyValue.findAttribute("TYPE");
  if (valueType != nullptr) {
    if (*valueType == "boolean") return CIMKeyBinding::BOOLEAN;
    if (*valueType == "numeric") return CIMKeyBinding::NUMERIC;
    if (*valueType == "string") return CIMKeyBinding::STRING;
    throwNotValid("VALUETYPE is " + *valueType);
  }
  if (type == nullptr) return CIMKeyBinding::STRING;
  const CIMType cimType = readType(*type);
  if (cimType == CIMTYPE_BOOLEAN) return CIMKeyBinding::BOOLEAN;
  return cimType < CIMTYPE_CHAR16 ? CIMKeyBinding::NUMERIC : CIMKeyBinding::STRING;
}

void checkKey(const std::string& text, CIMKeyBinding::Type type) {
  if (type == CIMKeyBinding::BOOLEAN) parseElements({CIMTYPE_BOOLEAN}, {text});
  if (type == CIMKeyBinding::NUMERIC && text.find_first_of(".eE") == std::string::npos) {
    parseElements({text[0] == '-' ? CIMTYPE_SINT64 : CIMTYPE_UINT64}, {text});
  } else if (type == CIMKeyBinding::NUMERIC && text.compare(0, 2, "0x") != 0) {
    parseElements({CIMTYPE_REAL64}, {text});
  }
}

CIMKeyBinding readKey(const XmlElement& binding) {
  const XmlElement& value = binding.onlyChild();
  const CIMName name = nameOf(binding, "NAME");
  if (value.is("VALUE.REFERENCE")) {
    const String path = readObjectPath(value).toString();
    if (path.size() > kMaximumReference) throw ValueArgumentError("the path in a key is too long");
    return CIMKeyBinding(name, path, CIMKeyBinding::REFERENCE);
  }
  const CIMKeyBinding::Type type = keyTypeOf(value);
  checkKey(value.text, type);
  return CIMKeyBinding(name, fromUtf8(value.text), type);
}

CIMObjectPath readInstanceName(const XmlElement& element) {
  Array<CIMKeyBinding> keys;
  for (const XmlElement& child : element.children) {
    if (!child.is("KEYBINDING")) throw ValueArgumentError("a key without a name is not understood");
    keys.append(readKey(child));
  }
  return CIMObjectPath(String(), CIMNamespaceName(), nameOf(element, "CLASSNAME"), keys);
}

void setNamespace(CIMObjectPath& path, const XmlElement& localNamespacePath) {
  path.setNameSpace(CIMNamespaceName(fromUtf8(namespaceText(localNamespacePath))));
}

// An element that holds a namespace, local or with a host, and a name.
CIMObjectPath readPlacedPath(const XmlElement& element) {
  if (element.children.size() != 2) throwNotValid(std::string(element.name()) + " is incomplete");
  const XmlElement& place = element.children[0];
  const XmlElement& name = element.children[1];
  if (!name.is("INSTANCENAME") && !name.is("CLASSNAME")) {
    throwNotValid(std::string(element.name()) + " must end with a name");
  }
  CIMObjectPath path = readObjectPath(name);
  if (!place.is("NAMESPACEPATH")) {
    setNamespace(path, place);
    return path;
  }
  if (place.children.size() != 2 || !place.children[0].is("HOST")) {
    throwNotValid("NAMESPACEPATH is incomplete");
  }
  setNamespace(path, place.children[1]);
  path.setHost(fromUtf8(place.children[0].text));
  return path;
}

// Instances that are read within the values of others.
class InstanceReader {
 public:
  explicit InstanceReader(int depth) : depth_(depth) {}

  CIMInstance instance(const XmlElement& element) const {
    CIMInstance result(nameOf(element, "CLASSNAME"));
    for (const XmlElement& child : element.children) {
      if (child.is("QUALIFIER")) {
        result.addQualifier(qualifier(child));
      } else {
        result.addProperty(property(child));
      }
    }
    return result;
  }

  CIMValue value(const DeclaredType& declared, const XmlElement* element) const {
    if (element == nullptr) return CIMValue(declared.type, declared.isArray, declared.arraySize);
    const bool isArray = element->is("VALUE.ARRAY") || element->is("VALUE.REFARRAY");
    if (isArray != declared.isArray) {
      throw ValueArgumentError(isArray ? "an array is given, one value expected"
                                       : "one value is given, an array expected");
    }
    switch (declared.type) {
      case CIMTYPE_REFERENCE:
        return references(declared, *element);
      case CIMTYPE_INSTANCE:
        return objects<CIMInstance>(declared, *element);
      case CIMTYPE_OBJECT:
        return objects<CIMObject>(declared, *element);
      default:
        return parseElements(declared, textsOf(*element));
    }
  }

 private:
  static const std::string& textOf(const XmlElement& element) {
    if (element.is("VALUE.NULL")) throw ValueArgumentError("null elements are not supported");
    if (!element.is("VALUE")) throw ValueArgumentError("a reference is given, a text expected");
    return element.text;
  }

  static std::vector<std::string> textsOf(const XmlElement& element) {
    if (!element.is("VALUE.ARRAY")) return {textOf(element)};
    std::vector<std::string> texts;
    for (const XmlElement& child : element.children) texts.push_back(textOf(child));
    return texts;
  }

  static CIMObjectPath referenceOf(const XmlElement& element) {
    if (element.is("VALUE.REFERENCE")) return readObjectPath(element);
    return CIMObjectPath(fromUtf8(textOf(element)));
  }

  static CIMValue references(const DeclaredType& declared, const XmlElement& element) {
    if (!declared.isArray) return CIMValue(referenceOf(element));
    Array<CIMObjectPath> paths;
    for (const XmlElement& child : element.children) paths.append(referenceOf(child));
    return CIMValue(paths);
  }

  template <class Object>
  CIMValue objects(const DeclaredType& declared, const XmlElement& element) const {
    if (!declared.isArray) return CIMValue(Object(embedded(textOf(element))));
    Array<Object> result;
    for (const XmlElement& child : element.children) {
      result.append(Object(embedded(textOf(child))));
    }
    return CIMValue(result);
  }

  // A text that is not what it should be is a wrong value of a valid request.
  CIMInstance embedded(const std::string& text) const {
    if (depth_ == kMaximumNesting) {
      throw ValueArgumentError("instances are nested too deeply in values");
    }
    try {
      const XmlDocument document = readXml(text, "INSTANCE CLASS");
      if (!document.problem.empty()) throw ValueArgumentError(document.problem);
      if (document.root.is("CLASS")) {
        throw ValueArgumentError("a class as a value is not supported");
      }
      return InstanceReader(depth_ + 1).instance(document.root);
    } catch (const HttpError& error) {
      throw ValueArgumentError(error.what());
    }
  }

  CIMProperty property(const XmlElement& element) const {
    const XmlElement* found = nullptr;
    for (const XmlElement& child : element.children) {
      if (child.is("QUALIFIER")) continue;
      if (found != nullptr) throwNotValid(std::string(element.name()) + " with two values");
      found = &child;
    }
    const CIMName name = nameOf(element, "NAME");
    const bool reference = element.is("PROPERTY.REFERENCE");
    const CIMType type =
        reference ? CIMTYPE_REFERENCE : embeddedType(element, readType(element.attribute("TYPE")));
    const DeclaredType declared{type, element.is("PROPERTY.ARRAY"), arraySizeOf(element)};
    CIMProperty result(name, namedValue(element, declared, found), declared.arraySize,
                       optionalName(element, "REFERENCECLASS"),
                       optionalName(element, "CLASSORIGIN"), isTrue(element, "PROPAGATED", false));
    for (const XmlElement& child : element.children) {
      if (child.is("QUALIFIER")) result.addQualifier(qualifier(child));
    }
    return result;
  }

  // The reason tells which property it is.
  CIMValue namedValue(const XmlElement& element, const DeclaredType& declared,
                      const XmlElement* found) const {
    try {
      return value(declared, found);
    } catch (const ValueArgumentError& error) {
      throw ValueArgumentError(element.attribute("NAME") + " (" + declared.toString() +
                               "): " + error.what());
    }
  }

  CIMQualifier qualifier(const XmlElement& element) const {
    const XmlElement* const found = element.children.empty() ? nullptr : &element.onlyChild();
    const DeclaredType declared{readType(element.attribute("TYPE")),
                                found != nullptr && found->is("VALUE.ARRAY")};
    CIMFlavor flavor;
    const auto add = [&](std::string_view attribute, bool otherwise, const CIMFlavor& each) {
      if (isTrue(element, attribute, otherwise)) flavor.addFlavor(each);
    };
    add("OVERRIDABLE", true, CIMFlavor::OVERRIDABLE);
    add("TOSUBCLASS", true, CIMFlavor::TOSUBCLASS);
    add("TOINSTANCE", false, CIMFlavor::TOINSTANCE);
    add("TRANSLATABLE", false, CIMFlavor::TRANSLATABLE);
    return CIMQualifier(nameOf(element, "NAME"), value(declared, found), flavor,
                        isTrue(element, "PROPAGATED", false));
  }

  int depth_;
};

}  // namespace

std::string namespaceText(const XmlElement& localNamespacePath) {
  std::string text;
  for (const XmlElement& each : localNamespacePath.children) {
    text += (text.empty() ? "" : "/") + each.attribute("NAME");
  }
  return text;
}

CIMObjectPath readObjectPath(const XmlElement& element) {
  if (element.is("VALUE.REFERENCE")) return readObjectPath(element.onlyChild());
  if (element.is("INSTANCENAME")) return readInstanceName(element);
  if (element.is("CLASSNAME")) {
    return CIMObjectPath(String(), CIMNamespaceName(), nameOf(element, "NAME"));
  }
  return readPlacedPath(element);
}

CIMType readType(const std::string& name) {
  for (int i = CIMTYPE_BOOLEAN; i <= CIMTYPE_REFERENCE; ++i) {
    const CIMType type = static_cast<CIMType>(i);
    if (strcasecmp(name.c_str(), cimTypeToString(type)) == 0) return type;
  }
  throwNotValid("there is no type " + name);
}

CIMType embeddedType(const XmlElement& holder, CIMType type) {
  const std::string* kind = holder.findAttribute("EmbeddedObject");
  if (kind == nullptr) kind = holder.findAttribute("EMBEDDEDOBJECT");
  if (kind == nullptr) return type;
  if (*kind == "instance") return CIMTYPE_INSTANCE;
  if (*kind == "object") return CIMTYPE_OBJECT;
  throwNotValid("EmbeddedObject is " + *kind);
}

CIMValue readValue(const DeclaredType& declared, const XmlElement* value) {
  return InstanceReader(0).value(declared, value);
}

CIMInstance readInstance(const XmlElement& instance) {
  return InstanceReader(0).instance(instance);
}

}  // namespace cimhost
