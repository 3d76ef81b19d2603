// What must not compile, so that sources which build here also build against a CIM server.
#include <Pegasus/Common/CIMClass.h>
#include <gtest/gtest.h>

#include <type_traits>
#include <utility>

using namespace Pegasus;

namespace {

template <class From, class To>
constexpr bool kConverts = std::is_convertible_v<From, To>;

template <class X, class ConstX>
void expectOneWay() {
  EXPECT_TRUE((kConverts<X, ConstX>));
  EXPECT_TRUE((std::is_assignable_v<ConstX&, X>));
  EXPECT_FALSE((std::is_constructible_v<X, ConstX>));
  EXPECT_FALSE((std::is_assignable_v<X&, ConstX>));
  // A reference to the const variant would let an assignment go round its promise.
  EXPECT_FALSE((kConverts<X&, ConstX&>));
  EXPECT_TRUE((std::is_same_v<decltype(std::declval<const ConstX&>().clone()), X>));
}

TEST(Portability, ConstVariantsOnlyRead) {
  expectOneWay<CIMQualifier, CIMConstQualifier>();
  expectOneWay<CIMProperty, CIMConstProperty>();
  expectOneWay<CIMParameter, CIMConstParameter>();
  expectOneWay<CIMMethod, CIMConstMethod>();
  expectOneWay<CIMClass, CIMConstClass>();
  expectOneWay<CIMInstance, CIMConstInstance>();
  expectOneWay<CIMObject, CIMConstObject>();
}

}  // namespace
