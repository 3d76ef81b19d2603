// Definition files that nobody would write: never a crash, and registries that stay usable.

#include <gmock/gmock.h>

#include <random>
#include <string>
#include <vector>

#include "definition/DefinitionRegistry.h"
#include "engine/ciEqual.h"
#include "tests/definition/Reading.h"
#include "tests/support/LogLevel.h"
#include "tests/support/TemporaryTree.h"

namespace {

using namespace std::string_literals;
using testing::StartsWith;

class HostileText : public Registered {};

const std::string kCallInArgument =
    "<functioncall><function name='f' type='getI'/><argument type='element'>";
const std::string kCallInModule = "<functioncall><function name='f'><module name='n'>";
const std::string kAssociation =
    kModule + "<association name='A'><classname name='B'/><classname name='C'/>";

TEST_F(HostileText, NestingEndsAtFiveHundredLevels) {
  const std::tuple<std::string, std::string, std::string> cases[] = {
      {"<plugin><module name='m'>", kCallInArgument, "functioncall"},
      {"<plugin><module name='m'>", kCallInModule, "functioncall"},
      {kClass + "<instances>", kCallInArgument, "functioncall"},
      {kAssociation, "<condition><and>", "condition"},
      {kAssociation, "<condition><or><condition><true/></condition>", "condition"},
      {kAssociation + "<condition><equal>", kCallInArgument, "functioncall"},
  };
  for (const auto& [before, open, innermost] : cases) {
    EXPECT_THAT(errorOfReading(before + times(100000, open)),
                StartsWith("elements are nested too deeply before: " + innermost + "\n"));
  }
}

// The deepest that is allowed, read, copied and released; then the reader starts from zero again.
TEST_F(HostileText, FiveHundredLevelsAreRead) {
  const auto conditions = [](int depth) {
    return kAssociation + times(depth - 1, "<condition><and><condition><true/></condition>") +
           "<condition><true/></condition>" + times(depth - 1, "</and></condition>") +
           "</association></plugin>";
  };
  EXPECT_NE(errorOfReading(conditions(501)), "");
  EXPECT_EQ(errorOfReading(conditions(500)), "");
  EXPECT_EQ(errorOfReading(kClass + "<instances>" + times(499, kCallInArgument) +
                           "<functioncall><function name='f'/></functioncall>" +
                           times(499, "</argument></functioncall>") + "</instances></class>"),
            "");
  const ProviderDefClass copy = registeredClasses().at(0);
  const ProviderDefAssociation association = registeredAssociations().at(0);
  release();
  EXPECT_EQ(association.getConditions().size(), 1u);
}

TEST_F(HostileText, ElementsThatDoNotNestEndAtOnce) {
  for (const char* open : {"<plugin>", "<module>", "<class>", "<instances>", "<property>", "<get>",
                           "<method>", "<association>", "<classname>", "<propertyname>", "<x>"}) {
    errorOfReading(times(100000, open));
    errorOfReading(kClassBody + times(100000, open));
    errorOfReading(kAssociation + times(100000, open));
  }
  EXPECT_TRUE(registeredClasses().empty());
}

TEST_F(HostileText, SizeAloneIsNoError) {
  const std::string long1 = times(4 << 20, "x");
  const std::string text = "<plugin" + times(1000000, " a='b'") + "><module name='" + long1 +
                           "'/><class name='C'>" + kOneInstance + "<property name='P' " + long1 +
                           "='" + long1 + "'><get><constant type='string'>" + long1 +
                           "</constant></get></property></class></plugin>";
  EXPECT_EQ(errorOfReading(text), "");
  EXPECT_NE(getModule(long1), nullptr);
  EXPECT_EQ(getProviderDefClass("C")->getProperty("P")->getValue(0).getStringValue(), long1);
}

TEST_F(HostileText, AnyByteMayStandInANameOrText) {
  const TemporaryTree tree;
  const LogLevel level(9);
  for (const std::string& name : {"a\0b"s, "\xC3\x28\xF5"s, "100%n%s%n"s}) {
    const std::string attributes = "<class name='" + name + "'>" + kOneInstance;
    const std::string call = "<functioncall><function name='" + name + "' type='" + name + "'/>";
    errorOfReading("<plugin><module name='" + name + "'>" + call + "</functioncall></module>" +
                   attributes + "<property name='" + name + "'><get><constant type='string'>" +
                   name + "</constant></get></property></class>" + attributes + name);
    EXPECT_NE(getModule(name), nullptr);
    EXPECT_NE(getFunction(name), nullptr);
    ASSERT_NE(getProviderDefClass(name), nullptr);
    EXPECT_EQ(getProviderDefClass(name)->getProperty(name)->getValue(0).getStringValue(), name);
    EXPECT_EQ(getProviderDefClass("a"), nullptr);
    // The file reader logs the message that holds the name.
    TemporaryTree::write("a.xml", attributes + name);
    EXPECT_EQ(readProviderDefXML("a.xml"), 0);
  }
}

TEST_F(HostileText, MutationsOfAGoodFileLeaveTheRegistriesConsistent) {
  const std::string good = TemporaryTree::read(DATA_FOLDER "/every_element.xml");
  ASSERT_FALSE(good.empty());
  std::vector<std::string> pieces = {"</",
                                     "<condition>",
                                     "<functioncall>",
                                     "</class>",
                                     "<module name='sample'/>",
                                     "<class name='Sample_disk'>"};
  // Each of these characters and the NUL behind them.
  for (const char one : "<>/'\"= \xFF") pieces.emplace_back(1, one);
  std::mt19937 random(20240501);
  const auto below = [&random](size_t end) { return random() % end; };
  int errors = 0;
  for (int i = 0; i < 20000; ++i) {
    std::string text = good;
    for (size_t changes = 1 + below(4); changes > 0; --changes) {
      const size_t at = below(text.size()), kind = below(4);
      if (kind == 0) text[at] = static_cast<char>(random());
      if (kind == 1) text.erase(at, 1 + below(40));
      if (kind == 2) text.insert(at, pieces[below(pieces.size())]);
      if (kind == 3) text.insert(at, good.substr(below(good.size()), below(200)));
    }
    errors += errorOfReading(text).empty() ? 0 : 1;
    for (const ProviderDefClass& one : registeredClasses()) {
      const ProviderDefClass* found = getProviderDefClass(one.getName());
      ASSERT_TRUE(found != nullptr && ci_equal(found->getName(), one.getName())) << text;
    }
    for (const char* name : {"startUp", "diskCount", "resetDisk", "linkedParts", "partName"}) {
      const ProviderDefFunction* function = getFunction(name);
      if (function == nullptr || function->getModule() == nullptr) continue;
      ASSERT_EQ(getModule(function->getModule()->getName()), function->getModule()) << text;
    }
    if (i % 5 == 0) release();
  }
  // Most changes must have been noticed, else this tests nothing; some must have gone through.
  EXPECT_GT(errors, 5000);
  EXPECT_LT(errors, 19500);
  release();
  EXPECT_EQ(getProviderDefClass("Sample_Disk"), nullptr);
  EXPECT_EQ(errorOfReading(good), "");
  EXPECT_EQ(getProviderDefClass("Sample_Disk"), &registeredClasses()[0]);
  EXPECT_EQ(getFunction("partName")->getModule(), getModule("/opt/sample/libparts.so"));
}

}  // namespace
