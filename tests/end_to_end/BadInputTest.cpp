// What a user meets who makes a mistake: one clear message with its place, an exit code that tells,
// and the rest goes on serving.

#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

namespace {

// A home with the loadavg example, to which a test adds what is wrong.
class BadInput : public testing::Test {
 protected:
  BadInput() {
    namespace fs = std::filesystem;
    for (const char* folder : {"run", "lib", "mof"}) {
      fs::copy(fs::path(HOMES "/loadavg") / folder, tree_.root() / folder,
               fs::copy_options::recursive | fs::copy_options::overwrite_existing |
                   fs::copy_options::copy_symlinks);
    }
  }

  void add(const std::string& name, const std::string& text) const {
    std::ofstream(tree_.root() / name, std::ios::binary) << text;
  }

  ProgramResult run(std::vector<std::string> arguments) const {
    std::vector<std::string> all = {CIMHOST, "--home", tree_.root().string()};
    all.insert(all.end(), arguments.begin(), arguments.end());
    return runProgram(all);
  }

  // The example is served whatever stands beside it.
  void expectServing() const {
    const ProgramResult result = run({"names", "root/load:Load_Average"});
    EXPECT_EQ(result.code, 0) << result.err;
    EXPECT_EQ(result.out,
              "root/load:Load_Average.Name=\"last 1 min\"\n"
              "root/load:Load_Average.Name=\"last 5 min\"\n"
              "root/load:Load_Average.Name=\"last 15 min\"\n");
  }

  void expectProblem(const std::string& message) const {
    const ProgramResult result = run({"check"});
    EXPECT_EQ(result.code, 1) << result.out << result.err;
    EXPECT_NE((result.out + result.err).find(message), std::string::npos)
        << result.out << result.err;
  }

  TemporaryTree tree_;
};

struct TextCase {
  const char* name;
  std::string file;
  std::string text;
  std::string message;
};

class BadText : public BadInput, public testing::WithParamInterface<TextCase> {};

TEST_P(BadText, IsReportedWithItsPlaceAndTheRestServes) {
  add(GetParam().file, GetParam().text);
  expectProblem(GetParam().message);
  expectServing();
}

std::string repeated(const std::string& text, int times) {
  std::string all;
  for (int i = 0; i < times; ++i) all += text;
  return all;
}

INSTANTIATE_TEST_SUITE_P(
    Files, BadText,
    testing::Values(
        TextCase{"Definition", "run/bad.xml",
                 "<plugin>\n  <module name='m'/>\n  <class name='%n%s'>\n    <property/>\n",
                 "bad.xml:4:5: error: instance elememt is missing in class element before: "
                 "property"},
        TextCase{"LongLine", "run/bad.xml",
                 "<plugin><module name='m'/>" + repeated(" ", 5000) + "\u00e9<oops/>",
                 "\n  " + repeated(" ", 60) + "\u00e9<oops/>\n  " + repeated(" ", 60) + "^"},
        TextCase{"DeepNesting", "run/bad.xml",
                 "<plugin><module name='m'>" +
                     repeated("<functioncall><function name='f'/><argument type='element'>", 20000),
                 "nested too deeply"},
        TextCase{"NulBytes", "run/bad.xml", std::string("<plugin>\0<mod\0ule", 17), "bad.xml:1:"},
        TextCase{"Mof", "mof/root/load/bad.mof", "class Bad {\n  strin Name;\n};\n",
                 "bad.mof:2:3: error: "},
        TextCase{"MofLongLine", "mof/root/load/bad.mof",
                 "class Bad {" + repeated(" ", 5000) + "/* \u00e9 */ uint8 A = 256; };",
                 "/* \u00e9 */ uint8 A = 256; };\n  " + repeated(" ", 59) + "^"},
        TextCase{"MofUnterminated", "mof/root/load/bad.mof", "class Bad { [Key] string S = \"abc",
                 "bad.mof:1:"},
        TextCase{"MofInvalidUtf8", "mof/root/load/bad.mof",
                 "[Description(\"\xC3(\")]\nclass Bad { };", "bad.mof:1:"},
        TextCase{"MofDeepNesting", "mof/root/load/bad.mof",
                 "instance of Bad { X = " + repeated("{", 100000), "bad.mof:1:"},
        TextCase{"MofSuperclass", "mof/root/load/bad.mof", "class Bad : Missing {\n};\n",
                 "bad.mof:1:13: error: "}),
    [](const auto& tested) { return tested.param.name; });

}  // namespace

TEST_F(BadInput, ConfigurationIsReportedWithItsPlace) {
  add("logs/CommonProvider.ini", "[log]\nLogLevel = verbose\n");
  expectProblem("CommonProvider.ini:2:");
  expectServing();
}

TEST_F(BadInput, OddFilesDoNotStopTheHost) {
  std::filesystem::create_directory(tree_.run() / "folder.xml");
  mkfifo((tree_.run() / "fifo.xml").c_str(), 0600);
  mkfifo((tree_.logs() / "CommonProvider.ini").c_str(), 0600);
  mkfifo((tree_.root() / "mof/root/load/fifo.mof").c_str(), 0600);
  add("run/empty.xml", "");
  expectServing();
}

TEST_F(BadInput, PluginThatIsNotThereLeavesItsClassEmptyAndIsLogged) {
  add("logs/CommonProvider.ini", "LogLevel=1\n");
  add("run/gone.xml",
      "<plugin><module name='gone' path='short'/><class name='Gone' namespace='root/load'>"
      "<instances><constant type='int'>2</constant></instances><property name='Name'><get>"
      "<functioncall><function name='goneName' type='getSi'/><argument type='index'/>"
      "</functioncall></get></property></class></plugin>");
  add("mof/root/load/gone.mof", "class Gone { [Key] string Name; };");
  const ProgramResult result = run({"enumerate", "root/load:Gone"});
  EXPECT_EQ(result.code, 0) << result.err;
  std::ostringstream log;
  log << std::ifstream(tree_.logs() / "CommonProvider.log").rdbuf();
  EXPECT_EQ(log.str(), "Couldn't load module gone\nCouldn't load module gone\n");
  expectServing();
}

TEST(Home, MissingHomeIsSaid) {
  const ProgramResult result =
      runProgram({CIMHOST, "--home", "/nonexistent/home", "classes", "root"});
  EXPECT_EQ(result.code, 3);
  EXPECT_NE(result.err.find("/nonexistent/home"), std::string::npos) << result.err;
}
