#include "tests/cimhost/mof/MofTestSupport.h"

#include <unistd.h>

namespace cimhost_test {
namespace {

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
