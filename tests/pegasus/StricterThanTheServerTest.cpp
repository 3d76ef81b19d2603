// What the server's library leaves undefined, and this one does not: built with this one alone.
// It crashes or reads freed memory where it is handed a part of the very object that is changed, on
// ranges past the end and on empty handles; nested references take it exponential time; it sorts
// the keys of its caller, and knows no moves: there a move is a copy.
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/OperationContext.h>

#include <utility>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

TEST(StricterArray, RefusesRangesPastTheEnd) {
  Array<String> array(4u, String("kept"));
  EXPECT_THROW(array.remove(2, 3), IndexOutOfBoundsException);
  EXPECT_THROW(array.remove(2, PEG_NOT_FOUND), IndexOutOfBoundsException);
  EXPECT_THROW(array.grow(PEG_NOT_FOUND, String()), std::bad_alloc);
  EXPECT_THROW(CIMInstance().clone(), UninitializedObjectException);
  ASSERT_EQ(array.size(), 4u);
  EXPECT_EQ(text(array[3]), "kept");
}

TEST(StricterArray, AddsItsOwnElements) {
  Array<String> array;
  array.append("0123456789 long enough to be destroyed visibly");
  for (int i = 0; i < 6; ++i) array.append(static_cast<const Array<String>&>(array)[0]);
  for (int i = 0; i < 4; ++i) array.appendArray(array);
  array.insert(3, array.getData(), array.size());
  array.prepend(array.getData()[5]);
  EXPECT_EQ(array.size(), 2u * 7u * 16u + 1u);
  for (Uint32 i = 0; i < array.size(); ++i) EXPECT_EQ(array[i], array[0]);
}

TEST(StricterString, AppendsPartsOfItself) {
  String str("ab");
  for (int i = 0; i < 12; ++i) str.append(str);
  EXPECT_EQ(str.size(), 2u << 12);
  str.append(str.getChar16Data() + 1, 3);
  EXPECT_EQ(text(str.subString(str.size() - 5)), "abbab");
  for (int i = 0; i < 9; ++i) str.append(static_cast<const String&>(str)[0]);
  EXPECT_EQ(text(str.subString(str.size() - 3)), "aaa");
}

TEST(StricterString, PrintsTextOfAnyLength) {
  String str("x");
  str.appendPrintf("=%d %s", 5, std::string(2000, 'y').c_str());
  EXPECT_EQ(text(str), "x=5 " + std::string(2000, 'y'));
}

TEST(StricterValue, WritesHalfACharacterAtTheEnd) {
  for (const int half : {0xD800, 0xDBFF, 0xDC00}) {
    EXPECT_EQ(text(CIMValue(String("a").append(Char16(Uint16(half)))).toString()), "a\xEF\xBF\xBD");
  }
}

TEST(StricterPath, LeavesTheCallersKeysAlone) {
  Array<CIMKeyBinding> keys;
  keys.append(CIMKeyBinding("zeta", "1", CIMKeyBinding::NUMERIC));
  keys.append(CIMKeyBinding("alpha", "B.z=1,a=2", CIMKeyBinding::REFERENCE));
  CIMObjectPath path("", "root", "A", keys);
  path.setKeyBindings(keys);
  EXPECT_EQ(text(path.toString()), R"(root:A.alpha="B.a=2,z=1",zeta=1)");
  EXPECT_EQ(text(keys[0].getName().getString()), "zeta");
  EXPECT_EQ(text(keys[1].getValue()), "B.z=1,a=2");
}

TEST(StricterPath, IsSetToAPartOfItself) {
  CIMObjectPath path(String("//host/root:A.k=1"));
  path.set(path.getHost());
  EXPECT_EQ(text(path.toString()), "host");
  path.setHost(path.getClassName().getString());
  EXPECT_EQ(text(path.toString()), "//host/:host");
}

// Every level doubles the backslashes, so depth 16 is a text of some hundred kilobytes.
TEST(StricterPath, ParsesDeeplyNestedReferences) {
  CIMObjectPath nested(String("A.k=1"));
  for (int i = 0; i < 16; ++i) {
    const CIMKeyBinding key("r", nested.toString(), CIMKeyBinding::REFERENCE);
    nested = CIMObjectPath("", "root", "B", Array<CIMKeyBinding>(1, key));
  }
  const String nestedText = nested.toString();
  EXPECT_GT(nestedText.size(), 1u << 16);
  const CIMObjectPath parsed(nestedText);
  EXPECT_TRUE(parsed == nested);
  EXPECT_TRUE(parsed.toString() == nestedText);
  EXPECT_EQ(parsed.getKeyBindings()[0].getType(), CIMKeyBinding::REFERENCE);
}

TEST(StricterContext, SetsTheContainerThatItHolds) {
  OperationContext context;
  context.insert(IdentityContainer(String("guest")));
  context.set(context.get(IdentityContainer::NAME));
  EXPECT_EQ(text(IdentityContainer(context.get(IdentityContainer::NAME)).getUserName()), "guest");
}

// NOLINTBEGIN(bugprone-use-after-move): what was moved from must stay usable
TEST(Moves, LeaveAnEmptyObject) {
  String str("moved");
  const String strTarget(std::move(str));
  str.append(String("again"));
  EXPECT_EQ(text(strTarget) + " " + text(str), "moved again");

  CIMObjectPath path(String("//host/root:A.k=1"));
  const CIMObjectPath pathTarget(std::move(path));
  path.setHost(pathTarget.getHost());
  EXPECT_EQ(text(pathTarget.toString()) + " " + text(path.toString()),
            "//host/root:A.k=1 //host/:");

  CIMValue value(Array<String>(1u, String("moved")));
  const CIMValue valueTarget(std::move(value));
  EXPECT_EQ(text(valueTarget.toString()), "moved ");
  EXPECT_TRUE(value.isNull() && value.getArraySize() == 0);
}
// NOLINTEND(bugprone-use-after-move)

// The server's text has more attributes and other white space; it promises none of it.
TEST(ObjectText, IsEscaped) {
  CIMInstance instance(CIMName("A"));
  instance.addProperty(CIMProperty(CIMName("p"), String("<&\">%s")));
  instance.addProperty(CIMProperty(CIMName("n"), CIMValue(CIMTYPE_UINT32, true)));
  EXPECT_EQ(text(CIMObject(instance).toString()),
            "<INSTANCE CLASSNAME=\"A\"><PROPERTY NAME=\"p\" TYPE=\"string\">"
            "<VALUE>&lt;&amp;&quot;&gt;%s</VALUE></PROPERTY>"
            "<PROPERTY NAME=\"n\" TYPE=\"uint32\" ARRAY=\"true\"></PROPERTY></INSTANCE>");
  CIMClass cls(CIMName("A"));
  CIMMethod method(CIMName("Run"), CIMTYPE_UINT32);
  method.addParameter(CIMParameter(CIMName("In"), CIMTYPE_UINT8, true));
  method.addQualifier(CIMQualifier(CIMName("q"), Boolean(true)));
  cls.addQualifier(CIMQualifier(CIMName("r"), CIMValue(CIMTYPE_STRING, false)));
  cls.addMethod(method);
  EXPECT_EQ(text(CIMObject(cls).toString()),
            "<CLASS NAME=\"A\"><QUALIFIER NAME=\"r\" TYPE=\"string\"></QUALIFIER><METHOD "
            "NAME=\"Run\" TYPE=\"uint32\">"
            "<QUALIFIER NAME=\"q\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>"
            "<PARAMETER NAME=\"In\" TYPE=\"uint8\" ARRAY=\"true\"></PARAMETER></METHOD></CLASS>");
}

}  // namespace
