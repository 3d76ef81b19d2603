// What somebody would write for the one class Bench_HandWritten: names, types and calls in the
// code. It fetches the class for each instance and sets the values on the class's own properties,
// as the generic provider does.

#include "bench/HandWritten.h"

#include <Pegasus/Common/CIMDateTime.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>

extern "C" {
int deviceCount(void);
int deviceText(void* out, int index);
int deviceNumber(int index);
long deviceLong(int index);
int deviceTime(void* out, int index);
int deviceTexts(void* out, int index);
}

using namespace Pegasus;
using namespace bench;

namespace {

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
    setProperty(cimClass, built, keys, "DeviceID", CIMValue(readText(deviceText, i)));
    setProperty(cimClass, built, keys, "Percent", CIMValue(static_cast<Uint8>(deviceNumber(i))));
    setProperty(cimClass, built, keys, "Offset", CIMValue(static_cast<Sint16>(deviceNumber(i))));
    setProperty(cimClass, built, keys, "Number", CIMValue(static_cast<Uint32>(deviceNumber(i))));
    setProperty(cimClass, built, keys, "Balance", CIMValue(static_cast<Sint32>(deviceNumber(i))));
    setProperty(cimClass, built, keys, "Size", CIMValue(static_cast<Uint64>(deviceLong(i))));
    setProperty(cimClass, built, keys, "Ready", CIMValue(deviceNumber(i) != 0));
    setProperty(cimClass, built, keys, "Load", CIMValue(static_cast<Real64>(deviceNumber(i))));
    setProperty(cimClass, built, keys, "Since", CIMValue(CIMDateTime(readText(deviceTime, i))));
    setProperty(cimClass, built, keys, "Labels", CIMValue(readTexts(deviceTexts, i)));
    built.setPath(
        CIMObjectPath(String(), reference.getNameSpace(), reference.getClassName(), keys));
    return built;
  }

  CIMOMHandle cimom_;
};

}  // namespace

extern "C" PEGASUS_EXPORT CIMProvider* PegasusCreateProvider(const String&) {
  return new HandWrittenProvider;
}
