// A provider that behaves as its provider name and the class asked for tell, mostly badly.

#include <Pegasus/Provider/CIMAssociationProvider.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>
#include <Pegasus/Provider/CIMMethodProvider.h>

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <map>
#include <stdexcept>
#include <string>

using namespace Pegasus;

namespace {

// The only traces that outlive the library: the environment, and a file for other processes.
void record(const std::string& event) {
  if (const char* file = std::getenv("TEST_PROVIDER_TRACE")) {
    std::ofstream(file, std::ios::app) << event << std::endl;
  }
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

void waitForGo(const Request& request) {
  record("waiting");
  const char* file = std::getenv("TEST_PROVIDER_GO");
  while (file != nullptr && !std::ifstream(file)) usleep(10000);
  request.deliver("waited");
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

void deliverUser(const Request& request) {
  const IdentityContainer identity(request.context.get(IdentityContainer::NAME));
  request.deliver(utf8(identity.getUserName()));
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

// What Test_Memory was last modified to.
CIMInstance& remembered() {
  static CIMInstance instance;
  return instance;
}

const std::map<std::string, Behaviour> kBehaviours = {
    {"Test_Memory", [](const Request& r) { r.handler.deliver(remembered()), r.complete(); }},
    {"Test_Disk", [](const Request& r) { r.deliver("a"), r.deliver("b"), r.complete(); }},
    {"Test_BigDisk", [](const Request& r) { r.deliver("big"), r.complete(); }},
    {"Test_Array", deliverArray},
    {"Test_Prints", deliverPrinting},
    {"Test_Waits", waitForGo},
    {"Test_User", deliverUser},
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
    {"Test_ThrowsOddCode", [](const Request&) { throw CIMException(CIMStatusCode(246), "odd"); }},
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

// What `name` says in its end.
void throwAs(const std::string& name) {
  const auto endsWith = [&name](const std::string& end) {
    return name.size() >= end.size() &&
           name.compare(name.size() - end.size(), end.size(), end) == 0;
  };
  if (endsWith("ThrowsCim")) throw CIMException(CIM_ERR_ACCESS_DENIED, "not for you");
  if (endsWith("ThrowsNotSupported")) throw CIMException(CIM_ERR_NOT_SUPPORTED, "no");
}

CIMObject makeObject(const CIMName& className, const String& name) {
  return CIMObject(makeDisk(className, CIMNamespaceName(), name));
}

// The ends of a link, or what its association class stands for.
template <class Handler, class Make>
void follow(const std::string& association, const std::string& echo, Handler& handler, Make make) {
  if (association == "Link_Echo") {
    handler.deliver(make(CIMName("Test_Port"), echo.c_str()));
  } else {
    handler.deliver(make(CIMName("Test_Port"), (association + " 1").c_str()));
    handler.deliver(make(CIMName("Test_FastPort"), (association + " 2").c_str()));
  }
  throwAs(association);
  if (association != "Link_NoComplete") handler.complete();
}

class TestProvider final : public CIMInstanceProvider,
                           public CIMAssociationProvider,
                           public CIMMethodProvider {
 public:
  explicit TestProvider(const std::string& name) : name_(name) {}

  void initialize(CIMOMHandle& handle) override {
    record("initialize");
    server_ = &handle;
    const char* file = std::getenv("TEST_PROVIDER_FAILS_ONCE");
    const bool fails = file != nullptr && std::remove(file) == 0;
    if (fails || name_ == "ThrowsInInitialize") throw CIMException(CIM_ERR_FAILED, "no luck");
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
  void modifyInstance(const OperationContext&, const CIMObjectPath& path,
                      const CIMInstance& instance, const Boolean includeQualifiers,
                      const CIMPropertyList& list, ResponseHandler& handler) override {
    throwAs(utf8(path.getClassName().getString()));
    if (path.getClassName() == CIMName("Test_Nothing")) return;
    if (path.getClassName() == CIMName("Test_EchoPath")) {
      record(utf8(path.toString()) + " " + utf8(instance.getPath().toString()) + " " +
             std::to_string(instance.getPropertyCount()) + (includeQualifiers ? " q " : " ") +
             utf8(list.toString()));
    }
    if (path.getClassName() == CIMName("Test_Memory")) remembered() = instance.clone();
    handler.processing();
    handler.complete();
  }
  void createInstance(const OperationContext&, const CIMObjectPath& path, const CIMInstance&,
                      ObjectPathResponseHandler& handler) override {
    throwAs(utf8(path.getClassName().getString()));
    if (path.getClassName() != CIMName("Test_OnlyCompletes")) {
      handler.deliver(makeDisk(path.getClassName(), CIMNamespaceName(), "new").getPath());
    }
    handler.complete();
  }
  void deleteInstance(const OperationContext&, const CIMObjectPath& path,
                      ResponseHandler& handler) override {
    throwAs(utf8(path.getClassName().getString()));
    handler.complete();
  }

  void associators(const OperationContext&, const CIMObjectPath& path, const CIMName& association,
                   const CIMName& result, const String& role, const String& resultRole,
                   const Boolean, const Boolean, const CIMPropertyList&,
                   ObjectResponseHandler& handler) override {
    const std::string name = utf8(association.getString());
    if (name == "Link_Class") handler.deliver(CIMObject(CIMClass(CIMName("Test_Port"))));
    follow(name, echoOf(path, association, result, role, resultRole), handler, makeObject);
  }
  void associatorNames(const OperationContext&, const CIMObjectPath& path,
                       const CIMName& association, const CIMName& result, const String& role,
                       const String& resultRole, ObjectPathResponseHandler& handler) override {
    follow(utf8(association.getString()), echoOf(path, association, result, role, resultRole),
           handler, makePath);
  }
  void references(const OperationContext&, const CIMObjectPath& path, const CIMName& result,
                  const String& role, const Boolean, const Boolean, const CIMPropertyList&,
                  ObjectResponseHandler& handler) override {
    throwAs(utf8(result.getString()));
    handler.deliver(makeObject(result, echoOf(path, result, CIMName(), role, String()).c_str()));
    handler.complete();
  }
  void referenceNames(const OperationContext&, const CIMObjectPath&, const CIMName& result,
                      const String&, ObjectPathResponseHandler& handler) override {
    throwAs(utf8(result.getString()));
    handler.deliver(makePath(result, "link"));
    handler.deliver(makePath(CIMName("Test_Port"), "odd"));
    handler.complete();
  }

  void invokeMethod(const OperationContext&, const CIMObjectPath& path, const CIMName& methodName,
                    const Array<CIMParamValue>& parameters,
                    MethodResultResponseHandler& handler) override {
    const std::string name = utf8(methodName.getString());
    if (name == "Nothing") return;
    if (name == "Uninitialized") handler.deliverParamValue(CIMParamValue());
    if (name != "OnlyCompletes") {
      handler.deliverParamValue(parameters);
      handler.deliverParamValue(CIMParamValue("Target", CIMValue(path)));
      handler.deliver(CIMValue(Sint32(name == "Twice" ? 1 : 7)));
    }
    throwAs(name);
    if (name == "NoComplete") return;
    handler.complete();
    if (name != "Twice") return;
    handler.deliver(CIMValue(Sint32(2)));
    handler.complete();
  }

 private:
  static CIMObjectPath makePath(const CIMName& className, const String& name) {
    return makeDisk(className, CIMNamespaceName(), name).getPath();
  }
  static std::string echoOf(const CIMObjectPath& path, const CIMName& association,
                            const CIMName& result, const String& role, const String& resultRole) {
    return utf8(path.getClassName().getString()) + "|" + utf8(association.getString()) + "|" +
           utf8(result.getString()) + "|" + utf8(role) + "|" + utf8(resultRole);
  }

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
