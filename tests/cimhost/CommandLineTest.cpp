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

TEST(CommandLine, EachCommand) {
  EXPECT_EQ(parse({"--home", "h", "names", "root:A"}).line->command, Command::names);
  EXPECT_EQ(parse({"--home", "h", "get", "root:A.k=1"}).line->command, Command::get);
  EXPECT_EQ(parse({"--home", "h", "classes", "root"}).line->command, Command::classes);
  EXPECT_EQ(parse({"--home", "h", "check"}).line->command, Command::check);
  const Parsed declaration = parse({"--home", "h", "class", "root:A"});
  EXPECT_EQ(declaration.line->command, Command::declaration);
  EXPECT_TRUE(declaration.line->includeQualifiers);
  EXPECT_FALSE(
      parse({"--home", "h", "class", "root:A", "--no-qualifiers"}).line->includeQualifiers);
}

TEST(CommandLine, Associations) {
  const Parsed all =
      parse({"--home", "h", "associators", "root:A.k=1", "--assoc-class", "L", "--result-class",
             "R", "--role", "a", "--result-role", "b", "--property", "P", "--qualifiers"});
  ASSERT_TRUE(all.line) << all.error;
  EXPECT_EQ(all.line->command, Command::associators);
  EXPECT_EQ(toUtf8(all.line->filter.associationClass.getString()), "L");
  EXPECT_EQ(toUtf8(all.line->filter.resultClass.getString()), "R");
  EXPECT_EQ(toUtf8(all.line->filter.role), "a");
  EXPECT_EQ(toUtf8(all.line->filter.resultRole), "b");
  EXPECT_TRUE(all.line->includeQualifiers);
  const Parsed references =
      parse({"--home", "h", "reference-names", "root:A.k=1", "--result-class", "L"});
  ASSERT_TRUE(references.line) << references.error;
  EXPECT_EQ(references.line->command, Command::referenceNames);
  EXPECT_EQ(toUtf8(references.line->filter.associationClass.getString()), "L");
  EXPECT_TRUE(references.line->filter.resultClass.isNull());
}

TEST(CommandLine, ValuesStayAsTheyAreGiven) {
  const Parsed modify = parse({"--home", "h", "modify", "root:A.k=1", "N=[]", "M", "S=-5 ",
                               "--format", "json", "T=a,b", "U="});
  ASSERT_TRUE(modify.line) << modify.error;
  EXPECT_EQ(modify.line->values, (std::vector<std::string>{"N=[]", "M", "S=-5 ", "T=a,b", "U="}));
  const Parsed invoke = parse({"--home", "h", "invoke", "root:A", "Do"});
  ASSERT_TRUE(invoke.line) << invoke.error;
  EXPECT_EQ(invoke.line->method, "Do");
  EXPECT_TRUE(invoke.line->values.empty());
  const Parsed dump = parse({"--home", "h", "dump", "a.xml", "b.xml"});
  ASSERT_TRUE(dump.line) << dump.error;
  EXPECT_EQ(dump.line->files, (std::vector<std::string>{"a.xml", "b.xml"}));
}

TEST(CommandLine, TheVersionNeedsNoHome) {
  const Parsed parsed = parse({"--version"});
  EXPECT_FALSE(parsed.line);
  EXPECT_EQ(parsed.exitCode, 0);
  EXPECT_EQ(parsed.out, "cimhost " PROJECT_VERSION "\n");
}

TEST(CommandLine, HelpNamesTheExitCodes) {
  const Parsed parsed = parse({"--help"});
  EXPECT_FALSE(parsed.line);
  EXPECT_EQ(parsed.exitCode, 0);
  EXPECT_THAT(parsed.out, HasSubstr("16 for\nCIM_ERR_NOT_FOUND"));
}

struct UsageCase {
  const char* name;
  std::vector<const char*> arguments;
  const char* message;
};

TEST(CommandLine, UsageErrors) {
  const UsageCase cases[] = {
      {"nothing", {}, "--home"},
      {"no command", {"--home", "h"}, "subcommand"},
      {"no home", {"check"}, "--home"},
      {"unknown command", {"--home", "h", "frobnicate"}, "subcommand"},
      {"no class", {"--home", "h", "enumerate"}, "NS:CLASS"},
      {"unknown option", {"--home", "h", "check", "--what"}, "--what"},
      {"surplus argument", {"--home", "h", "check", "x"}, "x"},
      {"format", {"--home", "h", "--format", "yaml", "check"}, "yaml"},
      {"path", {"--home", "h", "get", "root:A.k="}, "column 8"},
      {"property", {"--home", "h", "enumerate", "root:A", "--property", "1x"}, "1x"},
      {"empty property", {"--home", "h", "enumerate", "root:A", "--property", ""}, "not valid"},
      {"nothing to modify", {"--home", "h", "modify", "root:A.k=1"}, "NAME=VALUE"},
      {"modify a class", {"--home", "h", "modify", "root:A", "S=1"}, "no keys"},
      {"no method", {"--home", "h", "invoke", "root:A.k=1"}, "METHOD"},
      {"filter class", {"--home", "h", "associators", "root:A.k=1", "--assoc-class", "1x"}, "1x"},
      {"role of names", {"--home", "h", "names", "root:A", "--role", "x"}, "--role"},
      {"empty location", {"--home", "h", "registration", "--location", ""}, "--location"},
      {"module name with a line end",
       {"--home", "h", "registration", "--module-name", "a\nb"},
       "--module-name"},
      {"vendor that is not UTF-8", {"--home", "h", "registration", "--vendor", "\xff"}, "UTF-8"},
      {"option of another command", {"--home", "h", "names", "root:A", "--deep"}, "--deep"},
  };
  for (const UsageCase& row : cases) {
    SCOPED_TRACE(row.name);
    const Parsed parsed = parse(row.arguments);
    EXPECT_FALSE(parsed.line);
    EXPECT_EQ(parsed.exitCode, ExitCode::kUsage);
    EXPECT_THAT(parsed.error, HasSubstr(row.message));
    EXPECT_EQ(parsed.out, "");
  }
}

}  // namespace
