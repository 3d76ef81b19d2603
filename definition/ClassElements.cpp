// The elements class, instances, property, get, set, conversion and method.

#include "definition/ElementReader.h"
#include "definition/ModuleElement.h"
#include "diagnostics/debug.h"
#include "engine/ProviderDefClass.h"

ProviderDefClass::ProviderDefClass(const char* text, int length, int* consumed,
                                   ProviderDefModule* module) {
  static const char kInstancesMissing[] = "instance elememt is missing in class element before: ";
  debug(9, "ProviderDefClass Constructor\n");
  withContext("class", name_, [&] {
    ElementReader reader(text, length);
    for (const auto& [key, value] : reader.unit().getAttributes()) {
      if (key == "name") name_ = value;
      if (key == "namespace") namespace_ = value;
    }
    reader.enter(kInstancesMissing);
    if (reader.isStart("module")) module = readModule(reader);
    reader.expectStart("instances", kInstancesMissing);
    readInstances(reader, module);
    while (!reader.isEnd("class")) {
      int used = 0;
      if (reader.isStart("property")) {
        properties_.emplace_back(reader.rest(), reader.restLength(), &used, module);
      } else if (reader.isStart("method")) {
        methods_.emplace_back(reader.rest(), reader.restLength(), &used, module);
      } else {
        reader.fail("Unexpected elememt: ");
      }
      reader.skip(used);
    }
    *consumed = reader.consumed();
  });
}

void ProviderDefClass::readInstances(ElementReader& reader, ProviderDefModule* module) {
  static const char kMissing[] = "constant or functioncall elememt is missing in class element before: ";
  reader.enter(kMissing);
  if (reader.isStart("constant")) {
    debug(9, "Reading constant value\n");
    // Of another type than int the value is not converted: no instances.
    const ProviderDefValue value = readConstant(reader);
    numberOfInstances_ = value.getType() == ProviderDefValue::kInteger ? value.getIntValue() : 0;
  } else if (reader.isStart("functioncall")) {
    int used = 0;
    instancesCall_ =
        ProviderDefFunctionCall(reader.rest(), reader.restLength(), &used, module);
    instancesFromFunction_ = true;
    reader.skip(used);
  } else {
    reader.fail(kMissing);
  }
  reader.expectEnd("instances", "end of the instances element is missing before: ");
  reader.advance();
}

namespace {

// Reads the constant or the call of a get or set side, and goes past it.
void readSide(ElementReader& reader, ProviderDefModule* module, bool& fromFunction,
              ProviderDefValue& constant, ProviderDefFunctionCall& call) {
  static const char kMissing[] =
      "constant or functioncall elememt is missing in property element before: ";
  reader.enter(kMissing);
  if (reader.isStart("constant")) {
    if (attribute(reader, "type") == "int") debug(9, "Property constant type : int\n");
    constant = readConstant(reader);
    fromFunction = false;
  } else if (reader.isStart("functioncall")) {
    int used = 0;
    call = ProviderDefFunctionCall(reader.rest(), reader.restLength(), &used, module);
    fromFunction = true;
    reader.skip(used);
  } else {
    reader.fail(kMissing);
  }
}

}  // namespace

ProviderDefProperty::ProviderDefProperty(const char* text, int length, int* consumed,
                                         ProviderDefModule* module) {
  static const char kGetMissing[] = "get element is missing before: ";
  debug(9, "ProviderDefProperty Constructor\n");
  withContext("property", name_, [&] {
    ElementReader reader(text, length);
    name_ = attribute(reader, "name");
    reader.enter(kGetMissing);
    reader.expectStart("get", kGetMissing);
    readGet(reader, module);
    if (reader.isStart("set")) readSet(reader, module);
    reader.expectEnd("property", "end of the property element is missing before: ");
    *consumed = reader.consumed();
  });
}

void ProviderDefProperty::readGet(ElementReader& reader, ProviderDefModule* module) {
  static const char kEndMissing[] = "end of the get element is missing before: ";
  readSide(reader, module, getFromFunction_, getConstant_, getCall_);
  if (reader.isStart("conversion")) {
    if (attribute(reader, "type") == "valuemap") getValuemap_ = true;
    reader.skipEmpty("conversion", kEndMissing);
  }
  reader.expectEnd("get", kEndMissing);
  reader.advance();
}

void ProviderDefProperty::readSet(ElementReader& reader, ProviderDefModule* module) {
  hasSet_ = true;
  readSide(reader, module, setFromFunction_, setConstant_, setCall_);
  reader.expectEnd("set", "end of the set element is missing before: ");
  reader.advance();
}

ProviderDefMethod::ProviderDefMethod(const char* text, int length, int* consumed,
                                     ProviderDefModule* module) {
  static const char kCallMissing[] = "functioncall element is missing before: ";
  debug(9, "ProviderDefMethod Constructor\n");
  withContext("method", name_, [&] {
    ElementReader reader(text, length);
    name_ = attribute(reader, "name");
    reader.enter(kCallMissing);
    reader.expectStart("functioncall", kCallMissing);
    int used = 0;
    call_ = ProviderDefFunctionCall(reader.rest(), reader.restLength(), &used, module);
    reader.skip(used);
    reader.expectEnd("method", "end of the method element is missing before: ");
    *consumed = reader.consumed();
  });
}
