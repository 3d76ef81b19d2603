#include "tests/cimhost/mof/MofTestSupport.h"

#include <sys/stat.h>
#include <unistd.h>

namespace cimhost_test {
namespace {

using Pegasus::CIMFlavor;
using Pegasus::CIMNamespaceName;

TEST(MofReader, ReadsAClassWithEverything) {
  Mof mof;
  ASSERT_TRUE(
      mof.read("\xEF\xBB\xBF// A byte order mark stands before this.\r\n"
               R"(
#pragma locale ("en_US")
#PRAGMA something (1, "two", three)
#pragma bare
/* instances are skipped */
INSTANCE OF Nowhere AS $n { [Description("x")] A = $other; B = {1, "x", $c}; c = 'x'; };
[ASSOCIATION, Version ( "1." "0" ) : Translatable, ClassConstraint { "a", "b" }]
Class Demo_Link as $Demo
{
  [KEY, Min(1)] demo_disk REF Disk;
  [key ( TRUE )] Demo_File ref File;
  [MaxLen(0x10), ValueMap {"1", "2"}, Values {}] String Tags[4] = {"a", "b", "c", "d"};
  [Key(false), Description] uint8 Read = 1;
  [Static(false)] uint32 Format([In, Required] string Label, [In(false), Out] Demo_Disk REF Disks[],
                                uint8 Raw[2]);
  sint64 Stop();
};
)")) << mof.diagnostics();
  EXPECT_EQ(
      mof.classAsText("demo_LINK"),
      "[ASSOCIATION=TRUE Version=1.0 ClassConstraint=a b ] Demo_Link\n"
      "[KEY=TRUE Min=1] reference to demo_disk Disk (Demo_Link)\n"
      "[key=TRUE] reference to Demo_File File (Demo_Link)\n"
      "[MaxLen=16 ValueMap=1 2  Values=] string[4] Tags = a b c d  (Demo_Link)\n"
      "[Key=FALSE Description=null] uint8 Read = 1 (Demo_Link)\n"
      "[Static=FALSE] uint32 Format([In=TRUE Required=TRUE] string Label, [In=FALSE Out=TRUE] "
      "reference to Demo_Disk[] Disks, uint8[2] Raw) (Demo_Link)\n"
      "sint64 Stop() (Demo_Link)\n");
}

TEST(MofReader, KeepsWhatStandsBeforeAnErrorAndTheNamespaceOfAnEmptyText) {
  Mof mof;
  EXPECT_FALSE(mof.read("class A {}; class B { uint9 x; }; class C {};"));
  EXPECT_TRUE(mof.repository.hasClass(kNamespace, "A"));
  EXPECT_FALSE(mof.repository.hasClass(kNamespace, "C"));
  EXPECT_TRUE(mof.read("class B {};"));
  Mof empty;
  EXPECT_TRUE(empty.read(" // nothing"));
  EXPECT_TRUE(empty.repository.hasNamespace("ROOT/test"));
}

TEST(MofReader, DeclaredQualifiersSayTypeScopeAndFlavor) {
  Mof mof;
  ASSERT_TRUE(
      mof.read("Qualifier Owner : string = \"me\", Scope(class, property), "
               "Flavor(DisableOverride, Restricted, Translatable);\n"
               "qualifier Ports : uint16[] = {1, 2}, flavor(toinstance), scope(any);\n"
               "class A { [Owner(\"you\"), Ports {80}] string P; [Ports] string Q; };"))
      << mof.diagnostics();
  EXPECT_EQ(mof.classAsText("A"),
            "A\n[Owner=you Ports=80 ] string P (A)\n[Ports=null] string Q (A)\n");
  const Pegasus::CIMQualifier owner = mof.repository.findQualifier(kNamespace, "OWNER");
  EXPECT_EQ(text(owner.getValue().toString()), "me");
  EXPECT_TRUE(owner.getFlavor().equal(CIMFlavor::DISABLEOVERRIDE + CIMFlavor::RESTRICTED +
                                      CIMFlavor::TRANSLATABLE));
  const Pegasus::CIMQualifier ports = mof.repository.findQualifier(kNamespace, "ports");
  EXPECT_TRUE(ports.isArray());
  EXPECT_TRUE(ports.getFlavor().equal(CIMFlavor::DEFAULTS + CIMFlavor::TOINSTANCE));
  EXPECT_FALSE(mof.read("class B { uint8 M([Owner(\"x\")] uint8 a); };"));
  EXPECT_EQ(mof.firstLine(), "t.mof:1:20: qualifier 'Owner' is not allowed here");
}

TEST(MofReader, FlavorsOfAUseReplaceThoseOfTheDeclaration) {
  Mof mof;
  ASSERT_TRUE(
      mof.read("[Version(\"1\") : ToSubclass DisableOverride] class A {};"
               "class B : A {}; class C : A { [Key : Restricted] uint8 K; };"
               "class D : C {};"));
  EXPECT_EQ(mof.classAsText("B"), "[Version^=1] B : A\n");
  // A key stays one in subclasses whatever its flavor says.
  EXPECT_EQ(mof.classAsText("D"), "[Version^=1] D : C\n[Key^=TRUE] uint8 K (C^)\n");
  EXPECT_FALSE(mof.read("[Version(\"2\")] class E : A {};"));
}

// A file that is included twice is read once.
TEST(MofReader, NamespacePragmaHoldsToTheEndOfItsFile) {
  const TemporaryTree tree;
  write("a.mof",
        "class A {};\n#pragma include(\"sub/b.mof\")\n"
        "#pragma include(\"./sub/b.mof\")\nclass D : B {};");
  write("sub/b.mof",
        "class B : A {};\n#pragma namespace(\"root/other\")\nclass C {};\n"
        "#pragma include (\"c.mof\")\n");
  write("sub/c.mof", "class E : C {};");
  Mof mof;
  ASSERT_TRUE(mof.reader.readFile("a.mof", kNamespace)) << mof.diagnostics();
  EXPECT_TRUE(mof.repository.hasClass(kNamespace, "D"));
  EXPECT_TRUE(mof.repository.hasClass("Root/Other", "E"));
  EXPECT_FALSE(mof.repository.hasClass(kNamespace, "E"));
}

TEST(MofReader, CatchesIncludesThatEndNowhere) {
  const TemporaryTree tree;
  write("a.mof", "#pragma include(\"b.mof\")");
  write("b.mof", "class B {};\n#pragma include(\"../run/a.mof\")");
  for (int i = 0; i < 40; ++i) {
    write("deep" + std::to_string(i), "#pragma include(\"deep" + std::to_string(i + 1) + "\")");
  }
  Mof mof;
  EXPECT_FALSE(mof.reader.readFile("a.mof", kNamespace));
  EXPECT_EQ(mof.firstLine(), "b.mof:2:17: the file includes itself");
  EXPECT_TRUE(mof.repository.hasClass(kNamespace, "B"));
  Mof deep;
  EXPECT_FALSE(deep.reader.readFile("deep0", kNamespace));
  EXPECT_EQ(deep.firstLine(), "deep31:1:17: includes are nested more than 32 deep");
}

TEST(MofReader, FilesThatCannotBeReadAreDiagnostics) {
  const TemporaryTree tree;
  ASSERT_EQ(mkfifo("pipe", 0600), 0);
  write("big", "");
  std::filesystem::resize_file("big", (std::uintmax_t{64} << 20) + 1);
  write("a.mof", "#pragma include (\".\")");
  const struct {
    const char *file, *problem;
  } cases[] = {{".", ".: is a directory, not a file"},
               {"none", "none: No such file or directory"},
               {"pipe", "pipe: is not a regular file"},
               {"big", "big: is larger than 64 MiB"},
               {"a.mof", "a.mof:1:18: cannot read '.': is a directory, not a file"}};
  for (const auto& row : cases) {
    Mof mof;
    EXPECT_FALSE(mof.reader.readFile(row.file, kNamespace));
    EXPECT_EQ(mof.firstLine(), row.problem);
  }
}

// Resolved classes hold their inherited features, so short texts could fill the memory.
TEST(MofReader, NumbersOfClassesAndNamespacesAreBounded) {
  std::string classes, namespaces;
  std::string heirs = "class A {";
  for (int i = 0; i <= 65536; ++i) classes += "class C" + std::to_string(i) + "{};\n";
  for (int i = 0; i <= 4096; ++i) {
    namespaces += "#pragma namespace(\"n" + std::to_string(i) + "\")\nclass C {};\n";
  }
  for (int i = 0; i < 50; ++i) heirs += "uint8 P" + std::to_string(i) + ";";
  heirs += "};\n";
  for (int i = 0; i < 40000; ++i) heirs += "class C" + std::to_string(i) + ":A{};\n";
  const struct {
    std::string mof, expected;
  } cases[] = {{classes, "65537:7: more than 65536 classes"},
               {heirs, "40001:7: more than 2000000 features and qualifiers of all classes"},
               {namespaces, "8192:7: more than 4096 namespaces"}};
  for (const auto& row : cases) {
    Mof mof;
    EXPECT_FALSE(mof.read(row.mof));
    EXPECT_EQ(mof.firstLine(), "t.mof:" + row.expected);
  }
}

TEST(MofReader, CutTextsGiveOneDiagnosticEach) {
  const std::string whole =
      "#pragma locale(\"x\")\nQualifier Q : string[] = {\"\\x41\"}, scope(any), "
      "flavor(restricted);\n"
      "[Q {\"a\"} : tosubclass] class A { [Key] A REF P = \"A.k=1\"; uint8 M([In] real32 a[3]); "
      "};\n"
      "instance of A { P = {'x', -1.5e3, $b}; };";
  for (std::size_t length = 0; length < whole.size(); ++length) {
    Mof mof;
    const bool fine = mof.read(whole.substr(0, length));
    EXPECT_EQ(mof.reader.diagnostics().size(), fine ? 0u : 1u) << whole.substr(0, length);
  }
  Mof mof;
  EXPECT_TRUE(mof.read(whole)) << mof.diagnostics();
}

// Each file stops at what it lacks and goes on later, also when two need each other in turn.
TEST(MofDirectory, OrderOfFilesDoesNotMatterAndFoldersNameTheNamespaces) {
  const TemporaryTree tree;
  write("root/host/a.mof", "class A {};");
  write("root/host/notes.txt", "not MOF");
  write("a.mof", "class A1 {}; class A2 : b1 {}; class A3 : B2 {};");
  write("b.mof", "class B1 : A1 {}; class B2 : A2 {};");
  write("c.mof", "class C { [Mine] uint8 P; };");
  write("d.mof", "class D : E {};");
  write("e.mof", "#pragma include(\"q.mof\")\nclass E : C { [mine] uint8 Q; };");
  write("q.mof", "Qualifier MINE : boolean, scope(property);");
  Mof mof;
  ASSERT_TRUE(mof.reader.readDirectory(".", kNamespace)) << mof.diagnostics();
  EXPECT_TRUE(mof.repository.hasClass("root/host", "A"));
  EXPECT_TRUE(mof.repository.isSubclass(kNamespace, "A3", "A1"));
  EXPECT_EQ(mof.classAsText("D"), "D : E\n[Mine^=TRUE] uint8 P (C^)\n[mine^=TRUE] uint8 Q (E^)\n");
}

TEST(MofDirectory, LongChainsInReverseOrder) {
  const TemporaryTree tree;
  for (int i = 0; i < 500; ++i) {
    const std::string name = std::to_string(1000 + i);
    write(name + ".mof", "class C" + name + " : C" + std::to_string(1001 + i) + " {};");
  }
  write("z.mof", "class C1500 { [Key] uint8 K; };");
  Mof mof;
  ASSERT_TRUE(mof.reader.readDirectory(".", kNamespace)) << mof.diagnostics();
  EXPECT_EQ(mof.classAsText("C1000"), "C1000 : C1001\n[Key^=TRUE] uint8 K (C1500^)\n");
}

TEST(MofDirectory, EachFileHasItsOwnDiagnosticInOrder) {
  const TemporaryTree tree;
  write("a.mof", "class A : Never {};\nclass B {};");
  write("b.mof", "class C { uint9 x; };");
  write("bad-name/c.mof", "class D {};");
  write("d.mof", "class E : E {};");
  write("e.mof", "class F {};");
  ASSERT_EQ(symlink("nowhere", "f.mof"), 0);
  Mof mof;
  EXPECT_FALSE(mof.reader.readDirectory(".", kNamespace));
  std::string places;
  for (const auto& diagnostic : mof.reader.diagnostics()) {
    places += std::filesystem::path(diagnostic.file).filename().string() + ':' +
              std::to_string(diagnostic.line) + ':' + std::to_string(diagnostic.column) + ": " +
              diagnostic.message + '\n';
  }
  EXPECT_EQ(places,
            "a.mof:1:11: unknown superclass 'Never'\n"
            "b.mof:1:11: unknown data type 'uint9' (a reference is written CLASS REF name)\n"
            "c.mof:0:0: the names of its folders are not a namespace\n"
            "d.mof:1:11: unknown superclass 'E'\n"
            "f.mof:0:0: No such file or directory\n");
  EXPECT_TRUE(mof.repository.hasClass(kNamespace, "F"));
  Mof none;
  EXPECT_FALSE(none.reader.readDirectory("none", kNamespace));
  EXPECT_FALSE(none.reader.readDirectory("a.mof", kNamespace));
  EXPECT_EQ(none.diagnostics(),
            "none: error: cannot read the folder: No such file or directory\n"
            "a.mof: error: cannot read the folder: Not a directory\n");
}

}  // namespace
}  // namespace cimhost_test
