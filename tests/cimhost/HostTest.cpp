#include "cimhost/CommandLine.h"
#include "cimhost/Host.h"
#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <pwd.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

using namespace cimhost;
using testing::ElementsAre;
using testing::HasSubstr;
namespace fs = std::filesystem;

constexpr const char* kClasses = R"(
class Test_Base { [Key] string Name; uint64 Size; };
class Test_Port { [Key] string Name; uint32 Any([In] uint8 Level, [In(false)] string Text); };
class Test_FastPort : Test_Port { };
[Association] class Link_Port { [Key] Test_Base REF Disk; [Key] Test_Port REF Port; };
class Test_Disk : Test_Base { };
class Test_BigDisk : Test_Disk { };
class Test_ThrowsCim : Test_Base { };
class Test_ManyThrows : Test_Base { };
class Test_Prints : Test_Base { };
class Test_User : Test_Base { };
)";

// The definition of a class, with more elements in it.
std::string definitionOf(const std::string& name, const std::string& more = "") {
  return "<class name=\"" + name +
         "\" namespace=\"root/test\"><instances><constant type=\"int\">1</constant></instances>" +
         more + "</class>\n";
}

// A definition file with these elements.
std::string plugin(const std::string& elements) {
  return "<plugin>\n<module name=\"m\" path=\"short\"></module>\n" + elements + "</plugin>\n";
}

constexpr const char* kPortAndLink = R"(
<class name="Test_Port" namespace="root/test">
 <instances><constant type="int">1</constant></instances>
 <method name="Any"><functioncall><function name="f" type="getI"/></functioncall></method>
</class>
<association name="Link_Port" namespace="root/test" propertyname1="Disk" propertyname2="Port">
 <classname name="Test_Disk"/>
 <classname name="Test_Port"/>
 <condition><true/></condition>
</association>
)";

class HostTest : public testing::Test {
 protected:
  HostTest() { fs::create_directories(home_ / "mof/root/test"); }

  void write(const std::string& name, const std::string& text) {
    TemporaryTree::write(home_ / name, text);
  }

  void writeGoodFiles() {
    write("mof/root/test/classes.mof", kClasses);
    std::string text;
    for (const char* name : {"Test_Disk", "Test_BigDisk", "Test_ThrowsCim", "Test_ManyThrows",
                             "Test_Prints", "Test_User"}) {
      text += definitionOf(name);
    }
    write("run/test.xml", plugin(text));
  }

  void writeLinkedFiles() {
    writeGoodFiles();
    write("run/linked.xml", plugin(kPortAndLink));
    tree_.addPlugin("m", TEST_PROVIDER_FILE);
  }

  std::vector<std::string> diagnostics() {
    const Host host(home_.string());
    std::vector<std::string> lines;
    for (const Diagnostic& each : host.diagnostics()) {
      const std::string text = each.toString();
      lines.push_back(text.substr(0, text.find('\n')));
    }
    return lines;
  }

  // `words` as a shell takes them.
  int run(const std::string& words) {
    const std::string command = CIMHOST_FILE " --provider " TEST_PROVIDER_FILE " --home ";
    const ProgramResult result =
        runProgram({"/bin/sh", "-c", command + home_.string() + " " + words});
    out_ = result.out;
    error_ = result.err;
    return result.code;
  }

  const TemporaryTree tree_;
  const fs::path home_ = tree_.root();
  std::string out_, error_;
};

TEST_F(HostTest, AnUnusableHomeIsNamed) {
  fs::remove(home_ / "run");
  EXPECT_EQ(run("check"), ExitCode::kCannotStart);
  EXPECT_THAT(error_, HasSubstr("/run: No such file or directory\n"));
  EXPECT_EQ(run("--home /no/such/home check"), ExitCode::kUsage);  // --home twice
}

