#include <Pegasus/Common/CIMType.h>
#include <Pegasus/Common/Exception.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

template <class E, class... Arguments>
std::string message(const Arguments&... arguments) {
  return thrownMessage<E>([&] { throw E(arguments...); });
}

TEST(Exception, Messages) {
  EXPECT_EQ(message<Exception>("100% %s"), "100% %s");
  EXPECT_EQ(message<IndexOutOfBoundsException>(), "index out of bounds");
  EXPECT_EQ(message<UninitializedObjectException>(), "uninitialized object");
  EXPECT_EQ(message<TypeMismatchException>(), "type mismatch");
  EXPECT_EQ(message<TypeMismatchException>("x"), "type mismatch: x");
  EXPECT_EQ(message<DynamicCastFailedException>(), "dynamic cast failed");
  EXPECT_EQ(message<AlreadyExistsException>("x"), "already exists: x");
  EXPECT_EQ(message<InvalidNameException>("x"), "The CIM name is not valid: x");
  EXPECT_EQ(message<InvalidNamespaceNameException>("x"), "invalid CIM namespace name: x");
  EXPECT_EQ(message<InvalidDateTimeFormatException>(), "invalid datetime format");
  EXPECT_EQ(message<DateTimeOutOfRangeException>("x"), "DateTime is out of range : x");
  EXPECT_EQ(message<MalformedObjectNameException>("x"), "malformed object name: x");
}

TEST(Exception, CimExceptionKeepsCodeAndMessage) {
  try {
    throw CIMException(CIM_ERR_NOT_SUPPORTED, "CommonProvider::deleteInstance");
  } catch (const CIMException& exception) {
    CIMException copy;
    EXPECT_EQ(copy.getCode(), CIM_ERR_SUCCESS);
    EXPECT_EQ(text(copy.getMessage()), "");
    copy = exception;
    EXPECT_EQ(copy.getCode(), CIM_ERR_NOT_SUPPORTED);
    EXPECT_EQ(text(copy.getMessage()), "CommonProvider::deleteInstance");
  }
}

TEST(Constants, HaveTheirNames) {
  EXPECT_STREQ(cimStatusCodeToString(CIM_ERR_SUCCESS), "CIM_ERR_SUCCESS");
  EXPECT_STREQ(cimStatusCodeToString(CIM_ERR_METHOD_NOT_FOUND), "CIM_ERR_METHOD_NOT_FOUND");
  EXPECT_STREQ(cimStatusCodeToString(static_cast<CIMStatusCode>(18)), "empty");
  EXPECT_STREQ(cimStatusCodeToString(static_cast<CIMStatusCode>(29)),
               "Unrecognized CIM status code");
  EXPECT_STREQ(cimStatusCodeToString(CIM_ERR_NAMESPACE_NOT_EMPTY), "CIM_ERR_NAMESPACE_NOT_EMPTY");
  EXPECT_STREQ(cimStatusCodeToString(CIM_ERR_SERVER_IS_SHUTTING_DOWN),
               "CIM_ERR_SERVER_IS_SHUTTING_DOWN");
  EXPECT_STREQ(cimTypeToString(CIMTYPE_BOOLEAN), "boolean");
  EXPECT_STREQ(cimTypeToString(CIMTYPE_DATETIME), "datetime");
  EXPECT_STREQ(cimTypeToString(CIMTYPE_INSTANCE), "instance");
}

}  // namespace
