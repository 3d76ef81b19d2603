#include "definition/DefinitionCheck.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <tuple>

#include "definition/DefinitionRegistry.h"
#include "tests/definition/Reading.h"
#include "tests/support/LogLevel.h"
#include "tests/support/StdoutCapture.h"
#include "tests/support/TemporaryTree.h"

namespace {

using definition::CheckResult;

class DefinitionCheck : public Registered {
 protected:
  TemporaryTree tree_;
  LogLevel level_{0};
};

TEST_F(DefinitionCheck, PointsAtTheUnitThatWasFound) {
  const std::string rest =
      ": the rest of the file is not read (module, then classes, then associations)";
  // Line, column and first line of the message; the source line.
  const std::tuple<std::string, std::string, std::string> cases[] = {
      {"<plugin>\n <module name='m'>\n  <class/>\n",
       "3:3 the end of module element missing before: class", "  <class/>"},
      {"<plugin><module name='m'>\r\n\t text\r\n</module>",
       "2:3 the end of module element missing before: text", "\t text"},
      {"<plugin><module name='m'><functioncall><function name='f' type='getI'/>\n"
       "<argument type='element'>\n<functioncall><function name='g'/><argument type='x'/>",
       "3:35 invalid attribute: x", "<functioncall><function name='g'/><argument type='x'/>"},
      {"<plugin><module name='m'>\n", "2:1 the end of module element missing before: ", ""},
      {"\n <?xml version='1.0'?>\n" + kModule,
       "2:2 not a definition file: it must begin with the plugin element",
       " <?xml version='1.0'?>"},
      {kModule + "\n<association></association>\n<class name='C'/></plugin>",
       "3:1 unexpected class" + rest, "<class name='C'/></plugin>"},
      {kModule + std::string(300, ' ') + "x</plugin>", "1:327 unexpected x" + rest,
       std::string(100, ' ') + "x</plugin>"},
  };
  for (const auto& [text, expected, source] : cases) {
    TemporaryTree::write("a.xml", text);
    const CheckResult result = definition::checkDefinitionFiles({"a.xml"});
    ASSERT_EQ(result.problems.size(), 1u);
    const auto& problem = result.problems[0];
    EXPECT_EQ(problem.file, "a.xml");
    EXPECT_EQ(std::to_string(problem.line) + ":" + std::to_string(problem.column) + " " +
                  problem.message.substr(0, problem.message.find('\n')),
              expected);
    EXPECT_EQ(problem.source, source);
    EXPECT_EQ(problem.caret, std::min(problem.column, 101));
  }
}

TEST_F(DefinitionCheck, ListsOrDumpsWhatTheFilesServeAndLeavesNothingBehind) {
  const std::string sample = DATA_FOLDER "/every_element.xml";
  const CheckResult result = definition::checkDefinitionFiles({"no.xml", sample});
  ASSERT_EQ(result.problems.size(), 1u);
  EXPECT_EQ(result.problems[0].file, "no.xml");
  EXPECT_EQ(result.problems[0].line, 0);
  EXPECT_EQ(result.problems[0].message, "No such file or directory");
  std::string served;
  for (const auto& one : result.served) {
    served += one.nameSpace + ":" + one.className + (one.association ? " association" : "") +
              (one.hasMethods ? " methods" : "") + "\n";
  }
  EXPECT_EQ(served,
            "root/sample:Sample_Disk methods\nroot/sample:Sample_Part\n"
            "root/sample:Sample_DiskPart association\n");
  EXPECT_TRUE(registeredClasses().empty());
  EXPECT_EQ(getModule("sample"), nullptr);
  EXPECT_EQ(functionCount(), 0u);

  StdoutCapture out;
  EXPECT_EQ(definition::dumpDefinitionFiles({sample, "no.xml"}).size(), 1u);
  EXPECT_EQ(out.text(), TemporaryTree::read(DATA_FOLDER "/every_element.dump"));
  EXPECT_EQ(getModule("sample"), nullptr);
  EXPECT_EQ(functionCount(), 0u);
}

}  // namespace
