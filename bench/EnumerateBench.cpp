// enumerateInstances of 1,000 instances with ten properties: through the provider library, and
// through a provider class written by hand for the one class, over the same API and plug-in. Both
// fetch the class for every instance.

#include "bench/BenchDevice.h"
#include "bench/HandWritten.h"
#include "provider/SimpleInstanceResponseHandler.h"

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Embedded/CIMOMHandleRep.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>

#include <benchmark/benchmark.h>
#include <dlfcn.h>

#include <cstdio>
#include <cstring>
#include <stdexcept>

using namespace Pegasus;
using namespace bench;

namespace {

class BenchHost : public CIMOMHandleRep {
 public:
  CIMClass getClass(const OperationContext&, const CIMNamespaceName&, const CIMName&, Boolean,
                    Boolean, Boolean, const CIMPropertyList&) override {
    return class_.clone();
  }
  CIMInstance getInstance(const OperationContext&, const CIMNamespaceName&, const CIMObjectPath&,
                          Boolean, Boolean, Boolean, const CIMPropertyList&) override {
    throw CIMException(CIM_ERR_NOT_SUPPORTED);
  }
  Array<CIMInstance> enumerateInstances(const OperationContext&, const CIMNamespaceName&,
                                        const CIMName&, Boolean, Boolean, Boolean, Boolean,
                                        const CIMPropertyList&) override {
    throw CIMException(CIM_ERR_NOT_SUPPORTED);
  }

 private:
  CIMClass class_ = benchClass();
};

// What somebody would write for this one class: the property names, types and calls in the code,
// and each value set on the class's own property, as in the library.
class HandWritten {
 public:
  HandWritten() : library_(dlopen(BENCH_PLUGIN, RTLD_NOW)) {
    text_ = reinterpret_cast<Writer>(dlsym(library_, "benchText"));
    number_ = reinterpret_cast<int (*)(int)>(dlsym(library_, "benchNumber"));
    long_ = reinterpret_cast<long (*)(int)>(dlsym(library_, "benchLong"));
    numbers_ = reinterpret_cast<Writer>(dlsym(library_, "benchNumbers"));
    texts_ = reinterpret_cast<Writer>(dlsym(library_, "benchTexts"));
  }
  ~HandWritten() { dlclose(library_); }
  HandWritten(const HandWritten&) = delete;
  HandWritten& operator=(const HandWritten&) = delete;

  void enumerate(CIMOMHandle& cimom, const OperationContext& context, const CIMObjectPath& path,
                 InstanceResponseHandler& handler) {
    handler.processing();
    for (int i = 0; i < 1000; ++i) {
      CIMClass cimClass = cimom.getClass(context, path.getNameSpace(), path.getClassName(), false,
                                         true, true, CIMPropertyList());
      CIMInstance instance(path.getClassName());
      Array<CIMKeyBinding> keys;
      setProperty(cimClass, instance, keys, "DeviceID", CIMValue(readText(text_, i)));
      setProperty(cimClass, instance, keys, "Caption", CIMValue(readText(text_, i)));
      setProperty(cimClass, instance, keys, "Number", CIMValue(static_cast<Uint32>(number_(i))));
      setProperty(cimClass, instance, keys, "Percent", CIMValue(static_cast<Uint8>(number_(i))));
      setProperty(cimClass, instance, keys, "Offset", CIMValue(static_cast<Sint16>(number_(i))));
      setProperty(cimClass, instance, keys, "Size", CIMValue(static_cast<Uint64>(long_(i))));
      setProperty(cimClass, instance, keys, "Ready", CIMValue(number_(i) != 0));
      setProperty(cimClass, instance, keys, "Load", CIMValue(static_cast<Real64>(number_(i))));
      setProperty(cimClass, instance, keys, "Counters", CIMValue(numbers(i)));
      setProperty(cimClass, instance, keys, "Labels", CIMValue(readTexts(texts_, i)));
      instance.setPath(CIMObjectPath(String(), path.getNameSpace(), path.getClassName(), keys));
      handler.deliver(instance);
    }
    handler.complete();
  }

 private:
  Array<Sint32> numbers(int index) {
    char buffer[1024];
    numbers_(buffer, index);
    Array<Sint32> result;
    int count;
    std::memcpy(&count, buffer + 4, 4);
    for (int i = 0; i < count; ++i) {
      int value;
      std::memcpy(&value, buffer + 12 + 8 * i, 4);
      result.append(value);
    }
    return result;
  }
  void* library_;
  Writer text_;
  int (*number_)(int);
  long (*long_)(int);
  Writer numbers_;
  Writer texts_;
};

// Checks what was delivered, so that both sides are known to do the same work.
void check(benchmark::State& state, Vaneth::SimpleInstanceResponseHandler& handler) {
  if (handler.instances.size() != 1000 || handler.instances[999].getPropertyCount() != 10 ||
      handler.instances[999].getPath().toString() !=
          String("root/bench:Bench_Device.DeviceID=\"item 00999\"")) {
    state.SkipWithError("not the instances expected");
  }
  state.SetItemsProcessed(state.iterations() * 1000);
}

void enumerateHandWritten(benchmark::State& state) {
  BenchHost host;
  setEmbeddedHost(&host);
  CIMOMHandle cimom;
  HandWritten provider;
  Vaneth::SimpleInstanceResponseHandler last;
  for (auto _ : state) {
    Vaneth::SimpleInstanceResponseHandler handler;
    provider.enumerate(cimom, OperationContext(), benchPath(), handler);
    last = handler;
  }
  check(state, last);
  setEmbeddedHost(nullptr);
}
BENCHMARK(enumerateHandWritten)->Unit(benchmark::kMicrosecond);

void enumerateLibrary(benchmark::State& state) {
  const WorkingDirectory directory;
  BenchHost host;
  setEmbeddedHost(&host);
  CIMOMHandle cimom;
  void* library = dlopen(COMMONPROVIDER_LIBRARY, RTLD_NOW);
  if (library == nullptr) throw std::runtime_error(dlerror());
  const auto create =
      reinterpret_cast<CIMProvider* (*)(const String&)>(dlsym(library, "PegasusCreateProvider"));
  CIMProvider* provider = create(String("CommonProvider"));
  provider->initialize(cimom);
  auto* instances = dynamic_cast<CIMInstanceProvider*>(provider);
  {
    Vaneth::SimpleInstanceResponseHandler last;
    for (auto _ : state) {
      Vaneth::SimpleInstanceResponseHandler handler;
      instances->enumerateInstances(OperationContext(), benchPath(), false, false,
                                    CIMPropertyList(), handler);
      last = handler;
    }
    check(state, last);
  }
  provider->terminate();
  dlclose(library);
  setEmbeddedHost(nullptr);
}
BENCHMARK(enumerateLibrary)->Unit(benchmark::kMicrosecond);

}  // namespace
