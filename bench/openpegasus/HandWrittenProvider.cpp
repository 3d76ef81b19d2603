// What somebody would write for the one class Bench_HandWritten: names, types and calls in the
// code. It fetches the class for each instance and sets the values on the class's own properties,
// as the generic provider does.

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>

#include <cstring>

extern "C" {
int deviceCount(void);
int deviceText(void* out, int index);
int deviceNumber(int index);
long deviceLong(int index);
int deviceTime(void* out, int index);
int deviceTexts(void* out, int index);
}

using namespace Pegasus;

namespace {

String text(int (*function)(void*, int), int index) {
  char buffer[1024];
  function(buffer, index);
  return String(buffer);
}

Array<String> texts(int index) {
  char buffer[1024];
  deviceTexts(buffer, index);
  Array<String> result;
  int count;
  std::memcpy(&count, buffer + 4, 4);
  const char* at = buffer + 8;
  for (int i = 0; i < count; ++i) {
    int length;
    std::memcpy(&length, at + 4, 4);
    result.append(String(at + 8));
    at += length + 33;  // With the header, the NUL and the gap.
  }
  return result;
}

class HandWrittenProvider : public CIMInstanceProvider {
 public:
  void initialize(CIMOMHandle& cimom) override { cimom_ = cimom; }
  void terminate() override { delete this; }

  void enumerateInstances(const OperationContext& context, const CIMObjectPath& reference,
                          const Boolean, const Boolean, const CIMPropertyList&,
                          InstanceResponseHandler& handler) override {
    handler.processing();
    for (int i = 0; i < deviceCount(); ++i) handler.deliver(instance(context, reference, i));
    handler.complete();
  }

  void getInstance(const OperationContext&, const CIMObjectPath&, const Boolean, const Boolean,
                   const CIMPropertyList&, InstanceResponseHandler&) override {
    throw CIMNotSupportedException("getInstance");
  }
  void enumerateInstanceNames(const OperationContext&, const CIMObjectPath&,
                              ObjectPathResponseHandler&) override {
    throw CIMNotSupportedException("enumerateInstanceNames");
  }
  void modifyInstance(const OperationContext&, const CIMObjectPath&, const CIMInstance&,
                      const Boolean, const CIMPropertyList&, ResponseHandler&) override {
    throw CIMNotSupportedException("modifyInstance");
  }
  void createInstance(const OperationContext&, const CIMObjectPath&, const CIMInstance&,
                      ObjectPathResponseHandler&) override {
    throw CIMNotSupportedException("createInstance");
  }
  void deleteInstance(const OperationContext&, const CIMObjectPath&, ResponseHandler&) override {
    throw CIMNotSupportedException("deleteInstance");
  }

 private:
  CIMInstance instance(const OperationContext& context, const CIMObjectPath& reference, int i) {
    CIMClass cimClass = cimom_.getClass(context, reference.getNameSpace(), reference.getClassName(),
                                        false, true, true, CIMPropertyList());
    CIMInstance built(reference.getClassName());
    Array<CIMKeyBinding> keys;
    set(cimClass, built, keys, "DeviceID", CIMValue(text(deviceText, i)));
    set(cimClass, built, keys, "Percent", CIMValue(static_cast<Uint8>(deviceNumber(i))));
    set(cimClass, built, keys, "Offset", CIMValue(static_cast<Sint16>(deviceNumber(i))));
    set(cimClass, built, keys, "Number", CIMValue(static_cast<Uint32>(deviceNumber(i))));
    set(cimClass, built, keys, "Balance", CIMValue(static_cast<Sint32>(deviceNumber(i))));
    set(cimClass, built, keys, "Size", CIMValue(static_cast<Uint64>(deviceLong(i))));
    set(cimClass, built, keys, "Ready", CIMValue(deviceNumber(i) != 0));
    set(cimClass, built, keys, "Load", CIMValue(static_cast<Real64>(deviceNumber(i))));
    set(cimClass, built, keys, "Since", CIMValue(CIMDateTime(text(deviceTime, i))));
    set(cimClass, built, keys, "Labels", CIMValue(texts(i)));
    built.setPath(
        CIMObjectPath(String(), reference.getNameSpace(), reference.getClassName(), keys));
    return built;
  }

  static void set(CIMClass& cimClass, CIMInstance& instance, Array<CIMKeyBinding>& keys,
                  const char* name, const CIMValue& value) {
    CIMProperty property = cimClass.getProperty(cimClass.findProperty(CIMName(name)));
    property.setValue(value);
    Boolean key = false;
    property.getQualifier(property.findQualifier(CIMName("key"))).getValue().get(key);
    if (key) keys.append(CIMKeyBinding(property.getName(), property.getValue()));
    instance.addProperty(CIMProperty(property.getName(), property.getValue()));
  }

  CIMOMHandle cimom_;
};

}  // namespace

extern "C" PEGASUS_EXPORT CIMProvider* PegasusCreateProvider(const String&) {
  return new HandWrittenProvider;
}
