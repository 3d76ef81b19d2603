// A provider that behaves as its provider name and the class asked for tell, mostly badly.

#include <Pegasus/Provider/CIMInstanceProvider.h>

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <map>
#include <stdexcept>
#include <string>

using namespace Pegasus;

namespace {

// The only trace that outlives the library.
void record(const std::string& event) {
  const char* before = std::getenv("TEST_PROVIDER_EVENTS");
  setenv("TEST_PROVIDER_EVENTS", ((before != nullptr ? before : "") + event + ";").c_str(), 1);
}

CIMInstance makeDisk(const CIMName& className, const CIMNamespaceName& nameSpace,
                     const String& name) {
  CIMInstance instance(className);
  CIMProperty property(CIMName("Name"), CIMValue(name));
  property.setClassOrigin(CIMName("Test_Base"));
  property.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(true)));
  instance.addProperty(property);
  instance.addProperty(CIMProperty(CIMName("Size"), CIMValue(Uint64(7))));
  Array<CIMKeyBinding> keys;
  keys.append(CIMKeyBinding(CIMName("Name"), CIMValue(name)));
  instance.setPath(CIMObjectPath(String(), nameSpace, className, keys));
  return instance;
}

std::string utf8(const String& text) {
  return static_cast<const char*>(text.getCString());
}

struct Request {
  const OperationContext& context;
  const CIMObjectPath& path;
  InstanceResponseHandler& handler;
  CIMOMHandle& server;

  void deliver(const std::string& name) const {
    handler.deliver(makeDisk(path.getClassName(), path.getNameSpace(), String(name.c_str())));
  }
  void deliverNumbered(int count) const {
    for (int i = 0; i < count; ++i) deliver(std::to_string(i));
  }
  void complete() const { handler.complete(); }
};

using Behaviour = std::function<void(const Request&)>;

void deliverSwallowing(const Request& request) {
  for (int i = 0; i < 1500; ++i) {
    try {
      request.deliver(std::to_string(i));
    } catch (...) {
      record("swallowed");
    }
  }
  request.complete();
}

void deliverWhatTheServerHas(const Request& request) {
  const Array<CIMInstance> disks = request.server.enumerateInstances(
      request.context, request.path.getNameSpace(), CIMName("Test_Disk"), true, false, true, true,
      CIMPropertyList());
  for (Uint32 i = 0; i < disks.size(); ++i) {
    request.deliver("seen " + utf8(disks[i].getPath().toString()));
  }
  request.complete();
}

void askForItself(const Request& request) {
  record("nested");
  request.server.enumerateInstances(request.context, request.path.getNameSpace(),
                                    request.path.getClassName(), true, false, true, true,
                                    CIMPropertyList());
  request.complete();
}

void deliverWithoutNamespace(const Request& request) {
  CIMInstance instance = makeDisk(request.path.getClassName(), CIMNamespaceName(), "plain");
  request.handler.deliver(instance);
  request.complete();
}

void deliverPrinting(const Request& request) {
  std::puts("noise");
  request.deliver("quiet");
  request.complete();
}

void deliverArray(const Request& request) {
  Array<CIMInstance> instances;
  for (const char* name : {"x", "y"}) {
    instances.append(makeDisk(request.path.getClassName(), request.path.getNameSpace(), name));
  }
  request.handler.deliver(instances);
  request.complete();
}

