// Handles share, clones do not.
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMParamValue.h>

#include <atomic>
#include <thread>
#include <type_traits>
#include <utility>
#include <vector>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

template <class Handle>
Uint32 number(const Handle& handle) {
  Uint32 x = 0;
  handle.getValue().get(x);
  return x;
}

CIMClass makeClass() {
  CIMClass cls(CIMName("A"));
  CIMProperty property(CIMName("p"), Uint32(1));
  property.addQualifier(CIMQualifier(CIMName("q"), Uint32(1)));
  property.addQualifier(CIMQualifier(CIMName("r"), Uint32(1)));
  CIMMethod method(CIMName("m"), CIMTYPE_UINT32);
  CIMParameter parameter(CIMName("a"), CIMTYPE_UINT32);
  parameter.addQualifier(CIMQualifier(CIMName("q"), Uint32(1)));
  method.addParameter(parameter);
  cls.addQualifier(CIMQualifier(CIMName("q"), Uint32(1)));
  cls.addProperty(property);
  cls.addMethod(method);
  return cls;
}

TEST(Handles, CopiesAndContainersShare) {
  CIMInstance i(CIMName("A"));
  CIMProperty p(CIMName("p"), Uint32(1));
  i.addProperty(p);
  const CIMConstProperty reader = p;
  const CIMObject object(i);
  CIMInstance j = i, k = i.clone();
  p.setValue(Uint32(2));
  EXPECT_EQ(number(reader), 2u);
  j.getProperty(0).setValue(Uint32(3));
  Array<CIMInstance>(1, j)[0].setPath(CIMObjectPath(String("root/x:A.k=1")));
  EXPECT_EQ(number(i.getProperty(0)) + number(object.getProperty(0)), 6u);
  EXPECT_EQ(text(i.getPath().toString()), "root/x:A.k=1");
  EXPECT_EQ(number(k.getProperty(0)), 1u);
  EXPECT_EQ(text(k.getPath().toString()), "A");
}

TEST(Handles, ReferencesShowLaterChanges) {
  CIMClass original = makeClass();
  CIMClass clone = original.clone();
  for (CIMClass cls : {original, clone}) {
    CIMProperty p = cls.getProperty(0);
    const CIMValue& value = p.getValue();
    const CIMObjectPath& path = cls.getPath();
    p.setValue(Uint32(9));
    cls.setPath(CIMObjectPath(String("root/x:A")));
    EXPECT_EQ(text(value.toString()) + text(path.toString()), "9root/x:A");
  }
}

TEST(Handles, ParameterValuesShare) {
  CIMParamValue a(String("n"), Uint32(1));
  CIMParamValue b = a, c = a.clone();
  CIMValue two(Uint32(2));
  String name("m");
  b.setValue(two);
  b.setParameterName(name);
  b.setIsTyped(false);
  EXPECT_TRUE(number(a) == 2 && text(a.getParameterName()) == "m" && !a.isTyped());
  EXPECT_TRUE(number(c) == 1 && text(c.getParameterName()) == "n" && c.isTyped());
}

TEST(Clones, AHandleFromAfterTheCloneChangesItsSideOnly) {
  for (const bool changeClone : {false, true}) {
    const CIMClass original = makeClass();
    const CIMClass clone = original.clone();
    CIMClass changed = changeClone ? clone : original;
    const CIMClass other = changeClone ? original : clone;
    CIMQualifier q = changed.getProperty(0).getQualifier(0);
    q.setValue(Uint32(2));
    changed.getProperty(0).getQualifier(1).setFlavor(CIMFlavor::TOINSTANCE);
    changed.getMethod(0).getParameter(0).getQualifier(0).setValue(Uint32(2));
    changed.getMethod(0).setType(CIMTYPE_STRING);
    changed.getProperty(0).removeQualifier(0);
    changed.getQualifier(0).setPropagated(true);
    q.setValue(Uint32(3));  // in no container any more
    EXPECT_EQ(changed.getProperty(0).getQualifierCount(), 1u);
    EXPECT_EQ(number(changed.getMethod(0).getParameter(0).getQualifier(0)), 2u);
    EXPECT_TRUE(other.identical(makeClass()));
    EXPECT_FALSE(changed.identical(other));
  }
}

// The handle and all its containers see the change, the clone of one of them does not.
TEST(Clones, AHandleFromBeforeTheCloneStaysInItsContainers) {
  CIMClass one = makeClass(), two = makeClass();
  CIMQualifier shared(CIMName("shared"), Uint32(1));
  CIMProperty first = one.getProperty(0), second = two.getProperty(0);
  first.addQualifier(shared);
  second.addQualifier(shared);
  const CIMClass clone = one.clone();
  shared.setValue(Uint32(2));
  one.getProperty(0).getQualifier(2).setValue(Uint32(number(shared) + 1));
  EXPECT_EQ(number(two.getProperty(0).getQualifier(2)), 3u);
  EXPECT_EQ(number(clone.getProperty(0).getQualifier(2)), 1u);
  two.clone();  // gone at once
  CIMQualifier own = two.getQualifier(0);
  const CIMClass later = two.clone();
  own.setValue(Uint32(2));
  EXPECT_EQ(number(later.getQualifier(0)), 1u);
}

/// Changes every kind of element of a clone; true when the result is as expected.
bool changesAlone(CIMClass cls, Uint32 to) {
  cls.getProperty(0).setValue(to);
  cls.getProperty(0).getQualifier(0).setValue(to);
  CIMQualifier q = cls.getMethod(0).getParameter(0).getQualifier(0);
  q.setValue(to);
  const CIMConstClass next = cls.clone();
  q.setValue(Uint32(0));
  return number(next.getProperty(0)) == to && number(next.getProperty(0).getQualifier(0)) == to &&
         number(next.getMethod(0).getParameter(0).getQualifier(0)) == to;
}

// For the thread sanitizer, too.
TEST(Clones, AreIndependentFromTheFirstInSeveralThreads) {
  for (int round = 0; round < 40; ++round) {
    // Fresh, so that the threads race for the very first clone.
    const CIMClass shared = makeClass();
    std::atomic<int> good{0};
    std::vector<std::thread> threads;
    for (Uint32 t = 0; t < 3; ++t) {
      threads.emplace_back([&, t] {
        for (Uint32 i = 0; i < 10; ++i) {
          good += changesAlone(shared.clone(), t * 100 + i);
          good += number(shared.getProperty(0).getQualifier(1)) == 1;
        }
      });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(good, 60);
    EXPECT_TRUE(shared.identical(makeClass()));
  }
}

// What must not compile, so that sources which build here also build against a CIM server.
template <class X, class ConstX>
void expectOneWay() {
  static_assert(std::is_convertible_v<X, ConstX> && std::is_assignable_v<ConstX&, X>);
  static_assert(!std::is_constructible_v<X, ConstX> && !std::is_assignable_v<X&, ConstX>);
  // A reference to the const variant would let an assignment go round its promise.
  static_assert(!std::is_convertible_v<X&, ConstX&>);
  static_assert(std::is_same_v<decltype(std::declval<const ConstX&>().clone()), X>);
}

TEST(Handles, ConstVariantsOnlyRead) {
  expectOneWay<CIMQualifier, CIMConstQualifier>();
  expectOneWay<CIMProperty, CIMConstProperty>();
  expectOneWay<CIMParameter, CIMConstParameter>();
  expectOneWay<CIMMethod, CIMConstMethod>();
  expectOneWay<CIMClass, CIMConstClass>();
  expectOneWay<CIMInstance, CIMConstInstance>();
  expectOneWay<CIMObject, CIMConstObject>();
}

}  // namespace
