// The commands of the walkthrough in docs/plugins.md, run as they are printed there.

#include <gmock/gmock.h>

#include <iterator>
#include <regex>

#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

namespace {

// The lines of its code blocks that are commands, in order.
std::string commands() {
  std::ifstream file(std::string(PROJECT_FOLDER) + "/docs/plugins.md");
  std::string result;
  bool inBlock = false;
  bool inSection = false;
  for (std::string line; std::getline(file, line);) {
    if (line.rfind("## ", 0) == 0)
      inSection = line == "## A plug-in from nothing to a served class";
    if (line.rfind("```", 0) == 0) inBlock = !inBlock;
    static const std::regex command("(cc|cimhost|cp|mkdir|mv) .*");
    if (inSection && inBlock && std::regex_match(line, command)) result += line + "\n";
  }
  return result;
}

TEST(Walkthrough, ServesTheClassAndItsMethod) {
  const TemporaryTree tree;  // The working directory stands for the root of the source tree.
  for (const char* folder : {"examples", "plugin-sdk"}) {
    std::filesystem::create_directory_symlink(std::string(PROJECT_FOLDER) + "/" + folder, folder);
  }
  const std::string script = "set -e\ncc() { " C_COMPILER " \"$@\"; }\ncimhost() { " CIMHOST
                             " \"$@\"; }\n" +
                             commands() + "cimhost --home home/loadavg check\n";
  const ProgramResult result = runProgram({"/bin/sh", "-c", script});
  EXPECT_EQ(result.code, 0) << script << result.err;
  EXPECT_EQ(result.err, "");
  EXPECT_THAT(result.out, testing::ContainsRegex("last 15 min +15 +[0-9]+ +span 2\n"));
  EXPECT_THAT(result.out, testing::ContainsRegex("\\(return value\\) +0\nNames +[{]"));
  EXPECT_THAT(result.out, testing::HasSubstr("0 errors, 0 warnings"));
}

}  // namespace
