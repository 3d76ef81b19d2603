#include "cimhost/RequestArguments.h"

#include "cimhost/Text.h"
#include "cimhost/output/DisplayText.h"

#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>

#include <map>

namespace cimhost {

using namespace Pegasus;

namespace {

using Texts = std::vector<std::optional<std::string>>;

std::string shown(const CIMName& name) {
  return displayText(toUtf8(name.getString()));
}

std::string quoted(const std::string& text) {
  return '"' + fitToWidth(displayText(text), 60) + '"';
}

// PEG_NOT_FOUND also for what is no CIM name.
template <class Find>
Uint32 findByText(const std::string& name, Find find) {
  try {
    return find(CIMName(fromUtf8(name)));
  } catch (const Exception&) {
    return PEG_NOT_FOUND;
  }
}

// The texts of each element, by its position; `owner` tells in messages what has the elements.
template <class Find>
std::map<Uint32, Texts> collect(const std::vector<std::string>& arguments, const std::string& kind,
                                const std::string& owner, Find find) {
  std::map<Uint32, Texts> collected;
  for (const std::string& argument : arguments) {
    const ValueArgument value = splitValueArgument(argument);
    const Uint32 position = findByText(value.name, find);
    if (position == PEG_NOT_FOUND) {
      throw ValueArgumentError(owner + " has no " + kind + " " + quoted(value.name));
    }
    collected[position].push_back(value.text);
  }
  return collected;
}

// Puts in front of the reason whose value it is and what it is declared as.
template <class Element>
CIMValue valueOf(const std::string& kind, const Element& element, const Texts& texts) {
  const DeclaredType declared{element.getType(), static_cast<bool>(element.isArray()),
                              element.getArraySize()};
  try {
    return parseValue(declared, texts);
  } catch (const ValueArgumentError& error) {
    throw ValueArgumentError(kind + " " + shown(element.getName()) + " (" + declared.toString() +
                             "): " + error.what());
  }
}

bool isOutOnly(const CIMConstParameter& parameter) {
  const Uint32 position = parameter.findQualifier(CIMName("In"));
  return position != PEG_NOT_FOUND &&
         parameter.getQualifier(position).getValue().equal(CIMValue(false));
}

CIMConstMethod findMethod(const CIMConstClass& declaration, const std::string& name) {
  const Uint32 position =
      findByText(name, [&](const CIMName& cimName) { return declaration.findMethod(cimName); });
  if (position != PEG_NOT_FOUND) return declaration.getMethod(position);
  throw ValueArgumentError("class " + shown(declaration.getClassName()) + " has no method " +
                           quoted(name));
}

}  // namespace

ModifyInstanceRequest makeModifyRequest(const CIMClass& declaration, const CIMObjectPath& target,
                                        const std::vector<std::string>& arguments) {
  const CIMConstClass object(declaration);
  const std::map<Uint32, Texts> texts =
      collect(arguments, "property", "class " + shown(object.getClassName()),
              [&](const CIMName& name) { return object.findProperty(name); });
  CIMInstance instance(target.getClassName());
  instance.setPath(target);
  Array<CIMName> names;
  for (const auto& [position, given] : texts) {
    const CIMConstProperty property = object.getProperty(position);
    instance.addProperty(CIMProperty(property.getName(), valueOf("property", property, given),
                                     property.getArraySize(), property.getReferenceClassName()));
    names.append(property.getName());
  }
  return {target.getNameSpace(), instance, true, CIMPropertyList(names)};
}

InvokeMethodRequest makeInvokeRequest(const CIMClass& declaration, const CIMObjectPath& target,
                                      const std::string& method,
                                      const std::vector<std::string>& arguments) {
  const CIMConstMethod declared = findMethod(CIMConstClass(declaration), method);
  const std::string owner = "method " + shown(declared.getName());
  const std::map<Uint32, Texts> texts =
      collect(arguments, "parameter", owner,
              [&](const CIMName& name) { return declared.findParameter(name); });
  InvokeMethodRequest request{target.getNameSpace(), target, declared.getName(), {}};
  for (const auto& [position, given] : texts) {
    const CIMConstParameter parameter = declared.getParameter(position);
    if (isOutOnly(parameter)) {
      throw ValueArgumentError("parameter " + shown(parameter.getName()) + " of " + owner +
                               " takes no value: it is out only");
    }
    request.parameters.append(
        CIMParamValue(parameter.getName().getString(), valueOf("parameter", parameter, given)));
  }
  return request;
}

}  // namespace cimhost
