#include "cimhost/CommandLine.h"

#include "cimhost/Text.h"

#include <gmock/gmock.h>

#include <sstream>

namespace {

using namespace cimhost;
using testing::HasSubstr;
using Words = std::vector<const char*>;

struct Parsed {
  explicit Parsed(Words words) {
    words.insert(words.begin(), "cimhost");
    std::ostringstream outStream;
    std::ostringstream errorStream;
    line = parseCommandLine(static_cast<int>(words.size()), words.data(), outStream, errorStream,
                            exitCode);
    out = outStream.str();
    error = errorStream.str();
  }
  std::optional<CommandLine> line;
  int exitCode = -1;
  std::string out, error;
};

CommandLine parse(Words words) {
  words.insert(words.begin(), {"--home", "h"});
  const Parsed parsed(words);
  EXPECT_TRUE(parsed.line) << parsed.error;
  return parsed.line.value_or(CommandLine());
}

// The other commands and options are tested by running them.
TEST(CommandLine, OptionsMayStandBeforeAndBehindTheCommand) {
  CommandLine line = parse({"enumerate", "root/cimv2:A"});
  EXPECT_TRUE(line.deep);
  EXPECT_FALSE(line.localOnly || line.includeQualifiers || line.includeClassOrigin || line.trace);
  EXPECT_TRUE(line.properties.isNull());
  EXPECT_EQ(toUtf8(line.target.toString()), "root/cimv2:A");
  line = parse({"--trace", "enumerate", "--no-deep", "--local-only", "--qualifiers",
                "--class-origin", "--property", "A", "--property", "B", "root/cimv2:A", "--format",
                "json", "--provider", "p.so"});
  EXPECT_FALSE(line.deep);
  EXPECT_TRUE(line.localOnly && line.includeQualifiers && line.includeClassOrigin && line.trace);
  EXPECT_EQ(toUtf8(line.properties.toString()), "A, B");
  EXPECT_EQ(line.format, OutputFormat::json);
  EXPECT_EQ(line.providerFile, "p.so");
  EXPECT_TRUE(parse({"class", "root:A"}).includeQualifiers);
  EXPECT_FALSE(parse({"class", "root:A", "--no-qualifiers"}).includeQualifiers);
  line = parse({"associators", "root:A.k=1", "--assoc-class", "L", "--result-class", "R", "--role",
                "a", "--result-role", "b"});
  EXPECT_EQ(toUtf8(line.filter.associationClass.getString()), "L");
  EXPECT_EQ(toUtf8(line.filter.resultClass.getString()), "R");
  EXPECT_EQ(toUtf8(line.filter.role), "a");
  EXPECT_EQ(toUtf8(line.filter.resultRole), "b");
  // Values stay as they are given.
  line = parse({"modify", "root:A.k=1", "N=[]", "M", "S=-5 ", "--format", "json", "T=a,b", "U="});
  EXPECT_EQ(line.values, (std::vector<std::string>{"N=[]", "M", "S=-5 ", "T=a,b", "U="}));
}

TEST(CommandLine, VersionAndHelpNeedNoHome) {
  const Parsed version({"--version"});
  EXPECT_FALSE(version.line);
  EXPECT_EQ(version.exitCode, 0);
  EXPECT_EQ(version.out, "cimhost " PROJECT_VERSION "\n");
  EXPECT_THAT(Parsed({"--help"}).out, HasSubstr("16 for\nCIM_ERR_NOT_FOUND"));
}

TEST(CommandLine, UsageErrors) {
  const struct {
    Words arguments;
    const char* message;
  } cases[] = {
      {{"check"}, "--home"},
      {{"--home", "h"}, "subcommand"},
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
      {{"--home", "h", "names", "root:A", "--role", "x"}, "--role"},
      {{"--home", "h", "registration", "--location", ""}, "--location"},
      {{"--home", "h", "registration", "--module-name", "a\nb"}, "--module-name"},
      {{"--home", "h", "registration", "--vendor", "\xff"}, "UTF-8"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.message);
    const Parsed parsed(row.arguments);
    EXPECT_FALSE(parsed.line);
    EXPECT_EQ(parsed.exitCode, ExitCode::kUsage);
    EXPECT_THAT(parsed.error, HasSubstr(row.message));
    EXPECT_EQ(parsed.out, "");
  }
}

}  // namespace
