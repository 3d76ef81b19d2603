// Methods of classes: METHODCALL and METHODRESPONSE.

#include "cimhost/Text.h"
#include "cimhost/output/XmlText.h"
#include "cimhost/xml/CallParameters.h"
#include "cimhost/xml/CimCall.h"

#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>

#include <set>

namespace cimhost {

using namespace Pegasus;

namespace {

class MethodReply final : public MethodResultSink {
 public:
  explicit MethodReply(ReplyWriter& writer) : writer_(writer) {}

  bool deliverMethodResult(const CIMValue& returnValue,
                           const Array<CIMParamValue>& parameters) override {
    if (!returnValue.isNull()) {
      appendReturnValue(writer_.next(), returnValue);
      writer_.written();
    }
    for (Uint32 i = 0; i < parameters.size(); ++i) {
      appendParamValue(writer_.next(), parameters[i]);
      if (!writer_.written()) return false;
    }
    return true;
  }

 private:
  ReplyWriter& writer_;
};

// The method as the object's class declares it, or an empty handle.
CIMConstMethod findDeclaration(const CimCall& call, const CIMName& className,
                               const CIMName& method) {
  if (!call.repository.hasClass(call.nameSpace, className)) return CIMConstMethod();
  const CIMConstClass declaration =
      call.repository.getClass(call.nameSpace, className, false, true, true, CIMPropertyList());
  const Uint32 position = declaration.findMethod(method);
  return position == PEG_NOT_FOUND ? CIMConstMethod() : declaration.getMethod(position);
}

DeclaredType declaredType(const CIMConstMethod& method, const String& name) {
  if (method.isUninitialized() || !CIMName::legal(name)) return {};
  const Uint32 position = method.findParameter(CIMName(name));
  if (position == PEG_NOT_FOUND) return {};
  const CIMConstParameter parameter = method.getParameter(position);
  return {parameter.getType(), static_cast<bool>(parameter.isArray()), parameter.getArraySize()};
}

bool isArrayElement(const XmlElement& value) {
  return value.is("VALUE.ARRAY") || value.is("VALUE.REFARRAY");
}

// Some clients name no type at all: then the declaration does, and without one the element.
DeclaredType typeOf(const XmlElement& parameter, const XmlElement* value,
                    const DeclaredType& declared) {
  DeclaredType type = declared;
  const std::string* const sent = parameter.findAttribute("PARAMTYPE");
  if (sent != nullptr) {
    type = {readType(*sent), value == nullptr ? declared.isArray : isArrayElement(*value)};
  }
  type.type = embeddedType(parameter, type.type);
  return type;
}

bool namesObject(const XmlElement& value) {
  return value.is("INSTANCENAME") || value.is("CLASSNAME");
}

CIMValue readParameterValue(const XmlElement& parameter, const DeclaredType& declared) {
  const XmlElement* const value = parameter.children.empty() ? nullptr : &parameter.onlyChild();
  if (value != nullptr && namesObject(*value)) return CIMValue(readObjectPath(*value));
  if (value != nullptr && value->is("INSTANCE")) return CIMValue(readInstance(*value));
  DeclaredType type = typeOf(parameter, value, declared);
  const bool reference =
      value != nullptr && (value->is("VALUE.REFERENCE") || value->is("VALUE.REFARRAY"));
  if (reference) type = {CIMTYPE_REFERENCE, isArrayElement(*value)};
  return readValue(type, value);
}

Array<CIMParamValue> readParameters(const XmlElement& call, const CIMConstMethod& method) {
  Array<CIMParamValue> result;
  std::set<std::string> names;
  for (const XmlElement& each : call.children) {
    if (!each.is("PARAMVALUE")) continue;
    const std::string& name = each.attribute("NAME");
    result.append(readParameter("parameter " + name, [&] {
      if (!names.insert(name).second) throw ValueArgumentError("given twice");
      const String text = fromUtf8(name);
      return CIMParamValue(text, readParameterValue(each, declaredType(method, text)));
    }));
  }
  return result;
}

}  // namespace

OperationStatus runExtrinsic(const CimCall& call) {
  const CIMObjectPath path =
      readParameter("the object", [&] { return readObjectPath(call.message.objectName()); });
  call.isAbout(path.getClassName());
  const CIMName method =
      readParameter("the method", [&] { return CIMName(fromUtf8(call.message.method())); });
  const CIMConstMethod declaration = findDeclaration(call, path.getClassName(), method);
  MethodReply reply(call.writer);
  return call.operations.invokeMethod(
      call.context,
      {call.nameSpace, path, method, readParameters(call.message.call(), declaration)}, reply);
}

}  // namespace cimhost