TEST_F(HostTest, EveryProblemIsReportedAndTheRestServes) {
  writeGoodFiles();
  write("mof/root/test/bad.mof", "class X {\n  string;\n};\n");
  write("run/bad.xml", plugin(definitionOf("Test_Missing") + "<class name=\"Y\">\n</class>\n"));
  write("run/names.xml", plugin(definitionOf("1x")));
  write("logs/CommonProvider.ini", "LogLevel=9\nlevel\n");
  EXPECT_THAT(
      diagnostics(),
      testing::UnorderedElementsAre(
          testing::StartsWith("mof/root/test/bad.mof:2:9: error: "),
          testing::MatchesRegex("run/bad.xml:[45]:[0-9]+: error: .*"),
          "run/names.xml: error: class 1x is not served: The CIM name is not valid: 1x",
          "run/bad.xml: warning: class Test_Missing is defined, but not declared in namespace "
          "root/test; no client can reach it",
          "logs/CommonProvider.ini:2:1: error: expected key = value"));
  EXPECT_EQ(run("check"), ExitCode::kProblems);
  EXPECT_THAT(out_, testing::EndsWith("7 definitions, 4 errors, 1 warning\n"));
  EXPECT_EQ(error_, "");
  EXPECT_EQ(run("names root/test:Test_BigDisk"), ExitCode::kOk);
  EXPECT_THAT(error_, HasSubstr("bad.mof:2:9"));
}

TEST_F(HostTest, DefinitionsThatDoNotFitAreToldApart) {
  write(
      "mof/root/test/classes.mof",
      "class A { [Key] string Name; [Key(false)] string Good; string Bad; [Key(false)] A ref Link; "
      "};");
  std::string text;
  for (const char* name : {"Name", "good", "Bad", "Undeclared", "1x", "Link"}) {
    text += std::string("<property name=\"") + name +
            "\"><get><constant type=\"string\">v</constant></get></property>";
  }
  const std::string association =
      "<association name=\"A\" namespace2=\"root/test\" propertyname1=\"x\" propertyname2=\"y\">"
      "<classname name=\"A\"/><classname name=\"A\"/><condition><true/></condition></association>";
  write("run/a.xml", plugin(definitionOf("A", text) + definitionOf("a") + association));
  std::vector<std::string> warnings = {
      "property good of class A is declared as Good: letter case differs; it is left out",
      "property Bad of class A is declared without [Key] or [Key(false)]; the provider delivers no "
      "instance of the class",
      "property Undeclared of class A is defined, but not declared; it is left out",
      "property 1x of class A is defined, but not declared; it is left out",
      "property Link of class A is a reference in a class that is no association; OpenPegasus "
      "refuses the declaration",
      "class a is already defined in run/a.xml, which serves it in every namespace",
      "class A is defined as a class and as an association; clients see only the instances of the "
      "association"};
  for (std::string& each : warnings) each.insert(0, "run/a.xml: warning: ");
  EXPECT_EQ(diagnostics(), warnings);
}

TEST_F(HostTest, PluginsThatCannotBeCalledAreToldWithoutLoadingThem) {
  const bool wide = sizeof(void*) == 8;
  const std::string words = wide ? "32-bit library, cimhost a 64" : "64-bit library, cimhost a 32";
  const auto module = [](const std::string& name, const char* path = "short") {
    return "<module name=\"" + name + "\" path=\"" + path + "\"></module>";
  };
  const std::string cannot = " cannot be loaded: lib/lib";
  const struct {
    std::string module;
    const char* type;
    std::string warning;
  } cases[] = {
      {module("absent"), "getS", "module absent" + cannot + "absent.so: No such file or directory"},
      {module("text"), "getS", "module text" + cannot + "text.so is not a shared library"},
      {module("pipe"), "getS", "module pipe" + cannot + "pipe.so: not a regular file"},
      {module("words"), "getS",
       "module words" + cannot + "words.so is a " + words + "-bit program"},
      {module("good"), "getX",
       "function f4 is never called: its type is none of the function types"},
      {"", "getS", "function f5 is never called: no module element stands before it"},
      {module("libnowhere.so", "full"), "getS", ""},  // is searched for
  };
  std::string mof;
  std::vector<std::string> warnings;
  for (const auto& row : cases) {
    const std::string number = std::to_string(&row - cases);
    const std::string file = "run/" + number + ".xml";
    const std::string property = "<property name=\"P" + number +
                                 "\"><get><functioncall><function name=\"f" + number +
                                 "\" type=\"" + row.type + "\"/></functioncall></get></property>";
    mof += "class A" + number + " { [Key] string P" + number + "; };\n";
    write(file, "<plugin>" + row.module + definitionOf("A" + number, property) + "</plugin>");
    if (!row.warning.empty()) warnings.push_back(file + ": warning: " + row.warning);
  }
  write("run/unused.xml", "<plugin>" + module("unused") + "</plugin>");
  write("mof/root/test/a.mof", mof);
  tree_.addPlugin("good", TEST_PROVIDER_FILE);
  write("lib/libtext.so", "int f;\n");
  ASSERT_EQ(mkfifo((home_ / "lib/libpipe.so").c_str(), 0600), 0);
  write("lib/libwords.so", std::string("\x7f") + "ELF" + (wide ? '\1' : '\2') + "\1\1");
  EXPECT_THAT(diagnostics(), testing::UnorderedElementsAreArray(warnings));
}

