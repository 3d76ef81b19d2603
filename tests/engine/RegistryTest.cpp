#include "engine/Registry.h"

#include "tests/engine/PluginTest.h"
#include "tests/support/LogLevel.h"
#include "tests/support/StdoutCapture.h"

class Registry : public PluginTest {};

TEST_F(Registry, FindsTheFirstOfExactlyTheName) {
  ProviderDefModule* first = registerModule(std::make_unique<ProviderDefModule>("disk", true));
  registerModule(std::make_unique<ProviderDefModule>("disk", false));
  ProviderDefFunction* size =
      registerFunction(std::make_unique<ProviderDefFunction>("size", 100, first));
  registerFunction(std::make_unique<ProviderDefFunction>("size", 110, first));
  for (int i = 0; i < 100; ++i) {  // The lists move; the objects stay.
    registerModule(std::make_unique<ProviderDefModule>("m" + std::to_string(i), true));
    registerFunction(std::make_unique<ProviderDefFunction>("f" + std::to_string(i), 100, first));
  }
  EXPECT_EQ(getModule("disk"), first);
  EXPECT_EQ(getFunction("size"), size);
  EXPECT_EQ(functionCount(), 102u);
  for (const char* name : {"", "Disk", "dis", "disk ", "size"}) EXPECT_EQ(getModule(name), nullptr);
  for (const char* name : {"", "Size", "siz", "size ", "disk"}) {
    EXPECT_EQ(getFunction(name), nullptr);
  }
}

TEST_F(Registry, NotesAMissOnStandardOutputAtLevel9) {
  for (const int level : {8, 9}) {
    const LogLevel setLevel(level);
    StdoutCapture out;
    getModule("none");
    getFunction("none");
    EXPECT_EQ(out.text(), level == 9 ? "Can not find module\nCan not find a function\n" : "");
  }
  EXPECT_EQ(tree_.log(), "");
}

TEST_F(Registry, AFunctionWhoseModuleIsGoneCannotBeLoaded) {
  ProviderDefFunction orphan("size", 100, nullptr);
  EXPECT_EQ(errorOf([&] { orphan.get(); }), "Couldn't load function size");
}
