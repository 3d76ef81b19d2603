#include "cimhost/CommandLine.h"

#include "cimhost/Text.h"

#include <gmock/gmock.h>

#include <sstream>

namespace {

using namespace cimhost;
using testing::HasSubstr;
using Command = CommandLine::Command;

struct Parsed {
  std::optional<CommandLine> line;
  int exitCode = -1;
  std::string out;
  std::string error;
};

Parsed parse(std::vector<const char*> arguments) {
  arguments.insert(arguments.begin(), "cimhost");
  std::ostringstream out;
  std::ostringstream error;
  Parsed parsed;
  parsed.line = parseCommandLine(static_cast<int>(arguments.size()), arguments.data(), out, error,
                                 parsed.exitCode);
  parsed.out = out.str();
  parsed.error = error.str();
  return parsed;
}

TEST(CommandLine, Defaults) {
  const Parsed parsed = parse({"--home", "h", "enumerate", "root/cimv2:A"});
  ASSERT_TRUE(parsed.line) << parsed.error;
  const CommandLine& line = *parsed.line;
  EXPECT_EQ(line.command, Command::enumerate);
  EXPECT_EQ(line.home, "h");
  EXPECT_EQ(line.format, OutputFormat::table);
  EXPECT_TRUE(line.deep);
  EXPECT_FALSE(line.localOnly || line.includeQualifiers || line.includeClassOrigin || line.trace);
  EXPECT_TRUE(line.properties.isNull());
  EXPECT_EQ(toUtf8(line.target.toString()), "root/cimv2:A");
}

TEST(CommandLine, OptionsMayStandBeforeAndBehindTheCommand) {
  const Parsed parsed =
      parse({"--home", "h", "enumerate", "--no-deep", "--local-only", "--qualifiers",
             "--class-origin", "--property", "A", "--property", "B", "root/cimv2:A", "--format",
             "json", "--provider", "p.so", "--trace"});
  ASSERT_TRUE(parsed.line) << parsed.error;
  const CommandLine& line = *parsed.line;
  EXPECT_FALSE(line.deep);
  EXPECT_TRUE(line.localOnly && line.includeQualifiers && line.includeClassOrigin && line.trace);
  EXPECT_EQ(toUtf8(line.properties.toString()), "A, B");
  EXPECT_EQ(line.format, OutputFormat::json);
  EXPECT_EQ(line.providerFile, "p.so");
}

// The other commands and options are tested by running them.
TEST(CommandLine, ArgumentsOfCommands) {
  EXPECT_TRUE(parse({"--home", "h", "class", "root:A"}).line->includeQualifiers);
  EXPECT_FALSE(
      parse({"--home", "h", "class", "root:A", "--no-qualifiers"}).line->includeQualifiers);
  const Parsed all = parse({"--home", "h", "associators", "root:A.k=1", "--assoc-class", "L",
                            "--result-class", "R", "--role", "a", "--result-role", "b"});
  ASSERT_TRUE(all.line) << all.error;
  EXPECT_EQ(toUtf8(all.line->filter.associationClass.getString()), "L");
  EXPECT_EQ(toUtf8(all.line->filter.resultClass.getString()), "R");
  EXPECT_EQ(toUtf8(all.line->filter.role), "a");
  EXPECT_EQ(toUtf8(all.line->filter.resultRole), "b");
  // Values stay as they are given.
  const Parsed modify = parse({"--home", "h", "modify", "root:A.k=1", "N=[]", "M", "S=-5 ",
                               "--format", "json", "T=a,b", "U="});
  ASSERT_TRUE(modify.line) << modify.error;
  EXPECT_EQ(modify.line->values, (std::vector<std::string>{"N=[]", "M", "S=-5 ", "T=a,b", "U="}));
}

TEST(CommandLine, VersionAndHelpNeedNoHome) {
  const Parsed version = parse({"--version"});
  EXPECT_FALSE(version.line);
  EXPECT_EQ(version.exitCode, 0);
  EXPECT_EQ(version.out, "cimhost " PROJECT_VERSION "\n");
  const Parsed help = parse({"--help"});
  EXPECT_EQ(help.exitCode, 0);
  EXPECT_THAT(help.out, HasSubstr("16 for\nCIM_ERR_NOT_FOUND"));
}

TEST(CommandLine, UsageErrors) {
  const struct {
    std::vector<const char*> arguments;
    const char* message;
  } cases[] = {
      {{}, "--home"},
      {{"--home", "h"}, "subcommand"},
      {{"check"}, "--home"},
      {{"--home", "h", "frobnicate"}, "subcommand"},
      {{"--home", "h", "enumerate"}, "NS:CLASS"},
      {{"--home", "h", "check", "--what"}, "--what"},
      {{"--home", "h", "check", "x"}, "x"},
      {{"--home", "h", "--format", "yaml", "check"}, "yaml"},
      {{"--home", "h", "get", "root:A.k="}, "column 8"},
      {{"--home", "h", "enumerate", "root:A", "--property", "1x"}, "1x"},
      {{"--home", "h", "enumerate", "root:A", "--property", ""}, "not valid"},
      {{"--home", "h", "modify", "root:A.k=1"}, "NAME=VALUE"},
      {{"--home", "h", "modify", "root:A", "S=1"}, "no keys"},
      {{"--home", "h", "invoke", "root:A.k=1"}, "METHOD"},
      {{"--home", "h", "associators", "root:A.k=1", "--assoc-class", "1x"}, "1x"},
      {{"--home", "h", "names", "root:A", "--role", "x"}, "--role"},
      {{"--home", "h", "registration", "--location", ""}, "--location"},
      {{"--home", "h", "registration", "--module-name", "a\nb"}, "--module-name"},
      {{"--home", "h", "registration", "--vendor", "\xff"}, "UTF-8"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.message);
    const Parsed parsed = parse(row.arguments);
    EXPECT_FALSE(parsed.line);
    EXPECT_EQ(parsed.exitCode, ExitCode::kUsage);
    EXPECT_THAT(parsed.error, HasSubstr(row.message));
    EXPECT_EQ(parsed.out, "");
  }
}

}  // namespace
