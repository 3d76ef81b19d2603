#include <Pegasus/Provider/ProviderException.h>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

template <class E>
void expectCode(CIMStatusCode code) {
  try {
    throw E(String("%s stays as it is"));
  } catch (const CIMOperationFailedException& exception) {
    const CIMException copy(exception);
    EXPECT_EQ(copy.getCode(), code);
    EXPECT_EQ(text(copy.getMessage()), "%s stays as it is");
  }
}

TEST(Exceptions, CarryTheCodesOfTheirNames) {
  expectCode<CIMOperationFailedException>(CIM_ERR_FAILED);
  expectCode<CIMAccessDeniedException>(CIM_ERR_ACCESS_DENIED);
  expectCode<CIMInvalidParameterException>(CIM_ERR_INVALID_PARAMETER);
  expectCode<CIMObjectNotFoundException>(CIM_ERR_NOT_FOUND);
  expectCode<CIMNotSupportedException>(CIM_ERR_NOT_SUPPORTED);
  expectCode<CIMObjectAlreadyExistsException>(CIM_ERR_ALREADY_EXISTS);
  expectCode<CIMPropertyNotFoundException>(CIM_ERR_NO_SUCH_PROPERTY);
  expectCode<CIMMethodNotFoundException>(CIM_ERR_METHOD_NOT_FOUND);
  EXPECT_STREQ(cimStatusCodeToString(static_cast<CIMStatusCode>(18)), "empty");
  EXPECT_STREQ(cimStatusCodeToString(CIM_ERR_SERVER_IS_SHUTTING_DOWN),
               "CIM_ERR_SERVER_IS_SHUTTING_DOWN");
  EXPECT_STREQ(cimStatusCodeToString(static_cast<CIMStatusCode>(29)),
               "Unrecognized CIM status code");
}

}  // namespace
