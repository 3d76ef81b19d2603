#include <Pegasus/Embedded/CIMOMHandleRep.h>
#include <Pegasus/Provider/CIMOMHandle.h>
#include <gtest/gtest.h>

using namespace Pegasus;

namespace {

/// Has one class, and notes nothing: the provider's tests look at what arrives.
class OneClassHost : public CIMOMHandleRep {
 public:
  CIMClass getClass(const OperationContext&, const CIMNamespaceName&, const CIMName& className,
                    Boolean, Boolean, Boolean, const CIMPropertyList&) override {
    return CIMClass(className);
  }
  CIMInstance getInstance(const OperationContext&, const CIMNamespaceName&, const CIMObjectPath&,
                          Boolean, Boolean, Boolean, const CIMPropertyList&) override {
    return CIMInstance();
  }
  Array<CIMInstance> enumerateInstances(const OperationContext&, const CIMNamespaceName& nameSpace,
                                        const CIMName&, Boolean, Boolean, Boolean, Boolean,
                                        const CIMPropertyList&) override {
    throw CIMException(CIM_ERR_INVALID_NAMESPACE, nameSpace.getString());
  }
};

template <class Action>
CIMStatusCode statusOf(Action action) {
  try {
    action();
  } catch (const CIMException& exception) {
    return exception.getCode();
  }
  return CIM_ERR_SUCCESS;
}

TEST(CIMOMHandle, ReachesTheHostOfItsConstruction) {
  const OperationContext context;
  const CIMNamespaceName root("root/x");
  const CIMObjectPath path(String("A.k=1"));
  const auto getClass = [&](CIMOMHandle& handle) {
    return statusOf([&] { handle.getClass(context, root, CIMName("A"), true, true, true, {}); });
  };
  CIMOMHandle before;
  OneClassHost host;
  setEmbeddedHost(&host);
  CIMOMHandle handle;
  setEmbeddedHost(nullptr);
  CIMOMHandle copy(handle);
  EXPECT_EQ(getClass(copy), CIM_ERR_SUCCESS);
  EXPECT_EQ(getClass(before), CIM_ERR_FAILED);
  EXPECT_EQ(statusOf([&] {
              copy.enumerateInstances(context, root, CIMName("A"), true, true, true, true, {});
            }),
            CIM_ERR_INVALID_NAMESPACE);
  // What the host does not offer.
  Array<CIMParamValue> out;
  EXPECT_EQ(statusOf([&] { copy.deleteInstance(context, root, path); }), CIM_ERR_NOT_SUPPORTED);
  EXPECT_EQ(statusOf([&] { copy.invokeMethod(context, root, path, CIMName("M"), out, out); }),
            CIM_ERR_NOT_SUPPORTED);
  EXPECT_EQ(statusOf([&] { before.deleteInstance(context, root, path); }), CIM_ERR_FAILED);
  before.disallowProviderUnload();
  before.allowProviderUnload();
}

}  // namespace
