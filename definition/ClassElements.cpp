// The elements class, instances, property, get, set, conversion and method.

#include "definition/ElementReader.h"
#include "definition/ModuleElement.h"
#include "diagnostics/debug.h"
#include "engine/ProviderDefClass.h"

ProviderDefClass::ProviderDefClass(const char* text, int length, int* consumed,
                                   ProviderDefModule* module) {
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefClass::ProviderDefClass(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefClass::read(ElementReader& reader, ProviderDefModule* module) {
  static const char kInstancesMissing[] = "instance elememt is missing in class element before: ";
  debug(9, "ProviderDefClass Constructor\n");
  reader.retrace();
  withContext("class", name_, [&] {
    for (const auto& [key, value] : reader.unit().getAttributes()) {
      if (key == "name") name_ = value;
      if (key == "namespace") namespace_ = value;
    }
    reader.enter(kInstancesMissing);
    if (reader.isStart("module")) module = readModule(reader);
    reader.expectStart("instances", kInstancesMissing);
    readInstances(reader, module);
    while (!reader.isEnd("class")) {
      if (reader.isStart("property")) {
        properties_.emplace_back(reader, module);
      } else if (reader.isStart("method")) {
        methods_.emplace_back(reader, module);
      } else {
        reader.fail("Unexpected elememt: ");
      }
      reader.advance();
    }
  });
}

void ProviderDefClass::readInstances(ElementReader& reader, ProviderDefModule* module) {
  static const char kMissing[] =
      "constant or functioncall elememt is missing in class element before: ";
  reader.enter(kMissing);
  if (reader.isStart("constant")) {
    debug(9, "Reading constant value\n");
    // Of another type than int the value is not converted: no instances.
    const ProviderDefValue value = readConstant(reader);
    numberOfInstances_ = value.getType() == ProviderDefValue::kInteger ? value.getIntValue() : 0;
  } else if (reader.isStart("functioncall")) {
    instancesCall_ = ProviderDefFunctionCall(reader, module);
    instancesFromFunction_ = true;
    reader.advance();
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
    call = ProviderDefFunctionCall(reader, module);
    fromFunction = true;
    reader.advance();
  } else {
    reader.fail(kMissing);
  }
}

}  // namespace

ProviderDefProperty::ProviderDefProperty(const char* text, int length, int* consumed,
                                         ProviderDefModule* module) {
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefProperty::ProviderDefProperty(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefProperty::read(ElementReader& reader, ProviderDefModule* module) {
  static const char kGetMissing[] = "get element is missing before: ";
  debug(9, "ProviderDefProperty Constructor\n");
  reader.retrace();
  withContext("property", name_, [&] {
    name_ = attribute(reader, "name");
    reader.enter(kGetMissing);
    reader.expectStart("get", kGetMissing);
    readGet(reader, module);
    if (reader.isStart("set")) readSet(reader, module);
    reader.expectEnd("property", "end of the property element is missing before: ");
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
  ElementReader reader(text, length);
  read(reader, module);
  *consumed = reader.consumed();
}

ProviderDefMethod::ProviderDefMethod(ElementReader& reader, ProviderDefModule* module) {
  read(reader, module);
}

void ProviderDefMethod::read(ElementReader& reader, ProviderDefModule* module) {
  static const char kCallMissing[] = "functioncall element is missing before: ";
  debug(9, "ProviderDefMethod Constructor\n");
  reader.retrace();
  withContext("method", name_, [&] {
    name_ = attribute(reader, "name");
    reader.enter(kCallMissing);
    reader.expectStart("functioncall", kCallMissing);
    call_ = ProviderDefFunctionCall(reader, module);
    reader.advance();
    reader.expectEnd("method", "end of the method element is missing before: ");
  });
}
