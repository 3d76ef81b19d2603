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

// What `name` says.
void throwAs(const std::string& name) {
  const auto says = [&name](const char* word) { return name.find(word) != std::string::npos; };
  if (says("ThrowsCim")) throw CIMException(CIM_ERR_ACCESS_DENIED, "not for you");
  if (says("ThrowsNotSupported")) throw CIMException(CIM_ERR_NOT_SUPPORTED, "no");
  if (says("ThrowsSuccess")) throw CIMException(CIM_ERR_SUCCESS, "odd");
  if (says("ThrowsOddCode")) throw CIMException(CIMStatusCode(246), "odd");
  if (says("ThrowsPegasus")) throw InvalidNameException("1x");
  if (says("ThrowsStd")) throw std::runtime_error("std \xff");
  if (says("ThrowsInt")) throw 42;
  if (says("ManyThrows")) throw CIMException(CIM_ERR_FAILED, "in the middle");
}

struct Request {
  const OperationContext& context;
  const CIMObjectPath& path;
  InstanceResponseHandler& handler;
  CIMOMHandle& server;

  CIMInstance make(const std::string& name) const {
    return makeDisk(path.getClassName(), path.getNameSpace(), String(name.c_str()));
  }
  Array<CIMInstance> enumerate(const CIMName& className) const {
    return server.enumerateInstances(context, path.getNameSpace(), className, true, false, true,
                                     true, CIMPropertyList());
  }
  void deliver(const std::string& name) const { handler.deliver(make(name)); }
  void deliverNumbered(int count) const {
    for (int i = 0; i < count; ++i) deliver(std::to_string(i));
  }
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
}

void deliverWhatTheServerHas(const Request& request) {
  const Array<CIMInstance> disks = request.enumerate("Test_Disk");
  for (Uint32 i = 0; i < disks.size(); ++i) {
    request.deliver("seen " + utf8(disks[i].getPath().toString()));
  }
}

void waitForGo(const Request& request) {
  record("waiting");
  const char* file = std::getenv("TEST_PROVIDER_GO");
  while (file != nullptr && !std::ifstream(file)) usleep(10000);
  request.deliver("waited");
}

void deliverUser(const Request& request) {
  const IdentityContainer identity(request.context.get(IdentityContainer::NAME));
  request.deliver(utf8(identity.getUserName()));
}

void deliverArray(const Request& request) {
  Array<CIMInstance> instances;
  for (const char* name : {"x", "y"}) instances.append(request.make(name));
  request.handler.deliver(instances);
}

// What Test_Memory was last modified to.
CIMInstance& remembered() {
  static CIMInstance instance;
  return instance;
}

// Before the provider completes; classes that are not here deliver something and throw as their
// names say.
const std::map<std::string, Behaviour> kBehaviours = {
    {"Test_Memory", [](const Request& r) { r.handler.deliver(remembered()); }},
    {"Test_Disk", [](const Request& r) { r.deliver("a"), r.deliver("b"); }},
    {"Test_BigDisk", [](const Request& r) { r.deliver("big"); }},
    {"Test_Array", deliverArray},
    {"Test_Prints", [](const Request& r) { std::puts("noise"), r.deliver("quiet"); }},
    {"Test_Waits", waitForGo},
    {"Test_User", deliverUser},
    {"Test_Nothing", [](const Request&) {}},
    {"Test_OnlyCompletes", [](const Request&) {}},
    {"Test_LateDelivery", [](const Request& r) { r.deliver("a"); }},
    {"Test_TwoBatches",
     [](const Request& r) { r.deliver("lost"), r.handler.complete(), r.deliver("b"); }},
    {"Test_ThrowsNotSupported", [](const Request& r) { r.deliver("lost"), r.handler.complete(); }},
    {"Test_Uninitialized", [](const Request& r) { r.handler.deliver(CIMInstance()); }},
    {"Test_Many", [](const Request& r) { r.deliverNumbered(2500); }},
    {"Test_ManyNoComplete", [](const Request& r) { r.deliverNumbered(1500); }},
    {"Test_ManyThrows", [](const Request& r) { r.deliverNumbered(1500); }},
    {"Test_Swallows", deliverSwallowing},
    {"Test_ServerDisks", deliverWhatTheServerHas},
    {"Test_Nested", [](const Request& r) { record("nested"), r.enumerate(r.path.getClassName()); }},
    {"Test_NoNamespace",
     [](const Request& r) {
       r.handler.deliver(makeDisk(r.path.getClassName(), CIMNamespaceName(), "plain"));
     }},
    {"Test_EchoPath", [](const Request& r) { r.deliver(utf8(r.path.toString())); }},
};

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
    const std::string name = utf8(path.getClassName().getString());
    const Request request{context, path, handler, *server_};
    const auto found = kBehaviours.find(name);
    found == kBehaviours.end() ? request.deliver("lost") : found->second(request);
    throwAs(name);
    if (name == "Test_Nothing" || name == "Test_NoComplete" || name == "Test_ManyNoComplete")
      return;
    handler.complete();
    if (name == "Test_LateDelivery") request.deliver("lost");
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
