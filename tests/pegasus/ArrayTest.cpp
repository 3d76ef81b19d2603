#include <Pegasus/Common/Array.h>
#include <Pegasus/Common/CIMName.h>
#include <gtest/gtest.h>

#include <initializer_list>
#include <string>
#include <type_traits>
#include <utility>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;

namespace {

Array<Uint32> numbers(std::initializer_list<Uint32> values) {
  return Array<Uint32>(values.begin(), Uint32(values.size()));
}

template <class T>
std::string joined(const Array<T>& array) {
  std::string result;
  for (Uint32 i = 0; i < array.size(); ++i) {
    if constexpr (std::is_same_v<T, String>) {
      result += text(array[i]) + " ";
    } else {
      result += std::to_string(array[i]) + " ";
    }
  }
  return result;
}

TEST(Array, Constructs) {
  EXPECT_EQ(joined(Array<Uint32>()), "");
  EXPECT_EQ(joined(Array<Uint32>(3u)), "0 0 0 ");
  EXPECT_EQ(joined(Array<Uint32>(2u, 7u)), "7 7 ");
  EXPECT_EQ(joined(Array<String>(2u, String("x"))), "x x ");
  EXPECT_EQ(joined(numbers({1, 2, 3})), "1 2 3 ");
  EXPECT_NE(Array<Uint64>().getData(), nullptr);
  EXPECT_EQ(Array<Uint32>(nullptr, 0u).size(), 0u);
}

TEST(Array, EditsInPlace) {
  Array<Uint32> array = numbers({1, 2});
  const Uint32 more[] = {8, 9};
  array.insert(0, 0);
  array.insert(3, 3);
  array.insert(1, more, 2);
  EXPECT_EQ(joined(array), "0 8 9 1 2 3 ");
  array.prepend(7);
  array.prepend(more, 2);
  array.append(more, 2);
  array.grow(2, 5);
  EXPECT_EQ(joined(array), "8 9 7 0 8 9 1 2 3 8 9 5 5 ");
  array.remove(0);
  array.remove(2, 4);
  array.remove(7, 1);
  EXPECT_EQ(joined(array), "9 7 2 3 8 9 5 ");
  array.remove(0, array.size());
  array.appendArray(numbers({4}));
  array.reserveCapacity(100);
  EXPECT_GE(array.getCapacity(), 100u);
  EXPECT_EQ(joined(array), "4 ");
}

TEST(Array, RefusesRangesPastTheEnd) {
  Array<Uint32> array = numbers({0, 9, 1, 2});
  const Array<Uint32>& constant = array;
  EXPECT_THROW(array[4], IndexOutOfBoundsException);
  EXPECT_THROW(constant[4], IndexOutOfBoundsException);
  EXPECT_THROW(constant[PEG_NOT_FOUND], IndexOutOfBoundsException);
  EXPECT_THROW(array.insert(5, 1), IndexOutOfBoundsException);
  EXPECT_THROW(array.insert(99, 1), IndexOutOfBoundsException);
  EXPECT_THROW(array.remove(99), IndexOutOfBoundsException);
  EXPECT_EQ(joined(array), "0 9 1 2 ");
}

TEST(Array, CopiesAreIndependent) {
  const Array<String> original(2u, String("a"));
  Array<String> changed(original);
  changed[0] = String("b");
  Array<String> longer(original);
  longer.append("c");
  Array<String> shorter(original);
  shorter.remove(0);
  Array<String> cleared;
  cleared = original;
  cleared.clear();
  cleared.append("d");
  EXPECT_EQ(joined(original), "a a ");
  EXPECT_EQ(joined(changed), "b a ");
  EXPECT_EQ(joined(longer), "a a c ");
  EXPECT_EQ(joined(shorter), "a ");
  EXPECT_EQ(joined(cleared), "d ");
  cleared.swap(changed);
  EXPECT_EQ(joined(cleared), "b a ");
}

TEST(Array, BooleansLieSideBySide) {
  Array<Boolean> array(2u, true);
  array.append(false);
  const bool* const data = array.getData();
  EXPECT_TRUE(data[0] && data[1] && !data[2]);
}

}  // namespace
