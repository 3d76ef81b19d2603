// Entry point, start and stop of the provider, and the operations that it refuses.

#include "ProviderTest.h"
#include "engine/Registry.h"

using namespace Pegasus;

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

class Lifecycle : public testing::Test {
 protected:
  Lifecycle() {
    tree.addPlugin("test", PROVIDER_TEST_PLUGIN);
    setEmbeddedHost(&host);
    handle.emplace();
  }
  ~Lifecycle() override { setEmbeddedHost(nullptr); }

  CIMInstanceProvider* start() {
    CIMProvider* created = PegasusCreateProvider(String("CommonProvider"));
    created->initialize(*handle);
    return dynamic_cast<CIMInstanceProvider*>(created);
  }

  static bool pluginIsOpen() {
    void* found = dlopen(PROVIDER_TEST_PLUGIN, RTLD_NOW | RTLD_NOLOAD);
    if (found != nullptr) dlclose(found);
    return found != nullptr;
  }

  TemporaryTree tree;
  LogLevel quiet{0};
  TestHost host;
  std::optional<CIMOMHandle> handle;
  OperationContext context;
};

TEST_F(Lifecycle, ReadsEveryEntryWithXmlAnywhereInItsName) {
  const std::pair<const char*, bool> kFiles[] = {
      {"a.xml", true}, {"old.xml.bak", true}, {"defs.xml~", true}, {"x.xmlold", true},
      {".xml", true},  {"A.XML", false},      {"axml", false},     {"b.xm", false}};
  int number = 0;
  for (const auto& [name, isRead] : kFiles) {
    TemporaryTree::write(
        tree.run() / name,
        definitionFile(definedClass("T_" + std::to_string(number++), constant("int", "0"), "")));
  }
  std::filesystem::create_directory(tree.run() / "folder.xml");
  CIMInstanceProvider* provider = start();
  number = 0;
  for (const auto& [name, isRead] : kFiles) {
    EXPECT_EQ(getProviderDefClass("T_" + std::to_string(number++)) != nullptr, isRead) << name;
  }
  provider->terminate();
}

TEST_F(Lifecycle, TerminateClosesLibrariesAndASecondLifeStartsAnew) {
  host.add(makeClass("T_Item", {declared("Name", CIMTYPE_STRING, Key::kYes)}));
  host.add(makeClass("T_Other", {}));
  for (const char* name : {"T_Item", "T_Other"}) {
    TemporaryTree::write(
        tree.run() / "defs.xml",
        definitionFile(
            definedClass(name, call("leftCount", "getI", ""),
                         property("Name", constant("indexstring", "n"))) +
            "<association name=\"T_Link\" propertyname1=\"A\" propertyname2=\"B\"><classname "
            "name=\"T_Item\"></classname><classname name=\"T_Other\"></classname>"
            "<condition><true/></condition></association>"));
    CIMInstanceProvider* provider = start();
    EXPECT_FALSE(pluginIsOpen()) << "opened before it is needed";
    RecordingHandler handler;
    provider->enumerateInstances(context,
                                 CIMObjectPath(String(), CIMNamespaceName("root/t"), CIMName(name)),
                                 false, false, CIMPropertyList(), handler);
    // A library that is opened anew starts with its own initial values.
    EXPECT_THAT(handler.events, ElementsAre("processing", "complete"));
    EXPECT_TRUE(pluginIsOpen());
    EXPECT_NE(getProviderDefAssociation("T_Link"), nullptr);
    provider->terminate();
    EXPECT_FALSE(pluginIsOpen());
    EXPECT_EQ(getProviderDefClass(name), nullptr);
    EXPECT_EQ(getProviderDefAssociation("T_Link"), nullptr);
    EXPECT_EQ(getModule("test"), nullptr);
    EXPECT_EQ(functionCount(), 0u);
  }
}

class Refused : public ProviderTest {
 protected:
  template <class Operation>
  static void expectRefusal(Operation operation) {
    try {
      operation();
      ADD_FAILURE() << "no exception";
    } catch (const CIMException& error) {
      EXPECT_EQ(error.getCode(), CIM_ERR_NOT_SUPPORTED);
      EXPECT_EQ(textOf(error.getMessage()), "CommonProvider::deleteInstance");
    }
  }
};

TEST_F(Refused, CreationDeletionAndReferencesWithOneText) {
  start(itemClass());
  const CIMObjectPath path = pathOf("root/t:T_Item.Name=\"a\"");
  RecordingHandler handler;
  expectRefusal(
      [&] { provider->createInstance(context, path, CIMInstance(CIMName("T_Item")), handler); });
  expectRefusal([&] { provider->deleteInstance(context, path, handler); });
  expectRefusal([&] {
    provider->references(context, path, CIMName(), String(), false, false, CIMPropertyList(),
                         handler);
  });
  expectRefusal([&] { provider->referenceNames(context, path, CIMName(), String(), handler); });
  EXPECT_THAT(handler.events, ElementsAre());
}

}  // namespace
