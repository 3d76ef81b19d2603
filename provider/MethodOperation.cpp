#include "diagnostics/debug.h"
#include "engine/ProviderDefError.h"
#include "platform/StringConverters.h"
#include "provider/CimConversion.h"
#include "provider/CommonProvider.h"

#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/CIMParameter.h>
#include <Pegasus/Common/CIMQualifier.h>

using namespace Pegasus;

namespace Vaneth {
namespace {

// Unchecked on purpose: without the qualifier the server's out-of-range error leaves.
template <class Qualified>
bool readFlag(Qualified& object, const char* qualifier) {
  Boolean flag = false;
  object.getQualifier(object.findQualifier(CIMName(qualifier))).getValue().get(flag);
  return flag;
}

bool hasFlag(CIMParameter& parameter, const char* qualifier) {
  return parameter.findQualifier(CIMName(qualifier)) != PEG_NOT_FOUND &&
         readFlag(parameter, qualifier);
}

// Appends the value that was sent for a declared in-parameter. A parameter that was not sent
// appends nothing: those behind it move up.
void addInput(CIMParameter& declared, const Array<CIMParamValue>& sent,
              std::vector<ProviderDefValue>& inputs) {
  if (!readFlag(declared, "in")) return;
  for (Uint32 i = 0; i < sent.size(); ++i) {
    // Exact, unlike CIM names elsewhere.
    if (sent[i].getParameterName() != declared.getName().getString()) continue;
    const CIMValue value = sent[i].getValue();
    inputs.push_back(fromCimValue(value, value.getType(), value.isArray()));
    return;
  }
}

std::vector<ProviderDefValue> readInputs(CIMMethod& method, const Array<CIMParamValue>& sent) {
  std::vector<ProviderDefValue> inputs;
  for (Uint32 i = 0; i < method.getParameterCount(); ++i) {
    try {
      CIMParameter declared = method.getParameter(i);
      addInput(declared, sent, inputs);
    } catch (...) {
      // This parameter is left out; the others still count.
    }
  }
  return inputs;
}

Array<CIMParamValue> makeOutputs(CIMMethod& method, const std::vector<ProviderDefValue>& outputs) {
  Array<CIMParamValue> delivered;
  size_t next = 0;
  for (Uint32 i = 0; i < method.getParameterCount() && next < outputs.size(); ++i) {
    CIMParameter declared = method.getParameter(i);
    if (!hasFlag(declared, "out")) continue;
    const ProviderDefValue& output = outputs[next++];
    if (declared.getType() == CIMTYPE_DATETIME && !declared.isArray()) {
      DEBUG_FORMAT(9, "DATE TIME: %s\n", output.getStringValue().c_str());
    }
    delivered.append(CIMParamValue(declared.getName().getString(),
                                   toCimValue(output, declared.getType(), declared.isArray()),
                                   true));
  }
  return delivered;
}

}  // namespace

void CommonProvider::invokeMethod(const OperationContext& context,
                                  const CIMObjectPath& objectReference, const CIMName& methodName,
                                  const Array<CIMParamValue>& inParameters,
                                  MethodResultResponseHandler& handler) {
  const std::string className = make_string(objectReference.getClassName().getString());
  DEBUG_FORMAT(8, "CommonProvider:invokeMethod %s Entry\n", className.c_str());
  const ProviderDefClass* definition = getProviderDefClass(className);
  if (definition == nullptr) return;
  debug(8, "CommonProvider:ProviderDefClass found\n");
  const ProviderDefMethod* defined = definition->getMethod(make_string(methodName.getString()));
  if (defined == nullptr) return;
  handler.processing();
  try {
    CIMClass cimClass = fetchClass(context, objectReference);
    CIMMethod method = cimClass.getMethod(cimClass.findMethod(methodName));
    // The sense of "static" is the definitions' own: an instance is looked up for methods so
    // marked.
    const int index = readFlag(method, "static") ? findPlace(context, objectReference).index : 0;
    const std::vector<ProviderDefValue> inputs = readInputs(method, inParameters);
    std::vector<ProviderDefValue> outputs;
    const int result = defined->exec(inputs, outputs, index);
    const Array<CIMParamValue> delivered = makeOutputs(method, outputs);
    handler.deliverParamValue(delivered);
    handler.deliver(CIMValue(Sint32(result)));
  } catch (const ProviderDefError& error) {
    debugFormat(1, "%s\n", error.getMessage().c_str());
  }
  handler.complete();
}

}  // namespace Vaneth