TEST_F(HostTest, OddFilesDoNotHangTheCheck) {
  fs::create_directory(home_ / "run/folder.xml");
  ASSERT_EQ(mkfifo((home_ / "logs/CommonProvider.ini").c_str(), 0600), 0);
  ASSERT_EQ(mkfifo((home_ / "run/pipe.xml").c_str(), 0600), 0);
  EXPECT_EQ(run("check"), ExitCode::kProblems);
  for (const char* problem : {"logs/CommonProvider.ini: error: not a regular file",
                              "run/folder.xml: error: ", "run/pipe.xml: error: "}) {
    EXPECT_THAT(out_, HasSubstr(problem));
  }
}

// What starts with a line end stands somewhere in the outputs.
TEST_F(HostTest, CommandsPrintWhatAClientGets) {
  writeLinkedFiles();
  const passwd* entry = getpwuid(geteuid());
  const std::string user = entry != nullptr ? entry->pw_name : std::to_string(geteuid());
  const std::string disk = "'root/test:Test_Disk.Name=\"a\"'";
  const std::string thrower = "'root/test:Test_ThrowsCim.Name=\"a\"'";
  const std::string denied = "cimhost: CIM_ERR_ACCESS_DENIED (2): not for you\n";
  const struct {
    std::string words;
    int code;
    std::string printed;
  } cases[] = {
      {"enumerate root/test:Test_Disk", 0,
       "(class)       Name  Size\n------------  ----  ----\n"
       "Test_Disk     a     7\nTest_Disk     b     7\nTest_BigDisk  big   7\n"},
      {"enumerate root/test:Test_User --property Name", 0, "\n" + user + "\n"},
      {"get 'root/test:Test_BigDisk.Name=\"big\"' --property Name", 0, "\nName      big\n"},
      {"classes root/test:Test_Base --no-deep --format json", 0,
       "\n\"Test_Disk\",\n\"Test_ThrowsCim\",\n"},
      {"class root/test:test_disk --format mof --local-only", 0,
       "class Test_Disk : Test_Base {\n};\n"},
      {"enumerate root/test:Test_ThrowsCim --format json", 12, denied},
      {"get 'root/test:Test_Base.Name=\"x\"'", 16,
       "cimhost: CIM_ERR_NOT_FOUND (6): root/test:Test_Base.Name=\"x\"\n"},
      {"modify " + thrower + " Size=-5", ExitCode::kUsage,
       "cimhost: property Size (uint64): \"-5\" is out of range, 0 to 18446744073709551615\n"},
      {"associators " + disk + " --result-class Test_FastPort --property Name", 0,
       "Name\n-----------\nLink_Port 2\n"},
      {"reference-names " + disk + " --result-class Link_Port", 0,
       "root/test:Link_Port.Name=\"link\"\n"},
      {"references " + disk + " --result-class Link_Port --property Name", 0,
       "\nTest_Disk|Link_Port|||\n"},
  };
  for (const auto& row : cases) {
    SCOPED_TRACE(row.words);
    EXPECT_EQ(run(row.words), row.code);
    const std::string printed = out_ + error_;
    const bool whole = row.printed[0] != '\n';
    EXPECT_TRUE(whole ? printed == row.printed : printed.find(row.printed) != std::string::npos)
        << printed;
  }
  // What was sent before a failure is still well formed.
  EXPECT_EQ(run("enumerate root/test:Test_ManyThrows --format json"), 11);
  EXPECT_EQ(nlohmann::json::parse(out_).size(), 1001u);
}

