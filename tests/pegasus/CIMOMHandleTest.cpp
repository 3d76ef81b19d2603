#include <Pegasus/Embedded/CIMOMHandleRep.h>
#include <Pegasus/Provider/CIMOMHandle.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;

namespace {

/// Answers from the arguments, so that a swapped one shows.
class EchoHost : public CIMOMHandleRep {
 public:
  CIMClass getClass(const OperationContext&, const CIMNamespaceName&, const CIMName& className,
                    Boolean localOnly, Boolean includeQualifiers, Boolean includeClassOrigin,
                    const CIMPropertyList& propertyList) override {
    return CIMClass(className,
                    flags(localOnly, includeQualifiers, includeClassOrigin, propertyList.isNull()));
  }
  CIMInstance getInstance(const OperationContext&, const CIMNamespaceName&,
                          const CIMObjectPath& instanceName, Boolean localOnly,
                          Boolean includeQualifiers, Boolean includeClassOrigin,
                          const CIMPropertyList& propertyList) override {
    CIMInstance instance(instanceName.getClassName());
    instance.addProperty(CIMProperty(
        flags(localOnly, includeQualifiers, includeClassOrigin, propertyList.isNull()), Uint32(0)));
    return instance;
  }
  Array<CIMInstance> enumerateInstances(const OperationContext&, const CIMNamespaceName& nameSpace,
                                        const CIMName&, Boolean, Boolean, Boolean, Boolean,
                                        const CIMPropertyList&) override {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, nameSpace.getString());
  }

 private:
  static CIMName flags(Boolean a, Boolean b, Boolean c, Boolean d) {
    String name("f");
    for (Boolean flag : {a, b, c, d}) name.append(Char16(flag ? '1' : '0'));
    return name;
  }
};

template <class Action>
std::pair<CIMStatusCode, std::string> statusOf(Action action) {
  try {
    action();
  } catch (const CIMException& exception) {
    return {exception.getCode(), text(exception.getMessage())};
  }
  return {CIM_ERR_SUCCESS, ""};
}

class CIMOMHandleTest : public testing::Test {
 protected:
  ~CIMOMHandleTest() override { setEmbeddedHost(nullptr); }

  const OperationContext context_;
  const CIMNamespaceName root_{"root/x"};
};

TEST_F(CIMOMHandleTest, ReachesTheHostOfItsConstruction) {
  CIMOMHandle before;
  EchoHost host;
  setEmbeddedHost(&host);
  CIMOMHandle handle;
  setEmbeddedHost(nullptr);
  CIMOMHandle copy(handle);
  const CIMClass cls = copy.getClass(context_, root_, CIMName("A"), true, false, true, {});
  EXPECT_EQ(text(cls.getClassName().getString()), "A");
  EXPECT_EQ(text(cls.getSuperClassName().getString()), "f1011");
  const CIMInstance instance = copy.getInstance(context_, root_, CIMObjectPath(String("B.k=1")),
                                                false, true, false, Array<CIMName>());
  EXPECT_EQ(text(instance.getProperty(0).getName().getString()), "f0100");
  EXPECT_EQ(statusOf([&] {
              copy.enumerateInstances(context_, root_, CIMName("A"), true, true, true, true, {});
            }),
            std::make_pair(CIM_ERR_INVALID_NAMESPACE, std::string("root/x")));
  EXPECT_EQ(
      statusOf([&] { before.getClass(context_, root_, CIMName("A"), true, true, true, {}); }).first,
      CIM_ERR_FAILED);
}

TEST_F(CIMOMHandleTest, RefusesWhatTheHostDoesNotOffer) {
  EchoHost host;
  setEmbeddedHost(&host);
  CIMOMHandle handle;
  const CIMObjectPath path(String("A.k=1"));
  Array<CIMParamValue> out;
  EXPECT_EQ(statusOf([&] { handle.deleteInstance(context_, root_, path); }).first,
            CIM_ERR_NOT_SUPPORTED);
  EXPECT_EQ(
      statusOf([&] { handle.invokeMethod(context_, root_, path, CIMName("M"), out, out); }).first,
      CIM_ERR_NOT_SUPPORTED);
  setEmbeddedHost(nullptr);
  CIMOMHandle detached;
  EXPECT_EQ(statusOf([&] { detached.deleteInstance(context_, root_, path); }).first,
            CIM_ERR_FAILED);
  detached.disallowProviderUnload();
  detached.allowProviderUnload();
}

}  // namespace