const std::map<std::string, Behaviour> kBehaviours = {
    {"Test_Disk", [](const Request& r) { r.deliver("a"), r.deliver("b"), r.complete(); }},
    {"Test_BigDisk", [](const Request& r) { r.deliver("big"), r.complete(); }},
    {"Test_Array", deliverArray},
    {"Test_Prints", deliverPrinting},
    {"Test_Nothing", [](const Request&) {}},
    {"Test_OnlyCompletes", [](const Request& r) { r.complete(); }},
    {"Test_NoComplete", [](const Request& r) { r.deliver("lost"); }},
    {"Test_LateDelivery",
     [](const Request& r) { r.deliver("a"), r.complete(), r.deliver("lost"); }},
    {"Test_TwoBatches",
     [](const Request& r) { r.deliver("lost"), r.complete(), r.deliver("b"), r.complete(); }},
    {"Test_ThrowsCim",
     [](const Request& r) {
       r.deliver("lost");
       throw CIMException(CIM_ERR_ACCESS_DENIED, "not for you");
     }},
    {"Test_ThrowsSuccess", [](const Request&) { throw CIMException(CIM_ERR_SUCCESS, "odd"); }},
    {"Test_ThrowsNotSupported",
     [](const Request& r) {
       r.deliver("lost"), r.complete();
       throw CIMException(CIM_ERR_NOT_SUPPORTED, "no");
     }},
    {"Test_ThrowsPegasus", [](const Request&) { throw InvalidNameException("1x"); }},
    {"Test_ThrowsStd", [](const Request&) { throw std::runtime_error("std \xff"); }},
    {"Test_ThrowsInt", [](const Request&) { throw 42; }},
    {"Test_Uninitialized", [](const Request& r) { r.handler.deliver(CIMInstance()); }},
    {"Test_Many", [](const Request& r) { r.deliverNumbered(2500), r.complete(); }},
    {"Test_ManyNoComplete", [](const Request& r) { r.deliverNumbered(1500); }},
    {"Test_ManyThrows",
     [](const Request& r) {
       r.deliverNumbered(1500);
       throw CIMException(CIM_ERR_FAILED, "in the middle");
     }},
    {"Test_Swallows", deliverSwallowing},
    {"Test_ServerDisks", deliverWhatTheServerHas},
    {"Test_Nested", askForItself},
    {"Test_NoNamespace", deliverWithoutNamespace},
    {"Test_EchoPath", [](const Request& r) { r.deliver(utf8(r.path.toString())), r.complete(); }},
};

class TestProvider final : public CIMInstanceProvider {
 public:
  explicit TestProvider(const std::string& name) : name_(name) {}

  void initialize(CIMOMHandle& handle) override {
    record("initialize");
    server_ = &handle;
    if (name_ == "ThrowsInInitialize") throw CIMException(CIM_ERR_FAILED, "no luck");
    if (name_ == "ThrowsIntInInitialize") throw 1;
  }

  void terminate() override {
    record("terminate");
    const bool fails = name_ == "ThrowsInTerminate";
    delete this;
    if (fails) throw std::runtime_error("stuck");
  }

  void getInstance(const OperationContext& context, const CIMObjectPath& path, const Boolean,
                   const Boolean, const CIMPropertyList&,
                   InstanceResponseHandler& handler) override {
    run(context, path, handler);
  }
  void enumerateInstances(const OperationContext& context, const CIMObjectPath& path, const Boolean,
                          const Boolean, const CIMPropertyList&,
                          InstanceResponseHandler& handler) override {
    run(context, path, handler);
  }
  void enumerateInstanceNames(const OperationContext&, const CIMObjectPath& path,
                              ObjectPathResponseHandler& handler) override {
    CIMObjectPath delivered = makeDisk(path.getClassName(), CIMNamespaceName(), "n").getPath();
    Array<CIMObjectPath> more;
    more.append(path);
    handler.deliver(delivered);
    handler.deliver(more);
    if (path.getClassName() != CIMName("Test_NoComplete")) handler.complete();
  }
  void modifyInstance(const OperationContext&, const CIMObjectPath&, const CIMInstance&,
                      const Boolean, const CIMPropertyList&, ResponseHandler&) override {}
  void createInstance(const OperationContext&, const CIMObjectPath&, const CIMInstance&,
                      ObjectPathResponseHandler&) override {}
  void deleteInstance(const OperationContext&, const CIMObjectPath&, ResponseHandler&) override {}

 private:
  void run(const OperationContext& context, const CIMObjectPath& path,
           InstanceResponseHandler& handler) {
    kBehaviours.at(utf8(path.getClassName().getString()))({context, path, handler, *server_});
  }

  std::string name_;
  CIMOMHandle* server_ = nullptr;
};

class BareProvider final : public CIMProvider {
 public:
  void initialize(CIMOMHandle&) override {}
  void terminate() override { delete this; }
};

}  // namespace

extern "C" PEGASUS_EXPORT CIMProvider* PegasusCreateProvider(const String& providerName) {
  const std::string name = utf8(providerName);
  record("create");
  if (name == "Bare") return new BareProvider;
  if (name == "ThrowsInCreate") throw std::runtime_error("no memory for you");
  return name == "Unknown" ? nullptr : new TestProvider(name);
}
