#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/CIMPropertyList.h>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

TEST(CIMName, IsLegalOrRefused) {
  for (const char* name : {"A", "_a", "A_b9", "\xC3\xA9t\xC3\xA9", "\xEF\xBF\xAF"}) {
    EXPECT_EQ(text(CIMName(name).getString()), name);
    EXPECT_TRUE(CIMName::legal(name));
  }
  for (const char* name : {"", "1a", "a b", "a.b", "a:b", " a", "a ", "a/b", "\xEF\xBF\xB0",
                           "a\xF0\x9F\x98\x80\xEF\xBF\xBD"}) {
    const std::string message = std::string("The CIM name is not valid: ") + name;
    CIMName assigned("kept");
    EXPECT_EQ(thrownMessage<InvalidNameException>([&] { CIMName x(name); }), message);
    EXPECT_EQ(thrownMessage<InvalidNameException>([&] { assigned = String(name); }), message);
    EXPECT_EQ(text(assigned.getString()), "kept");
    EXPECT_FALSE(CIMName::legal(name));
  }
  EXPECT_THROW(CIMName(String("a\0b", 3)), InvalidNameException);
  EXPECT_THROW(CIMName(std::string(1 << 20, '-').c_str()), InvalidNameException);
}

TEST(CIMNamespaceName, IsLegalOrRefused) {
  for (const char* name : {"root", "r1/_x", "a/b/c/d"}) {
    EXPECT_EQ(text(CIMNamespaceName(name).getString()), name);
    EXPECT_EQ(text(CIMNamespaceName(String("/") + String(name)).getString()), name);
  }
  for (const char* name : {"", "/", "//root", "root/", "root//a", "root/1a", "root/a b", "root/a.b",
                           "1root", "root:a"}) {
    EXPECT_EQ(thrownMessage<InvalidNamespaceNameException>([&] { CIMNamespaceName x(name); }),
              std::string("invalid CIM namespace name: ") + name);
    EXPECT_FALSE(CIMNamespaceName::legal(name));
  }
}

TEST(CIMPropertyList, NullMeansAllAndEmptyMeansNone) {
  CIMPropertyList list;
  EXPECT_TRUE(list.isNull() && list.useThisProperty(CIMName("x")));
  EXPECT_FALSE(list.contains(CIMName("x")));
  EXPECT_EQ(text(list.toString()), "NULL");
  list.set(Array<CIMName>());
  EXPECT_FALSE(list.isNull() || list.useThisProperty(CIMName("x")));
  EXPECT_EQ(text(list.toString()), "EMPTY");
  Array<CIMName> names(1, CIMName("A"));
  names.append(CIMName("b"));
  list.set(names);
  EXPECT_EQ(text(list.toString()), "A, b");
  names.append(CIMName());
  EXPECT_EQ(thrownMessage<UninitializedObjectException>([&] { list.set(names); }),
            "uninitialized object");
  EXPECT_EQ(list.size(), 2u);
  EXPECT_EQ(thrownMessage<IndexOutOfBoundsException>([&] { list[2]; }), "index out of bounds");
}

}  // namespace
