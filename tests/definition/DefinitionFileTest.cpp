#include "definition/DefinitionFile.h"

#include <gmock/gmock.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <sstream>
#include <string>
#include <tuple>
#include <vector>

#include "definition/DefinitionRegistry.h"
#include "tests/definition/Reading.h"
#include "tests/support/LogLevel.h"
#include "tests/support/StdoutCapture.h"
#include "tests/support/TemporaryTree.h"

namespace {

using testing::ElementsAre;

class DefinitionFile : public Registered {
 protected:
  // Writes and reads a file; its entries in the log.
  std::string reading(const std::string& text) {
    TemporaryTree::write("definitions.xml", text);
    return readingOf("definitions.xml");
  }

  std::string readingOf(const std::string& file) {
    std::filesystem::remove(tree_.logs() / "CommonProvider.log");
    EXPECT_EQ(readProviderDefXML(file), 0);
    return tree_.log();
  }

  static std::vector<std::string> classes() {
    std::vector<std::string> names;
    for (const auto& one : registeredClasses()) names.push_back(one.getName());
    return names;
  }

  TemporaryTree tree_;
  LogLevel level_{1};
};

// What the elements become: every_element.dump. A file read twice adds its classes only.
TEST_F(DefinitionFile, EveryElementIsRegistered) {
  for (size_t times = 1; times <= 2; ++times) {
    EXPECT_EQ(readingOf(DATA_FOLDER "/every_element.xml"), "");
    ASSERT_NE(getModule("resetter"), nullptr);
    EXPECT_EQ(getModule("resetter")->getInit()->getDefFunction(), getFunction("startReset"));
    EXPECT_EQ(functionCount(), 9u);
    EXPECT_EQ(registeredClasses().size(), 2 * times);
    EXPECT_EQ(registeredAssociations().size(), times);
    EXPECT_EQ(getProviderDefClass("SAMPLE_disk"), &registeredClasses()[0]);
    EXPECT_EQ(getProviderDefAssociation("sample_diskpart"), &registeredAssociations()[0]);
  }
}

TEST_F(DefinitionFile, AModuleNamedAgainTakesOverTheInitialisationCallItLacks) {
  const auto withInit = [](const std::string& function) {
    return "<plugin><module name='m' path='short'><functioncall><function name='" + function +
           "' type='getI'/></functioncall></module></plugin>";
  };
  reading("<plugin><module name='m'/>" + classText("A") + "</plugin>");
  const ProviderDefModule* first = getModule("m");
  EXPECT_FALSE(first->getNeedInit());
  reading(withInit("start"));
  EXPECT_EQ(getModule("m"), first);
  EXPECT_EQ(first->getPath(), 0);
  EXPECT_EQ(first->getInit()->getDefFunction(), getFunction("start"));
  EXPECT_EQ(getFunction("start")->getModule(), first);
  reading(withInit("other"));
  EXPECT_EQ(first->getInit()->getDefFunction(), getFunction("start"));
  EXPECT_EQ(getFunction("other")->getModule(), first);
}

TEST_F(DefinitionFile, TheFirstClassOfANameWins) {
  reading(kModule + classText("Foo_Bar", 1) + classText("FOO_BAR", 2));
  reading("<plugin><module name='n'/>" + classText("foo_bar", 3) + classText("Other", 4));
  EXPECT_THAT(classes(), ElementsAre("Foo_Bar", "FOO_BAR", "foo_bar", "Other"));
  EXPECT_EQ(getProviderDefClass("foo_BAR")->getNumberOfInstances(), 1);
  EXPECT_EQ(getProviderDefClass("other")->getNumberOfInstances(), 4);
  EXPECT_EQ(getProviderDefClass("Foo"), nullptr);
  EXPECT_EQ(getProviderDefClass(""), nullptr);
}

TEST_F(DefinitionFile, ASyntaxErrorKeepsWhatStoodBefore) {
  EXPECT_EQ(reading(kModule + classText("A") + classText("B") +
                    "<class name='100%n'><property name='P'/></class>" + classText("D") +
                    "<association name='E'></association></plugin>"),
            "XML syntax error: instance elememt is missing in class element before: property\n"
            "class:100%n\n\n");
  EXPECT_THAT(classes(), ElementsAre("A", "B"));
  EXPECT_NE(getModule("m"), nullptr);
  EXPECT_TRUE(registeredAssociations().empty());
  reading(kModule + classText("D"));
  EXPECT_NE(getProviderDefClass("D"), nullptr);
}

TEST_F(DefinitionFile, WhatDoesNotBelongThereEndsItSilently) {
  const std::string association = "<association name='L'></association>";
  using Names = std::vector<std::string>;
  const std::tuple<std::string, Names, size_t> cases[] = {
      {kModule + classText("A") + association + classText("B") + association, {"A"}, 1},
      {"<?xml version='1.0'?>" + kModule + classText("A"), {}, 0},
      {classText("A") + association, {"A"}, 1},
      {"<module name='m'/>" + classText("A"), {}, 0},
      {" \n<plugin a='b'>" + classText("A"), {"A"}, 0},
      {kModule + classText("A") + "and" + classText("B"), {"A"}, 0},
      {kModule + classText("A") + "</plugin><<class>junk='", {"A"}, 0},
  };
  for (const auto& [text, expected, associations] : cases) {
    EXPECT_EQ(reading(text), "");
    EXPECT_EQ(classes(), expected) << text;
    EXPECT_EQ(registeredAssociations().size(), associations) << text;
    release();
  }
}

// Without the single characters. A start tag is seen by what holds the element, then by the
// element.
TEST_F(DefinitionFile, TheTraceShowsTheElementsAsTheyAreRead) {
  const LogLevel level(9);
  StdoutCapture quiet;
  std::istringstream log(
      reading("<plugin><module name='m'><functioncall><function name='f'/></functioncall></module>"
              "<class><instances><constant type='int'>1</constant></instances>"
              "<property><get><constant type='int'>2</constant></get></property></class>"
              "<association></association>"));
  quiet.text();
  std::string trace;
  for (std::string line; std::getline(log, line);) {
    if (line.rfind("state ", 0) == 0 || line.rfind("Enter ", 0) == 0) continue;
    trace += line.substr(0, line.find(" init : ")) + "\n";
  }
  EXPECT_EQ(
      trace,
      "element plugin\nelement module\nAttribute: name=m\n"
      "ProviderDefModule Constructor\nelement module\nAttribute: name=m\nelement functioncall\n"
      "ProviderDefFunctionCall Constructor\nelement functioncall\n"
      "element function\nAttribute: name=f\n"
      "ProviderDefFunction Constructor\nelement function\nAttribute: name=f\n"
      "element functioncall\nsetting needInit=true,\nelement module\nelement class\n"
      "ProviderDefClass Constructor\nelement class\nelement instances\n"
      "element constant\nAttribute: type=int\nReading constant value\nCDATA 1\n"
      "element constant\nelement instances\nelement property\n"
      "ProviderDefProperty Constructor\nelement property\nelement get\n"
      "element constant\nAttribute: type=int\nProperty constant type : int\nCDATA 2\n"
      "element constant\nelement get\nelement property\nelement class\nelement association\n"
      "ProviderDefAssociation Constructor\nelement association\nelement association\n");
}

TEST_F(DefinitionFile, WhatCannotBeReadGivesOneLine) {
  const std::string prefix = "Couldn't read definition file ";
  EXPECT_EQ(readingOf("no%n.xml"), prefix + "no%n.xml: No such file or directory\n");
  EXPECT_EQ(readingOf("."), prefix + ".: not a regular file\n");
  EXPECT_EQ(reading(""), prefix + "definitions.xml: empty\n");
  ASSERT_EQ(mkfifo("pipe.xml", 0600), 0);
  EXPECT_EQ(readingOf("pipe.xml"), prefix + "pipe.xml: not a regular file\n");
  TemporaryTree::write("big.xml", kModule);
  ASSERT_EQ(truncate("big.xml", 65 << 20), 0);
  EXPECT_EQ(readingOf("big.xml"), prefix + "big.xml: larger than 64 MiB\n");
  EXPECT_EQ(getModule("m"), nullptr);
}

}  // namespace
