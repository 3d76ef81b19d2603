#include "cimhost/repository/ClassRepository.h"

#include "cimhost/repository/ClassDeclarationError.h"
#include "tests/cimhost/mof/MofTestSupport.h"

#include <gtest/gtest.h>

#include <functional>
#include <sstream>

namespace cimhost_test {
namespace {

using namespace Pegasus;

std::string names(const std::vector<CIMName>& list) {
  std::string result;
  for (const CIMName& name : list) result += text(name.getString()) + ' ';
  return result;
}

// What a class looks like at the end of a chain of declarations.
TEST(ClassRepository, Inheritance) {
  const struct {
    const char* mof;
    const char* cimClass;
    const char* expected;
  } cases[] = {
      // Inherited features first, then the class's own.
      {"class A { uint8 A1; uint8 A2 = 5; }; class B : a { uint8 B1; }; class C : B { uint8 C1; };",
       "C", "C : B\nuint8 A1 (A^)\nuint8 A2 = 5 (A^)\nuint8 B1 (B^)\nuint8 C1 (C)\n"},
      // An overriding feature stands where it is declared, with the old origin.
      {"class A { uint8 X = 1; uint8 Y; uint8 Z; };"
       "class B : A { uint8 N; uint8 y = 3; uint8 X; };",
       "B", "B : A\nuint8 Z (A^)\nuint8 N (B)\nuint8 y = 3 (A)\nuint8 X (A)\n"},
      {"class A { uint8 X; }; class B : A { uint8 X = 1; };"
       "class C : B { uint8 X = 2; }; class D : C {};",
       "D", "D : C\nuint8 X = 2 (A^)\n"},
      {"class A { uint8 M([In] string s); uint8 N(); };"
       "class B : A { uint8 O(); uint8 m([Out] string S, uint8 t); }; class C : B {};",
       "C",
       "C : B\nuint8 N() (A^)\nuint8 O() (B^)\n"
       "uint8 m([Out^=TRUE In^=TRUE] string S, uint8 t) (A^)\n"},
      {"class A { A REF P; }; class B : A { B REF P; };", "B", "B : A\nreference to B P (A)\n"},
      // Restricted qualifiers stay behind.
      {"[Abstract, Description(\"d\"), Version(\"1\"), Deprecated {\"x\"}] class A {"
       " [Experimental, Key] uint8 K; [Deprecated] uint8 M([Experimental, In] uint8 p); };"
       "class B : A {};",
       "B", "[Description^=d] B : A\n[Key^=TRUE] uint8 K (A^)\nuint8 M([In^=TRUE] uint8 p) (A^)\n"},
      // An overriding feature keeps the qualifiers that it does not give.
      {"class A { [Key, Description(\"a\"), MaxLen(3)] string K; };"
       "class B : A { [Override(\"A.k\"), MaxLen(5)] string K; };"
       "class C : B { [Description(\"c\")] string K; };",
       "C", "C : B\n[Description=c MaxLen^=5 Key^=TRUE] string K (A)\n"},
      // A fixed value may be repeated.
      {"[Association] class A { [Key] A REF K; };"
       "[Association(true)] class B : A { [Key(TRUE)] A REF K; };",
       "B", "[Association=TRUE] B : A\n[Key=TRUE] reference to A K (A)\n"},
      // That a class is an association is inherited, for scopes too.
      {"[Association] class A {}; [Aggregation] class B : A {};", "B",
       "[Aggregation=TRUE Association^=TRUE] B : A\n"},
  };
  for (const auto& row : cases) {
    Mof mof;
    mof.read(row.mof);
    EXPECT_EQ(mof.classAsText(row.cimClass), row.expected);
  }
}

const char* const kModel =
    "[Description(\"a\")] class A { [Key] uint8 K; uint8 P; uint8 M([In] uint8 p); };\n"
    "class B : A { [Write] uint8 Q; uint8 p; [Static] uint8 N(); };\n";

TEST(ClassRepository, Filters) {
  const struct {
    bool localOnly, qualifiers, origins;
    const char* list;  // Null: all; else the properties, apart.
    const char* expected;
  } cases[] = {
      {false, true, true, nullptr,
       "[Description^=a] B : A\n[Key^=TRUE] uint8 K (A^)\n[Write=TRUE] uint8 Q (B)\n"
       "uint8 p (A)\nuint8 M([In^=TRUE] uint8 p) (A^)\n[Static=TRUE] uint8 N() (B)\n"},
      {true, false, false, nullptr, "B : A\nuint8 Q ()\nuint8 p ()\nuint8 N() ()\n"},
      {false, false, true, "P k Other",
       "B : A\nuint8 K (A^)\nuint8 p (A)\nuint8 M(uint8 p) (A^)\nuint8 N() (B)\n"},
      {true, false, true, "", "B : A\nuint8 N() (B)\n"},
  };
  Mof mof;
  ASSERT_TRUE(mof.read(kModel));
  for (const auto& row : cases) {
    std::istringstream stream(row.list != nullptr ? row.list : "");
    Array<CIMName> list;
    for (std::string name; stream >> name;) list.append(CIMName(name.c_str()));
    EXPECT_EQ(classText(mof.repository.getClass(
                  "Root/Test", "b", row.localOnly, row.qualifiers, row.origins,
                  row.list == nullptr ? CIMPropertyList() : CIMPropertyList(list))),
              row.expected);
  }
}

TEST(ClassRepository, EveryFetchedClassIsAnother) {
  Mof mof;
  ASSERT_TRUE(mof.read(kModel));
  const std::string before = mof.classAsText("B");
  CIMClass b = mof.get("B");
  EXPECT_EQ(text(b.getPath().toString()), "B");
  b.getProperty(0).setValue(CIMValue(Uint8(7)));
  b.getProperty(1).removeQualifier(0);
  b.getMethod(0).getParameter(0).getQualifier(0).setValue(CIMValue(false));
  b.getMethod(0).setClassOrigin("Z");
  b.removeProperty(2);
  b.removeQualifier(0);
  b.addQualifier(CIMQualifier("Version", CIMValue(String("1"))));
  EXPECT_EQ(mof.classAsText("B"), before);
  // Inherited features are shared inside; filtering one class must not show in the other.
  mof.repository.getClass(kNamespace, "B", false, false, false, CIMPropertyList());
  EXPECT_EQ(mof.classAsText("A"),
            "[Description=a] A\n[Key=TRUE] uint8 K (A)\nuint8 P (A)\nuint8 M([In=TRUE] uint8 p) "
            "(A)\n");
}

TEST(ClassRepository, Hierarchy) {
  Mof mof;
  ASSERT_TRUE(
      mof.read("class A {}; class X {}; class B : A {}; class C : A {}; class D : B {};"
               "class E : X {}; class F : A {};"));
  const cimhost::ClassRepository& repository = mof.repository;
  EXPECT_EQ(names(repository.subclassNames(kNamespace, "a", false)), "B C F ");
  EXPECT_EQ(names(repository.subclassNames(kNamespace, "A", true)), "B C D F ");
  EXPECT_EQ(names(repository.subclassNames(kNamespace, CIMName(), false)), "A X ");
  EXPECT_EQ(names(repository.subclassNames(kNamespace, CIMName(), true)), "A X B C D E F ");
  EXPECT_TRUE(repository.isSubclass(kNamespace, "d", "A"));
  EXPECT_TRUE(repository.isSubclass(kNamespace, "A", "a"));
  EXPECT_FALSE(repository.isSubclass(kNamespace, "A", "D"));
  EXPECT_FALSE(repository.isSubclass(kNamespace, "D", "X"));
  EXPECT_FALSE(repository.isSubclass(kNamespace, "Nope", "Nope"));
  EXPECT_FALSE(repository.isSubclass("root/none", "A", "A"));
  // Deep ones need no stack.
  std::string deep = "class C0 {};";
  for (int i = 1; i < 20000; ++i) {
    deep += "class C" + std::to_string(i) + " : C" + std::to_string(i - 1) + " {};";
  }
  ASSERT_TRUE(mof.read(deep));
  EXPECT_TRUE(repository.isSubclass(kNamespace, "C19999", "C0"));
  EXPECT_EQ(repository.subclassNames(kNamespace, "C0", true).size(), 19999u);
}

TEST(ClassRepository, ErrorsHaveTheCodesOfTheServer) {
  Mof mof;
  ASSERT_TRUE(mof.read("class A { uint8 P; };"));
  cimhost::ClassRepository& repository = mof.repository;
  const struct {
    std::function<void()> action;
    const char* error;
  } cases[] = {
      {[&] { mof.get("Nope"); }, "6:Nope"},
      {[&] { mof.get("A", "root/None"); }, "3:root/None"},
      {[&] { mof.get("A", CIMNamespaceName()); }, "3:"},
      {[&] { repository.subclassNames(kNamespace, "Nope", true); }, "6:Nope"},
      {[&] { repository.subclassNames("none", CIMName(), true); }, "3:none"},
      {[&] { repository.addClass("none", CIMClass("B")); }, "3:none"},
      {[&] { repository.addClass(kNamespace, CIMClass("a")); }, "11:a"},
      {[&] { repository.addClass(kNamespace, CIMClass("B", "C")); }, "10:C"},
      {[&] { repository.addNamespace(CIMNamespaceName()); }, "3:"},
  };
  for (const auto& row : cases) {
    try {
      row.action();
      ADD_FAILURE() << row.error;
    } catch (const CIMException& exception) {
      EXPECT_EQ(std::to_string(exception.getCode()) + ':' + text(exception.getMessage()),
                row.error);
    }
  }
}

// Qualifiers without a flavor, as code rather than a MOF text gives them, follow the declaration.
TEST(ClassRepository, DeclaredClassIsCopiedAndGetsDeclaredFlavors) {
  cimhost::ClassRepository repository;
  repository.addNamespace(kNamespace);
  CIMClass a("A");
  CIMProperty key("K", CIMValue(CIMTYPE_UINT8, false));
  key.addQualifier(CIMQualifier("Key", CIMValue(true)));
  a.addProperty(key);
  repository.addClass(kNamespace, a);
  key.getQualifier(0).setValue(CIMValue(false));
  a.removeProperty(0);
  repository.addClass(kNamespace, CIMClass("B", "A"));
  const CIMClass b = repository.getClass(kNamespace, "B", false, true, true, CIMPropertyList());
  EXPECT_EQ(classText(b), "B : A\n[Key^=TRUE] uint8 K (A^)\n");
  EXPECT_TRUE(b.getProperty(0).getQualifier(0).getFlavor().equal(CIMFlavor::DISABLEOVERRIDE +
                                                                 CIMFlavor::TOSUBCLASS));
}

TEST(ClassRepository, NamespacesAreSeparate) {
  Mof mof;
  ASSERT_TRUE(mof.read("Qualifier Mine : boolean, scope(any); class A { uint8 P; };"));
  ASSERT_TRUE(mof.reader.readText("class A { string S; };", "u.mof", "root/other"));
  mof.repository.addNamespace("ROOT/Test");
  EXPECT_EQ(mof.repository.namespaces().size(), 2u);
  EXPECT_EQ(text(mof.repository.namespaces()[0].getString()), "root/test");
  EXPECT_EQ(classText(mof.get("A", "root/other")), "A\nstring S (A)\n");
  EXPECT_FALSE(mof.repository.findQualifier("root/test", "mine").isUninitialized());
  EXPECT_TRUE(mof.repository.findQualifier("root/other", "mine").isUninitialized());
  EXPECT_FALSE(mof.repository.findQualifier("root/other", "VALUEMAP").isUninitialized());
}

}  // namespace
}  // namespace cimhost_test
