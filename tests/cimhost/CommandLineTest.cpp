#include "cimhost/CommandLine.h"

#include "cimhost/Text.h"

#include <gmock/gmock.h>

#include <sstream>

namespace {

using namespace cimhost;
using testing::HasSubstr;

// `words` stand one blank apart.
struct Parsed {
  explicit Parsed(const std::string& words) {
    std::istringstream stream("cimhost " + words);
    std::vector<std::string> all;
    for (std::string word; std::getline(stream, word, ' ');) all.push_back(word);
    std::vector<const char*> arguments;
    for (const std::string& word : all) arguments.push_back(word.c_str());
    std::ostringstream outStream, errorStream;
    line = parseCommandLine(static_cast<int>(all.size()), arguments.data(), outStream, errorStream,
                            exitCode);
    out = outStream.str();
    error = errorStream.str();
  }
  std::optional<CommandLine> line;
  int exitCode = -1;
  std::string out, error;
};

CommandLine parse(const std::string& words) {
  const Parsed parsed("--home h " + words);
  EXPECT_TRUE(parsed.line) << parsed.error;
  return parsed.line.value_or(CommandLine());
}

// The other commands and options are tested by running them.
TEST(CommandLine, OptionsMayStandBeforeAndBehindTheCommand) {
  CommandLine line = parse("enumerate root/cimv2:A");
  EXPECT_TRUE(line.deep);
  EXPECT_FALSE(line.localOnly || line.includeQualifiers || line.includeClassOrigin || line.trace);
  EXPECT_TRUE(line.properties.isNull());
  EXPECT_EQ(toUtf8(line.target.toString()), "root/cimv2:A");
  line = parse(
      "--trace enumerate --no-deep --local-only --qualifiers --class-origin --property A "
      "--property B root/cimv2:A --format json --provider p.so");
  EXPECT_FALSE(line.deep);
  EXPECT_TRUE(line.localOnly && line.includeQualifiers && line.includeClassOrigin && line.trace);
  EXPECT_EQ(toUtf8(line.properties.toString()), "A, B");
  EXPECT_EQ(line.format, OutputFormat::json);
  EXPECT_EQ(line.providerFile, "p.so");
  EXPECT_TRUE(parse("class root:A").includeQualifiers);
  EXPECT_FALSE(parse("class root:A --no-qualifiers").includeQualifiers);
  line = parse("associators root:A.k=1 --assoc-class L --result-class R --role a --result-role b");
  EXPECT_EQ(toUtf8(line.filter.associationClass.getString()), "L");
  EXPECT_EQ(toUtf8(line.filter.resultClass.getString()), "R");
  EXPECT_EQ(toUtf8(line.filter.role), "a");
  EXPECT_EQ(toUtf8(line.filter.resultRole), "b");
  // Values stay as they are given.
  line = parse("modify root:A.k=1 N=[] M S=-5\t --format json T=a,b U=");
  EXPECT_EQ(line.values, (std::vector<std::string>{"N=[]", "M", "S=-5\t", "T=a,b", "U="}));
}

TEST(CommandLine, VersionAndHelpNeedNoHome) {
  const Parsed version("--version");
  EXPECT_FALSE(version.line);
  EXPECT_EQ(version.exitCode, 0);
  EXPECT_EQ(version.out, "cimhost " PROJECT_VERSION "\n");
  EXPECT_THAT(Parsed("--help").out, HasSubstr("16 for\nCIM_ERR_NOT_FOUND"));
}

TEST(CommandLine, UsageErrors) {
  const struct {
    const char *words, *message;
  } cases[] = {
      {"", "subcommand"},
      {"enumerate", "NS:CLASS"},
      {"check --what", "--what"},
      {"--format yaml check", "yaml"},
      {"get root:A.k=", "column 8"},
      {"enumerate --property  root:A", "not valid"},
      {"modify root:A.k=1", "NAME=VALUE"},
      {"modify root:A S=1", "no keys"},
      {"invoke root:A.k=1", "METHOD"},
      {"names root:A --role x", "--role"},
      {"registration --location  --vendor v", "--location"},
      {"registration --module-name a\nb", "--module-name"},
      {"registration --vendor \xff", "UTF-8"},
      // Other machines need TLS and users.
      {"serve --bind 0.0.0.0", "it needs --tls-cert"},
      {"serve --bind ::", "it needs --tls-cert"},
      {"serve --bind ::ffff:127.0.0.1", "it needs --tls-cert"},
      {"serve --bind 0.0.0.0 --users u", "it needs --tls-cert"},
      {"serve --bind 0.0.0.0 --tls-cert c --tls-key k", "it needs --tls-cert"},
      {"serve --tls-cert c", "go together"},
      {"serve --bind localhost", "not an IPv4 or IPv6 address"},
      {"serve --port 65536", "--port"},
      {"serve --threads 0", "--threads"},
      {"serve --idle-timeout 0", "--idle-timeout"},
      {"serve --max-request-size 1", "--max-request-size"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.message);
    const Parsed parsed(std::string("--home h ") + row.words);
    EXPECT_FALSE(parsed.line);
    EXPECT_EQ(parsed.exitCode, ExitCode::kUsage);
    EXPECT_THAT(parsed.error, HasSubstr(row.message));
    EXPECT_EQ(parsed.out, "");
  }
  EXPECT_THAT(Parsed("check").error, HasSubstr("--home"));
  for (const char* fine :
       {"serve", "serve --bind 127.0.0.2", "serve --bind ::1", "serve --bind 0.0.0.0 --insecure",
        "serve --bind 0.0.0.0 --tls-cert c --tls-key k --users u",
        "serve --max-request-size 1048576"}) {
    parse(fine);
  }
}

}  // namespace
