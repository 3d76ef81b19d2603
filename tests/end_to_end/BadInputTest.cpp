// What a user meets who makes a mistake: one clear message with its place, an exit code that tells,
// and the rest goes on serving.

#include <gmock/gmock.h>
#include <sys/stat.h>

#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

namespace {

using testing::HasSubstr;

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

  ProgramResult run(const std::vector<std::string>& arguments) const {
    return runProgram({CIMHOST, "--home", tree_.root().string()}, arguments);
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

  TemporaryTree tree_;
};

std::string repeated(const std::string& text, int times) {
  std::string all;
  for (int i = 0; i < times; ++i) all += text;
  return all;
}

}  // namespace

TEST_F(BadInput, IsReportedWithItsPlaceAndTheRestServes) {
  const char* const kXml = "run/bad.xml";
  const char* const kMof = "mof/root/load/bad.mof";
  const std::string begin = "<plugin><module name='m'/>";
  const struct {
    const char* file;
    std::string text, message;
  } cases[] = {
      {kXml, "<plugin>\n  <module name='m'/>\n  <class name='%n%s'>\n    <property/>\n",
       "bad.xml:4:5: error: instance elememt is missing in class element before: property"},
      {kXml, begin + repeated(" ", 5000) + "\u00e9<oops/>",
       "\n  " + repeated(" ", 60) + "\u00e9<oops/>\n  " + repeated(" ", 60) + "^"},
      {kXml,
       "<plugin><module name='m'>" +
           repeated("<functioncall><function name='f'/><argument type='element'>", 20000),
       "nested too deeply"},
      {kXml, std::string("<plugin>\0<mod\0ule", 17), "bad.xml:1:"},
      {kMof, "class Bad {\n  strin Name;\n};\n", "bad.mof:2:3: error: "},
      {kMof, "class Bad {" + repeated(" ", 5000) + "/* \u00e9 */ uint8 A = 256; };",
       "/* \u00e9 */ uint8 A = 256; };\n  " + repeated(" ", 59) + "^"},
      {kMof, "class Bad { [Key] string S = \"abc", "bad.mof:1:"},
      {kMof, "[Description(\"\xC3(\")]\nclass Bad { };", "bad.mof:1:"},
      {kMof, "instance of Bad { X = " + repeated("{", 100000), "bad.mof:1:"},
      {kMof, "class Bad : Missing {\n};\n", "bad.mof:1:13: error: "},
      {"logs/CommonProvider.ini", "[log]\nLogLevel = verbose\n", "CommonProvider.ini:2:"}};
  for (const auto& [file, text, message] : cases) {
    SCOPED_TRACE(file + (" " + text.substr(0, 80)));
    TemporaryTree::write(tree_.root() / file, text);
    const ProgramResult result = run({"check"});
    EXPECT_EQ(result.code, 1);
    EXPECT_THAT(result.out + result.err, HasSubstr(message));
    expectServing();
    std::filesystem::remove(tree_.root() / file);
  }
}

TEST_F(BadInput, OddFilesDoNotStopTheHost) {
  std::filesystem::create_directory(tree_.run() / "folder.xml");
  for (const char* name : {"run/a.xml", "logs/CommonProvider.ini", "mof/root/load/a.mof"}) {
    EXPECT_EQ(mkfifo((tree_.root() / name).c_str(), 0600), 0) << name;
  }
  TemporaryTree::write(tree_.run() / "empty.xml", "");
  expectServing();
}

TEST_F(BadInput, PluginThatIsNotThereLeavesItsClassEmptyAndIsLogged) {
  tree_.setLogLevel("1");
  TemporaryTree::write(
      tree_.run() / "gone.xml",
      "<plugin><module name='gone' path='short'/><class name='Gone' namespace='root/load'>"
      "<instances><constant type='int'>2</constant></instances><property name='Name'><get>"
      "<functioncall><function name='goneName' type='getSi'/><argument type='index'/>"
      "</functioncall></get></property></class></plugin>");
  TemporaryTree::write(tree_.root() / "mof/root/load/gone.mof",
                       "class Gone { [Key] string Name; };");
  const ProgramResult result = run({"enumerate", "root/load:Gone"});
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_EQ(tree_.log(), "Couldn't load module gone\nCouldn't load module gone\n");
  expectServing();
}

TEST(Home, MissingHomeIsSaid) {
  const ProgramResult result =
      runProgram({CIMHOST, "--home", "/nonexistent/home", "classes", "root"});
  EXPECT_EQ(result.code, 3);
  EXPECT_THAT(result.err, HasSubstr("/nonexistent/home"));
}
