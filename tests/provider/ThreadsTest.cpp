// Operations from two threads at once on one provider.

#include <atomic>
#include <thread>

#include "LinkTest.h"

namespace {

/// Three items with a number that clients set and a method, over a plug-in that nobody has opened.
class AllOperations : public LinkTest {
 protected:
  void SetUp() override {
    host.add(makeClass(
        "T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes), declared("Number", CIMTYPE_SINT32)},
        {method("Twice", true,
                {parameter("Number", CIMTYPE_SINT32, "I"),
                 parameter("Position", CIMTYPE_SINT32, "iO")})}));
    host.add(makeClass("T_Link", {declared("Part", CIMTYPE_REFERENCE, Key::kYes),
                                  declared("Item", CIMTYPE_REFERENCE, Key::kYes)}));
    tree.addPlugin("threads", THREADS_PLUGIN);
    const std::string number =
        property("Number", call("threads_get", "getIi"), call("threads_set", "setIi"));
    const std::string twice = "<method name=\"Twice\">" +
                              call("threads_twice", "execCi",
                                   "<argument type=\"index\"/><argument type=\"input\"/>"
                                   "<argument type=\"output\"/>") +
                              "</method>";
    TemporaryTree::write(
        tree.run() / "threads.xml",
        "<plugin><module name=\"threads\" path=\"short\">" + call("threads_init", "getI", "") +
            "</module>" +
            definedClass("T_Item", constant("int", "3"),
                         property("Name", constant("indexstring", "item")) + number + twice) +
            association("T_Link", pairOf("T_Item", "Name", "T_Item", "Name")) + "</plugin>");
    start("");
  }

  // Every operation once; what it gave, and how much where other threads change the numbers.
  std::vector<std::string> runAll(int number) {
    const char* const item = "root/t:T_Item.Name=\"item 2\"";
    std::vector<std::string> all;
    const auto add = [&all](const std::vector<std::string>& events) {
      all.insert(all.end(), events.begin(), events.end());
    };
    add(instanceNames("root/t:T_Item").events);
    add(instanceNames("root/t:T_Link").events);
    add(modify(item, {{"Number", Sint32(number)}}));
    add(invoke(item, "Twice", {{"Number", Sint32(number)}}));
    add(associatorNames(item));
    add({std::to_string(enumerate("root/t:T_Item").events.size() + get(pathOf(item)).events.size() +
                        associators(item).size())});
    RecordingHandler handler;
    EXPECT_THROW(provider->deleteInstance(context, pathOf(item), handler), CIMException);
    return all;
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
