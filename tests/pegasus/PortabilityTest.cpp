// What must not compile, so that sources which build here also build against a CIM server.
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/CIMValue.h>
#include <gtest/gtest.h>

#include <string>
#include <type_traits>
#include <utility>

using namespace Pegasus;

namespace {

template <class From, class To>
constexpr bool kConverts = std::is_convertible_v<From, To>;

template <class T, class = void>
constexpr bool kGets = false;
template <class T>
constexpr bool kGets<T, std::void_t<decltype(std::declval<CIMValue&>().get(std::declval<T&>()))>> =
    true;

TEST(Portability, ConversionsAreThoseOfTheServersApi) {
  EXPECT_FALSE((std::is_constructible_v<CIMValue, long>));
  EXPECT_FALSE((std::is_constructible_v<CIMValue, unsigned long>));
  EXPECT_FALSE((std::is_constructible_v<CIMValue, std::string>));
  EXPECT_FALSE(kGets<long>);
  EXPECT_FALSE(kGets<std::string>);
  EXPECT_TRUE(kGets<Sint64>);
  EXPECT_TRUE((kConverts<Array<CIMInstance>, CIMValue>));

  EXPECT_FALSE((kConverts<CIMObject, CIMInstance>));
  EXPECT_FALSE((kConverts<CIMObject, CIMClass>));
  EXPECT_TRUE((std::is_constructible_v<CIMInstance, CIMObject>));
  EXPECT_TRUE((std::is_constructible_v<CIMClass, CIMObject>));
  EXPECT_TRUE((kConverts<CIMInstance, CIMObject>));
  EXPECT_TRUE((kConverts<CIMClass, CIMObject>));
  EXPECT_TRUE((kConverts<CIMName, CIMInstance>));
  EXPECT_FALSE((kConverts<String, CIMInstance>));
}

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

TEST(Portability, AConstContainerYieldsConstElements) {
  EXPECT_TRUE((std::is_same_v<decltype(std::declval<const CIMInstance&>().getProperty(0)),
                              CIMConstProperty>));
  EXPECT_TRUE((std::is_same_v<decltype(std::declval<CIMInstance&>().getProperty(0)), CIMProperty>));
  EXPECT_TRUE(
      (std::is_same_v<decltype(std::declval<CIMConstClass&>().getMethod(0)), CIMConstMethod>));
  EXPECT_TRUE((std::is_same_v<decltype(std::declval<CIMMethod&>().getParameter(0)), CIMParameter>));
  EXPECT_TRUE((std::is_same_v<decltype(std::declval<CIMConstProperty&>().getQualifier(0)),
                              CIMConstQualifier>));
}

}  // namespace
