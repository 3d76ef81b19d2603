// A definition file that uses most of the format, served to a client as a whole.

#include <gtest/gtest.h>

#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

namespace {

class Demo : public testing::Test {
 protected:
  Demo() {
    std::filesystem::copy_file(DEMO_DEFINITION, tree_.run() / "demo.xml");
    tree_.addPlugin("demo", DEMO_PLUGIN);
    std::filesystem::create_directories(tree_.root() / "mof/root/demo");
    std::ofstream(tree_.root() / "mof/root/demo/demo.mof")
        << "class Demo_Disk { [Key] string DeviceID; [Key(false), ValueMap{\"2\"}, Values{\"OK\"}] "
           "string Status; [Key(false)] boolean Removable; [Key(false)] string Label; "
           "[Static] sint32 Reset(); };\n"
           "class Demo_Part { [Key] string Name; };\n"
           "[Association] class Demo_DiskPart { [Key] Demo_Disk REF Disk; [Key] Demo_Part REF "
           "Part; "
           "};\n";
  }

  std::string run(std::vector<std::string> arguments) {
    std::vector<std::string> all = {CIMHOST, "--home", tree_.root().string(), "--format", "mof"};
    all.insert(all.end(), arguments.begin(), arguments.end());
    const ProgramResult result = runProgram(all);
    EXPECT_EQ(result.code, 0) << result.err;
    return result.out;
  }

  TemporaryTree tree_;
};

}  // namespace

TEST_F(Demo, IsServed) {
  // No attribute names the property that carries the mapping: the conversion gives "Unknown".
  EXPECT_EQ(run({"enumerate", "root/demo:Demo_Disk"}),
            "instance of Demo_Disk {\n"
            "  DeviceID = \"part\";\n  Status = \"Unknown\";\n  Removable = FALSE;\n"
            "  Label = \"label 0, next tag 0 value 0\";\n};\n"
            "\ninstance of Demo_Disk {\n"
            "  DeviceID = \"sdb\";\n  Status = \"Unknown\";\n  Removable = FALSE;\n"
            "  Label = \"label 1, next tag 0 value 0\";\n};\n");
  const std::string part = "instance of Demo_Part {\n  Name = \"part\";\n};\n";
  EXPECT_EQ(run({"enumerate", "root/demo:Demo_Part"}),
            part + "\n" + part + "\n" + part + "\n" + part);
  // "or" holds only when both sides do: equal names are not enough.
  EXPECT_EQ(run({"enumerate", "root/demo:Demo_DiskPart"}), "");
}

TEST_F(Demo, RunsItsMethodAndLeavesASetCallThatDoesNotFitAlone) {
  const std::string result = run({"invoke", "root/demo:Demo_Disk.DeviceID=\"sdb\"", "Reset"});
  EXPECT_NE(result.find("41"), std::string::npos) << result;
  // setSi takes one extra argument; with two the plug-in is not called.
  run({"modify", "root/demo:Demo_Disk.DeviceID=\"sdb\"", "DeviceID=other"});
  EXPECT_NE(run({"enumerate", "root/demo:Demo_Disk"}).find("\"sdb\""), std::string::npos);
}
