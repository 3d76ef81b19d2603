// Entry point, start and stop of the provider, and the operations that it refuses.

#include "ProviderTest.h"
#include "engine/Registry.h"

namespace {

TEST(EntryPoint, KnowsOneNameInAnyLetterCase) {
  for (const char* name : {"CommonProvider", "commonprovider", "COMMONPROVIDER"}) {
    CIMProvider* provider = PegasusCreateProvider(String(name));
    EXPECT_NE(dynamic_cast<CIMInstanceProvider*>(provider), nullptr) << name;
    EXPECT_NE(dynamic_cast<CIMAssociationProvider*>(provider), nullptr) << name;
    EXPECT_NE(dynamic_cast<CIMMethodProvider*>(provider), nullptr) << name;
    CIMProvider* second = PegasusCreateProvider(String(name));
    EXPECT_NE(provider, second);
    delete provider;
    delete second;
  }
  for (const char* name : {"", "CommonProvide", "CommonProvider ", "CommonProvider2"}) {
    EXPECT_EQ(PegasusCreateProvider(String(name)), nullptr) << name;
  }
}

class Lifecycle : public ProviderTest {
 protected:
  // Only the provider opens the plug-in.
  void SetUp() override {
    dlclose(plugin);
    plugin = nullptr;
  }

  static bool pluginIsOpen() {
    void* found = dlopen(PROVIDER_TEST_PLUGIN, RTLD_NOW | RTLD_NOLOAD);
    if (found != nullptr) dlclose(found);
    return found != nullptr;
  }
};

TEST_F(Lifecycle, ReadsEveryEntryWithXmlAnywhereInItsName) {
  const std::pair<const char*, bool> kFiles[] = {
      {"a.xml", true}, {"old.xml.bak", true}, {"defs2.xml~", true}, {"x.xmlold", true},
      {".xml", true},  {"A.XML", false},      {"axml", false},      {"b.xm", false}};
  int number = 0;
  for (const auto& [name, isRead] : kFiles) {
    TemporaryTree::write(
        tree.run() / name,
        definitionFile(definedClass("T_" + std::to_string(number++), constant("int", "0"), "")));
  }
  std::filesystem::create_directory(tree.run() / "folder.xml");
  start("");
  number = 0;
  for (const auto& [name, isRead] : kFiles) {
    EXPECT_EQ(getProviderDefClass("T_" + std::to_string(number++)) != nullptr, isRead) << name;
  }
}

TEST_F(Lifecycle, TerminateClosesLibrariesAndASecondLifeStartsAnew) {
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
  host.add(makeClass("T_Other", {}));
  for (const std::string name : {"T_Item", "T_Other"}) {
    start(definedClass(name, call("leftCount", "getI", ""),
                       property("Name", constant("indexstring", "n"))) +
          "<association name=\"T_Link\" propertyname1=\"A\" propertyname2=\"B\"><classname "
          "name=\"T_Item\"></classname><classname name=\"T_Other\"></classname>"
          "<condition><true/></condition></association>");
    EXPECT_FALSE(pluginIsOpen()) << "opened before it is needed";
    // A library that is opened anew starts with its own initial values.
    EXPECT_THAT(enumerate(("root/t:" + name).c_str()).events,
                ElementsAre("processing", "complete"));
    EXPECT_TRUE(pluginIsOpen());
    EXPECT_NE(getProviderDefAssociation("T_Link"), nullptr);
    stop();
    EXPECT_FALSE(pluginIsOpen());
    EXPECT_EQ(getProviderDefClass(name), nullptr);
    EXPECT_EQ(getProviderDefAssociation("T_Link"), nullptr);
    EXPECT_EQ(getModule("test"), nullptr);
    EXPECT_EQ(functionCount(), 0u);
  }
}

using Refused = ProviderTest;

TEST_F(Refused, CreationDeletionAndReferencesWithOneText) {
  start(itemClass());
  const CIMObjectPath path = pathOf("root/t:T_Item.Name=\"a\"");
  RecordingHandler handler;
  const std::string text = "CommonProvider::deleteInstance";
  const CIMInstance item(CIMName("T_Item"));
  EXPECT_EQ(refusal([&] { provider->createInstance(context, path, item, handler); }), text);
  EXPECT_EQ(refusal([&] { provider->deleteInstance(context, path, handler); }), text);
  EXPECT_EQ(refusal([&] {
              provider->references(context, path, CIMName(), String(), false, false,
                                   CIMPropertyList(), handler);
            }),
            text);
  EXPECT_EQ(refusal([&] { provider->referenceNames(context, path, CIMName(), String(), handler); }),
            text);
  EXPECT_THAT(handler.events, ElementsAre());
}

}  // namespace
