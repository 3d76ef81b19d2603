#pragma once

#include <Pegasus/Common/ResponseHandler.h>

#include <string>
#include <vector>

#include "conversion/CimText.h"

/// Notes every call that an operation makes on its handler, in order.
class RecordingHandler : public InstanceResponseHandler,
                         public ObjectPathResponseHandler,
                         public ObjectResponseHandler,
                         public MethodResultResponseHandler {
 public:
  void processing() override { events.push_back("processing"); }
  void complete() override { events.push_back("complete"); }

  void deliver(const CIMInstance& instance) override {
    instances.append(instance);
    events.push_back(textOf(instance));
  }
  void deliver(const CIMObjectPath& path) override { events.push_back(textOf(path)); }
  void deliver(const CIMObject& object) override {
    events.push_back("object " + textOf(CIMInstance(object)));
  }
  void deliver(const CIMValue& value) override { events.push_back("returns " + textOf(value)); }
  void deliver(const Array<CIMInstance>&) override { unexpected(); }
  void deliver(const Array<CIMObjectPath>&) override { unexpected(); }
  void deliver(const Array<CIMObject>&) override { unexpected(); }

  void deliverParamValue(const CIMParamValue&) override { unexpected(); }
  void deliverParamValue(const Array<CIMParamValue>& values) override {
    std::string text = "out";
    for (Uint32 i = 0; i < values.size(); ++i) {
      text += " " + textOf(values[i].getParameterName()) + "=(" + textOf(values[i].getValue()) +
              ")" + (values[i].isTyped() ? "" : " untyped");
    }
    events.push_back(text);
  }

  std::vector<std::string> events;
  Array<CIMInstance> instances;

 private:
  void unexpected() { events.push_back("unexpected delivery"); }
};
