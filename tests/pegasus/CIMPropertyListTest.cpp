#include <Pegasus/Common/CIMPropertyList.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

TEST(CIMPropertyList, NullMeansAllAndEmptyMeansNone) {
  CIMPropertyList list;
  EXPECT_TRUE(list.isNull());
  EXPECT_TRUE(list.useThisProperty(CIMName("x")));
  EXPECT_FALSE(list.contains(CIMName("x")));
  EXPECT_EQ(text(list.toString()), "NULL");
  list.set(Array<CIMName>());
  EXPECT_FALSE(list.isNull());
  EXPECT_FALSE(list.useThisProperty(CIMName("x")));
  EXPECT_EQ(text(list.toString()), "EMPTY");
}

TEST(CIMPropertyList, FindsNamesInAnyCase) {
  Array<CIMName> names;
  names.append(CIMName("A"));
  names.append(CIMName("b"));
  CIMPropertyList list(names);
  EXPECT_EQ(text(list.toString()), "A, b");
  EXPECT_TRUE(list.contains(CIMName("B")) && list.useThisProperty(CIMName("a")));
  EXPECT_FALSE(list.useThisProperty(CIMName("c")));
  names.append(CIMName("c"));
  EXPECT_EQ(list.size(), 2u);
  EXPECT_EQ(thrownMessage<IndexOutOfBoundsException>([&] { list[2]; }), "index out of bounds");
  list.clear();
  EXPECT_TRUE(list.isNull());
  EXPECT_EQ(list.size(), 0u);
}

TEST(CIMPropertyList, RefusesANullNameAndKeepsWhatItHad) {
  Array<CIMName> names(1, CIMName("A"));
  CIMPropertyList list(names);
  names.append(CIMName());
  EXPECT_EQ(thrownMessage<UninitializedObjectException>([&] { list.set(names); }),
            "uninitialized object");
  EXPECT_EQ(text(list.toString()), "A");
}

}  // namespace
