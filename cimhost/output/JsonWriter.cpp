#include "cimhost/CimTypes.h"
#include "cimhost/Text.h"
#include "cimhost/output/ResultWriter.h"

#include <nlohmann/json.hpp>

#include <cmath>

namespace cimhost {

using namespace Pegasus;

namespace {

using Json = nlohmann::ordered_json;

// An embedded object may hold others; a chain of them must not exhaust the stack.
constexpr int kMaximumNesting = 16;

Json text(const String& value) {
  return toUtf8(value);
}
Json text(const CIMName& name) {
  return name.isNull() ? Json() : text(name.getString());
}

Json instanceJson(const CIMConstInstance& instance, int depth);
Json classJson(const CIMConstClass& declaration, int depth);

struct ElementJson {
  int depth;

  template <class T>
  Json operator()(const T& element) const {
    if constexpr (std::is_floating_point_v<T>) {
      return real(element);
    } else if constexpr (std::is_arithmetic_v<T>) {
      return element;
    } else {
      return other(element);
    }
  }

  // JSON has no number for these; XML Schema's names for them are in use elsewhere in WBEM.
  static Json real(double number) {
    if (std::isnan(number)) return "NaN";
    if (std::isinf(number)) return number > 0 ? "INF" : "-INF";
    return number;
  }

  static Json other(const Char16& element) { return text(String(&element, 1)); }
  static Json other(const String& element) { return text(element); }
  static Json other(const CIMDateTime& element) { return text(element.toString()); }
  static Json other(const CIMObjectPath& element) { return text(element.toString()); }
  Json other(const CIMInstance& element) const { return instanceJson(element, depth + 1); }
  Json other(const CIMObject& element) const {
    if (element.isUninitialized()) return nullptr;
    if (element.isInstance()) return instanceJson(CIMInstance(element), depth + 1);
    return classJson(CIMClass(element), depth + 1);
  }
};

template <class T>
Json elementOrArray(const ElementJson& convert, const T& element) {
  return convert(element);
}

template <class T>
Json elementOrArray(const ElementJson& convert, const Array<T>& elements) {
  Json result = Json::array();
  for (Uint32 i = 0; i < elements.size(); ++i) result.push_back(convert(elements[i]));
  return result;
}

Json valueJson(const CIMValue& value, int depth) {
  if (value.isNull() || depth > kMaximumNesting) return nullptr;
  const ElementJson convert{depth};
  return visitCimValue(value, [&convert](const auto& any) { return elementOrArray(convert, any); });
}

template <class Element>
Json qualifiersJson(const Element& element, int depth) {
  Json result = Json::object();
  for (Uint32 i = 0; i < element.getQualifierCount(); ++i) {
    const CIMConstQualifier qualifier = element.getQualifier(i);
    result[toUtf8(qualifier.getName().getString())] = valueJson(qualifier.getValue(), depth);
  }
  return result;
}

Json instanceJson(const CIMConstInstance& instance, int depth) {
  Json properties = Json::object();
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    const CIMConstProperty property = instance.getProperty(i);
    properties[toUtf8(property.getName().getString())] = valueJson(property.getValue(), depth);
  }
  return Json{{"path", text(instance.getPath().toString())},
              {"class", text(instance.getClassName())},
              {"properties", std::move(properties)}};
}

template <class Element>
Json typedElement(const Element& element) {
  Json result{{"name", text(element.getName())},
              {"type", cimTypeToString(element.getType())},
              {"array", static_cast<bool>(element.isArray())}};
  if (element.getArraySize() > 0) result["size"] = element.getArraySize();
  if (element.getType() == CIMTYPE_REFERENCE) {
    result["referenceClass"] = text(element.getReferenceClassName());
  }
  return result;
}

Json propertyJson(const CIMConstProperty& property, int depth) {
  Json result = typedElement(property);
  result["default"] = valueJson(property.getValue(), depth);
  if (!property.getClassOrigin().isNull()) result["classOrigin"] = text(property.getClassOrigin());
  result["inherited"] = static_cast<bool>(property.getPropagated());
  result["qualifiers"] = qualifiersJson(property, depth);
  return result;
}

Json methodJson(const CIMConstMethod& method, int depth) {
  Json parameters = Json::array();
  for (Uint32 i = 0; i < method.getParameterCount(); ++i) {
    Json parameter = typedElement(method.getParameter(i));
    parameter["qualifiers"] = qualifiersJson(method.getParameter(i), depth);
    parameters.push_back(std::move(parameter));
  }
  Json result{{"name", text(method.getName())}, {"type", cimTypeToString(method.getType())}};
  result["parameters"] = std::move(parameters);
  if (!method.getClassOrigin().isNull()) result["classOrigin"] = text(method.getClassOrigin());
  result["inherited"] = static_cast<bool>(method.getPropagated());
  result["qualifiers"] = qualifiersJson(method, depth);
  return result;
}

Json classJson(const CIMConstClass& declaration, int depth) {
  Json properties = Json::array();
  for (Uint32 i = 0; i < declaration.getPropertyCount(); ++i) {
    properties.push_back(propertyJson(declaration.getProperty(i), depth));
  }
  Json methods = Json::array();
  for (Uint32 i = 0; i < declaration.getMethodCount(); ++i) {
    methods.push_back(methodJson(declaration.getMethod(i), depth));
  }
  return Json{{"class", text(declaration.getClassName())},
              {"superclass", text(declaration.getSuperClassName())},
              {"qualifiers", qualifiersJson(declaration, depth)},
              {"properties", std::move(properties)},
              {"methods", std::move(methods)}};
}

class JsonWriter final : public ResultWriter {
 public:
  JsonWriter(std::ostream& out, ResultForm form) : out_(out), list_(form == ResultForm::list) {}

  bool deliverInstance(const CIMInstance& instance) override {
    return write(instanceJson(instance, 0));
  }
  bool deliverPath(const CIMObjectPath& path) override { return write(text(path.toString())); }
  bool deliverClass(const CIMClass& declaration) override {
    return write(classJson(declaration, 0));
  }
  bool deliverClassName(const CIMName& name) override { return write(text(name)); }
  bool deliverMethodResult(const CIMValue& returnValue,
                           const Array<CIMParamValue>& parameters) override {
    Json values = Json::object();
    for (Uint32 i = 0; i < parameters.size(); ++i) {
      const CIMParamValue& each = parameters[i];
      values[toUtf8(each.getParameterName())] = valueJson(each.getValue(), 0);
    }
    return write(
        Json{{"returnValue", valueJson(returnValue, 0)}, {"parameters", std::move(values)}});
  }

  void finish() override {
    if (list_) out_ << (first_ ? "[]" : "\n]");
    out_ << std::endl;
  }

 private:
  bool write(const Json& value) {
    if (list_) out_ << (first_ ? "[\n" : ",\n");
    first_ = false;
    out_ << value.dump(2, ' ', false, Json::error_handler_t::replace);
    return static_cast<bool>(out_);
  }

  std::ostream& out_;
  bool list_;
  bool first_ = true;
};

}  // namespace

std::unique_ptr<ResultWriter> makeJsonWriter(std::ostream& out, ResultForm form) {
  return std::make_unique<JsonWriter>(out, form);
}

}  // namespace cimhost
