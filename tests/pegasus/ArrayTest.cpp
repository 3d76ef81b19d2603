#include <Pegasus/Common/Array.h>

#include <initializer_list>
#include <sstream>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

Array<Uint32> numbers(std::initializer_list<Uint32> values) {
  return Array<Uint32>(values.begin(), Uint32(values.size()));
}

template <class T>
std::string joined(const Array<T>& array) {
  std::ostringstream result;
  for (Uint32 i = 0; i < array.size(); ++i) result << array[i] << " ";
  return result.str();
}

TEST(Array, ConstructsAndEditsInPlace) {
  EXPECT_EQ(joined(Array<Uint32>(3u)) + joined(Array<Uint32>(2u, 7u)), "0 0 0 7 7 ");
  EXPECT_EQ(Array<Uint32>(nullptr, 0u).size(), 0u);
  EXPECT_NE(Array<Uint64>().getData(), nullptr);
  const Array<Boolean> truths(2u, true);
  const bool* const sideBySide = truths.getData();
  EXPECT_TRUE(sideBySide[0] && sideBySide[1]);

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
  EXPECT_THROW(array.insert(5, 1), IndexOutOfBoundsException);
  EXPECT_THROW(array.remove(99), IndexOutOfBoundsException);
  EXPECT_EQ(joined(array), "0 9 1 2 ");
}

TEST(Array, CopiesAreIndependent) {
  const Array<String> original(2u, String("a"));
  Array<String> changed(original), longer(original), shorter(original), cleared;
  changed[0] = String("b");
  longer.append("c");
  shorter.remove(0);
  cleared = original;
  cleared.clear();
  cleared.append("d");
  EXPECT_EQ(joined(original), "a a ");
  EXPECT_EQ(joined(changed) + joined(longer) + joined(shorter), "b a a a c a ");
  cleared.swap(changed);
  EXPECT_EQ(joined(cleared) + joined(changed), "b a d ");
}

}  // namespace