TEST_F(HostTest, WhatAProviderPrintsStaysOutOfTheResults) {
  writeGoodFiles();
  EXPECT_EQ(run("enumerate root/test:Test_Prints --format json"), 0);
  EXPECT_THAT(out_ + error_, testing::Not(HasSubstr("noise")));
  EXPECT_EQ(run("--trace enumerate root/test:Test_Prints"), 0);
  EXPECT_THAT(out_, testing::Not(HasSubstr("noise")));
  EXPECT_EQ(error_, "noise\n");
  EXPECT_EQ(run("enumerate root/test:Test_Disk >/dev/full"), ExitCode::kOutput);
  EXPECT_EQ(run("check >/dev/full"), ExitCode::kOutput);
}

constexpr const char* kRegistration = R"(
instance of PG_ProviderModule {
  Name = "Disk-1";
  Vendor = "A \"B\" \\ C\n\x001Bé";
  Version = "2.0";
  InterfaceType = "C++Default";
  InterfaceVersion = "2.9.0";
  Location = "Disk";
};

instance of PG_Provider {
  ProviderModuleName = "Disk-1";
  Name = "CommonProvider";
};

instance of PG_ProviderCapabilities {
  ProviderModuleName = "Disk-1";
  ProviderName = "CommonProvider";
  CapabilityID = "Link_Port";
  ClassName = "Link_Port";
  Namespaces = {"root/test"};
  ProviderType = {2, 3};
  SupportedProperties = NULL;
  SupportedMethods = NULL;
};

)";

TEST_F(HostTest, RegistrationIsMofForTheServer) {
  writeLinkedFiles();
  ASSERT_EQ(
      run("registration --module-name Disk-1 --vendor 'A \"B\" \\ C\n\x1bé' --module-version 2.0 "
          "--location Disk"),
      ExitCode::kOk)
      << error_;
  EXPECT_EQ(error_, "");
  EXPECT_THAT(out_, HasSubstr(kRegistration));
  EXPECT_THAT(out_, testing::StartsWith("// Registers libDisk.so with OpenPegasus.\n"));
  EXPECT_THAT(out_, HasSubstr("ClassName = \"Test_Port\";\n  Namespaces = {\"root/test\"};\n"
                              "  ProviderType = {2, 5};"));
}

TEST_F(HostTest, RegistrationWarnsAndRefuses) {
  EXPECT_EQ(run("registration"), ExitCode::kProblems);
  EXPECT_THAT(error_, HasSubstr("nothing to register"));
  write("run/a.xml", plugin(definitionOf("Undeclared")));
  EXPECT_EQ(run("registration"), ExitCode::kOk);
  EXPECT_THAT(out_, HasSubstr("ClassName = \"Undeclared\""));
  EXPECT_THAT(error_, HasSubstr("not declared in namespace root/test"));
  write("run/b.xml", plugin("<class name=\"Y\">\n</class>"));
  EXPECT_EQ(run("registration"), ExitCode::kProblems);
  EXPECT_EQ(out_, "");
  EXPECT_THAT(error_, HasSubstr("run/b.xml:"));
}

TEST_F(HostTest, DumpsShowWhatNamedFilesHold) {
  writeLinkedFiles();
  write("bad.xml", "<plugin><module name=\"x\"/><class/>");
  EXPECT_EQ(run("dump " + (home_ / "run/linked.xml").string()), ExitCode::kOk);
  EXPECT_THAT(out_,
              testing::StartsWith("*** Start of ProviderDefModule Dump ***\nModule Name: m\n"));
  EXPECT_THAT(out_, HasSubstr("Class Name: Link_Port\n"));
  EXPECT_THAT(out_, testing::EndsWith("*** End   of ProviderDefAssociation Dump ***\n"));
  EXPECT_EQ(run("dump " + (home_ / "bad.xml").string()), ExitCode::kProblems);
  EXPECT_THAT(error_, HasSubstr("bad.xml:1:"));
  EXPECT_EQ(run("dump >/dev/full"), ExitCode::kOutput);
}

}  // namespace
