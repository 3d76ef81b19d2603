#include <Pegasus/Common/CIMName.h>
#include <gtest/gtest.h>

#include <string>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

TEST(CIMName, AcceptsLegalNames) {
  for (const char* name : {"A", "_a", "a1", "A_b9", "\xC3\xA9t\xC3\xA9", "\xEF\xBF\xAF"}) {
    EXPECT_EQ(text(CIMName(name).getString()), name);
    EXPECT_EQ(text(CIMName(String(name)).getString()), name);
    EXPECT_TRUE(CIMName::legal(name));
  }
}

TEST(CIMName, RefusesIllegalNames) {
  for (const char* name : {"", "1a", "a b", "a.b", "a-b", "a:b", " a", "a ", "a/b", "\xEF\xBF\xB0",
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

TEST(CIMName, ComparesIgnoringCase) {
  EXPECT_TRUE(CIMName("Abc") == CIMName("aBC"));
  EXPECT_TRUE(CIMName() == CIMName());
  EXPECT_TRUE(CIMName("A") != CIMName());
  EXPECT_FALSE(CIMName("\xC3\x89") == CIMName("\xC3\xA9"));
  CIMName name("A");
  name.clear();
  EXPECT_TRUE(name.isNull());
  EXPECT_TRUE(name.equal(CIMName()));
  EXPECT_EQ(text(name.getString()), "");
}

TEST(CIMNamespaceName, AcceptsLegalNames) {
  for (const char* name : {"root", "root/cimv2", "r1/_x", "a/b/c/d"}) {
    EXPECT_EQ(text(CIMNamespaceName(name).getString()), name);
    EXPECT_EQ(text(CIMNamespaceName(String("/") + String(name)).getString()), name);
  }
  EXPECT_TRUE(CIMNamespaceName("root/A") == CIMNamespaceName("ROOT/a"));
  EXPECT_TRUE(CIMNamespaceName("root") != CIMNamespaceName());
  CIMNamespaceName name;
  EXPECT_TRUE(name.isNull());
  name = String("/root");
  EXPECT_EQ(text(name.getString()), "root");
}

TEST(CIMNamespaceName, RefusesIllegalNames) {
  for (const char* name : {"", "/", "//root", "root/", "root//a", "root/1a", "root/a b", "root/a.b",
                           "1root", "root:a", "/root/"}) {
    EXPECT_EQ(thrownMessage<InvalidNamespaceNameException>([&] { CIMNamespaceName x(name); }),
              std::string("invalid CIM namespace name: ") + name);
    EXPECT_FALSE(CIMNamespaceName::legal(name));
  }
}

}  // namespace
