// Operations from two threads at once on one provider.

#include <atomic>
#include <thread>

#include "LinkTest.h"

using namespace Pegasus;

namespace {

/// Three items with a number that clients set and a method, over a plug-in that nobody has opened.
class AllOperations : public LinkTest {
 protected:
  void SetUp() override {
    CIMMethod twice(CIMName("Twice"), CIMTYPE_SINT32);
    twice.addQualifier(CIMQualifier(CIMName("Static"), CIMValue(true)));
    CIMParameter number(CIMName("Number"), CIMTYPE_SINT32);
    number.addQualifier(CIMQualifier(CIMName("In"), CIMValue(true)));
    twice.addParameter(number);
    CIMParameter position(CIMName("Position"), CIMTYPE_SINT32);
    position.addQualifier(CIMQualifier(CIMName("In"), CIMValue(false)));
    position.addQualifier(CIMQualifier(CIMName("Out"), CIMValue(true)));
    twice.addParameter(position);
    CIMClass item = makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes),
                                         declared("Number", CIMTYPE_SINT32)});
    item.addMethod(twice);
    host.add(item);
    host.add(makeClass("T_Link", {declared("Part", CIMTYPE_REFERENCE, Key::kYes),
                                  declared("Item", CIMTYPE_REFERENCE, Key::kYes)}));
    tree.addPlugin("threads", THREADS_PLUGIN);
    TemporaryTree::write(
        tree.run() / "threads.xml",
        "<plugin><module name=\"threads\" path=\"short\">" + call("threads_init", "getI", "") +
            "</module>" +
            definedClass(
                "T_Item", call("threads_count", "getI", ""),
                property("Name", call("threads_name", "getSi")) +
                    property("Number", call("threads_get", "getIi"), call("threads_set", "setIi")) +
                    "<method name=\"Twice\">" +
                    call("threads_twice", "execCi",
                         "<argument type=\"index\"/><argument type=\"input\"/>"
                         "<argument type=\"output\"/>") +
                    "</method>") +
            association("T_Link", pairOf("T_Item", "Name", "T_Item", "Name")) + "</plugin>");
    start("");
  }

  // Every operation once; what it gave, numbers that other threads change apart.
  std::vector<std::string> runAll(int number) {
    RecordingHandler handler;
    const CIMObjectPath item = pathOf("root/t:T_Item.Name=\"item 2\"");
    for (const char* name : {"root/t:T_Item", "root/t:T_Link"}) {
      provider->enumerateInstanceNames(context, pathOf(name), handler);
    }
    CIMInstance changed(CIMName("T_Item"));
    changed.addProperty(CIMProperty(CIMName("Number"), CIMValue(Sint32(number))));
    provider->modifyInstance(context, item, changed, true, CIMPropertyList(), handler);
    Array<CIMParamValue> inputs;
    inputs.append(CIMParamValue(String("Number"), CIMValue(Sint32(number))));
    provider->invokeMethod(context, item, CIMName("Twice"), inputs, handler);
    provider->associatorNames(context, item, CIMName(), CIMName(), String(), String(), handler);
    RecordingHandler changing;
    provider->enumerateInstances(context, pathOf("root/t:T_Item"), true, true, CIMPropertyList(),
                                 changing);
    provider->getInstance(context, item, true, true, CIMPropertyList(), changing);
    provider->associators(context, item, CIMName(), CIMName(), String(), String(), true, true,
                          CIMPropertyList(), changing);
    handler.events.push_back(std::to_string(changing.events.size()));
    EXPECT_THROW(provider->deleteInstance(context, item, handler), CIMException);
    return handler.events;
  }
};

TEST_F(AllOperations, OpenThePluginOnceAndDoNotDisturbEachOther) {
  StdoutCapture traces;
  ASSERT_EQ(dlopen(THREADS_PLUGIN, RTLD_NOW | RTLD_NOLOAD), nullptr);
  std::atomic<int> waiting{2};
  const auto work = [&](int number) {
    --waiting;
    while (waiting.load() != 0) std::this_thread::yield();
    for (int i = 0; i < 20; ++i) {
      EXPECT_THAT(
          runAll(number),
          ElementsAre("processing", "root/t:T_Item.Name=\"item 0\"",
                      "root/t:T_Item.Name=\"item 1\"", "root/t:T_Item.Name=\"item 2\"", "complete",
                      "processing", HasSubstr("item 0"), HasSubstr("item 1"), HasSubstr("item 2"),
                      "complete", "processing", "complete", "processing", "out Position=(sint32 2)",
                      "returns sint32 " + std::to_string(2 * number), "complete", "processing",
                      "root/t:T_Item.Name=\"item 2\"", "complete", "11"));
    }
  };
  std::thread other(work, 7);
  work(5);
  other.join();
  void* library = dlopen(THREADS_PLUGIN, RTLD_NOW | RTLD_NOLOAD);
  ASSERT_NE(library, nullptr);
  EXPECT_EQ(reinterpret_cast<int (*)()>(dlsym(library, "threads_inits"))(), 1);
  dlclose(library);
}

}  // namespace
