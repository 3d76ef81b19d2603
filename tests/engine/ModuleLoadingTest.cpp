#include "engine/ProviderDefModule.h"

#include "tests/engine/PluginTest.h"
#include "tests/support/LogLevel.h"

#include <gmock/gmock.h>

class ModuleLoading : public PluginTest {
 protected:
  static int number(const std::string& module, const std::string& name) {
    return function(module, name, "getI").get().getIntValue();
  }
  static std::string history() {
    return function("lifecycle", "getHistory", "getS").get().getStringValue();
  }
};

TEST_F(ModuleLoading, TakesAFullPathAsItIs) {
  tree_.addPlugin("other", pluginFile("lifecycle"));
  std::filesystem::copy(pluginFile("lifecycle"), "own.so");
  for (const std::string& path : {pluginFile("lifecycle"), std::string("../lib/libother.so"),
                                  std::string("./own.so"), std::string("libc.so.6")}) {
    ProviderDefModule full(path, false);
    EXPECT_EQ(full.getPath(), 0);
    EXPECT_NE(full.getFunction(path == "libc.so.6" ? "getpid" : "twice"), nullptr) << path;
  }
}

TEST_F(ModuleLoading, FailsWithTheNameOfTheModule) {
  TemporaryTree::write(tree_.lib() / "libtext.so", "no library");
  std::filesystem::create_directory(tree_.lib() / "libfolder.so");
  for (const std::string& name :
       {std::string("missing"), std::string("broken"), std::string("text"), std::string("folder"),
        std::string(""), std::string("%n%s"), std::string(100000, 'x')}) {
    ProviderDefModule shortPath(name, true);
    EXPECT_EQ(errorOf([&] { shortPath.getFunction("f"); }), "Couldn't load module " + name);
  }
  ProviderDefModule fullPath("twice", false);
  EXPECT_EQ(errorOf([&] { fullPath.getFunction("f"); }), "Couldn't load module twice");
  // Not the program itself, which the loader would give for an empty path.
  ProviderDefModule empty("", false);
  EXPECT_EQ(errorOf([&] { empty.getFunction("getpid"); }), "Couldn't load module ");
}

TEST_F(ModuleLoading, AFailedLoadIsTriedAgain) {
  setInit("late", callText("late", "start", "getI"));
  ProviderDefFunction& starts = function("late", "getStarts", "getI");
  for (int i = 0; i < 2; ++i) {
    EXPECT_EQ(errorOf([&] { starts.get(); }), "Couldn't load module late");
  }
  tree_.addPlugin("late", pluginFile("lifecycle"));
  EXPECT_EQ(starts.get().getIntValue(), 1);
}

TEST_F(ModuleLoading, FailsWithTheNameOfTheFunction) {
  for (const char* name : {"missing", "nullSymbol", "FILL", "", "%n%s"}) {
    ProviderDefFunction& missing = function("misbehaving", name, "getI");
    EXPECT_EQ(errorOf([&] { missing.get(); }), std::string("Couldn't load function ") + name);
    EXPECT_EQ(errorOf([&] { missing.set(1); }), std::string("Couldn't load function ") + name);
  }
  EXPECT_TRUE(isOpen("misbehaving"));
}

TEST_F(ModuleLoading, RunsTheInitCallOnceBeforeAnythingElse) {
  const std::string prepare = callText("lifecycle", "prepare", "getI");
  const std::tuple<const char*, const char*, std::string, std::string> cases[] = {
      {"start", "getI", "", "s"},
      // A get call for index 0, that may use its own module.
      {"startWith", "getIi", "<argument type=\"index\"/>", "0s"},
      {"startWith", "getIi", "<argument type=\"element\">" + prepare + "</argument>", "p7s"},
      {"start", "execA", "", ""},
  };
  for (const auto& [name, type, arguments, expected] : cases) {
    setInit("lifecycle", callText("lifecycle", name, type, arguments));
    EXPECT_EQ(history(), expected);
    EXPECT_EQ(number("lifecycle", "prepare"), 7);
    EXPECT_EQ(history(), expected + "p");
    release();
  }
}

TEST_F(ModuleLoading, AFailedInitCallFailsTheFirstUseOnly) {
  setInit("lifecycle", callText("lifecycle", "missing", "getI"));
  EXPECT_EQ(errorOf([] { number("lifecycle", "getStarts"); }), "Couldn't load function missing");
  EXPECT_EQ(number("lifecycle", "getStarts"), 0);
}

TEST_F(ModuleLoading, ExecCIsNeverLoadedYetWorks) {
  ProviderDefFunction& twice = function("lifecycle", "twiceList", "execC");
  ProviderDefFunction& getter = function("lifecycle", "getFactor", "getI");
  Values outputs;
  for (int i = 0; i < 2; ++i) {
    EXPECT_EQ(twice.loadFunction(), 1);
    EXPECT_EQ(getter.loadFunction(), 0);
    EXPECT_EQ(twice.exec(Values{3}, outputs), 0);
  }
  EXPECT_EQ(valueText(outputs), "0 0; 0 0; ");
}

TEST_F(ModuleLoading, UnknownTypeLoadsNothingAndIsNotSupported) {
  ProviderDefFunction& unknown = function("missing", "f", "getX");
  Values outputs;
  EXPECT_EQ(unknown.loadFunction(), 0);
  EXPECT_EQ(unknown.set(1), 0);
  EXPECT_EQ(valueText(unknown.get()), "0 0");
  EXPECT_EQ(unknown.exec(1, Values{1}, outputs), 99);
}

TEST_F(ModuleLoading, ACopyKeepsTheLibraryOpen) {
  auto original = std::make_unique<ProviderDefModule>("lifecycle", true);
  original->getFunction("start");
  auto copy = std::make_unique<ProviderDefModule>(*original);
  original.reset();
  EXPECT_TRUE(isOpen("lifecycle"));
  EXPECT_NE(copy->getFunction("twice"), nullptr);
  copy.reset();
  EXPECT_FALSE(isOpen("lifecycle"));
}

TEST_F(ModuleLoading, LogsItsSteps) {
  const LogLevel level(7);
  setInit("lifecycle", callText("lifecycle", "start", "getI"));
  std::filesystem::remove(tree_.logs() / "CommonProvider.log");
  module("lifecycle").getFunction("twice");
  errorOf([] { module("none").getFunction("f"); });
  EXPECT_THAT(
      tree_.log(),
      testing::MatchesRegex(
          "ProviderDefModule::getFunction\\(std::string twice\\)\nLoading lifecycle\n"
          "lifecycle loaded: [0-9a-f]+\nCalling init: [0-9a-f]+\n"
          "ProviderDefFunctionCall::init\\(void\\)\n"
          "ProviderDefFunctionCall::getValue\\(int index\\) : no argument\n"
          "ProviderDefFunction::get\\(void\\) Type:100\n"
          "ProviderDefModule::getFunction\\(std::string start\\)\n"
          "Loading start : [0-9a-f]+\nstart loaded\nLoading twice : [0-9a-f]+\ntwice loaded\n"
          "ProviderDefModule::getFunction\\(std::string f\\)\nLoading none\n"
          "Loading none: [^\n]*libnone\\.so: cannot open [^\n]*\n"));
}
