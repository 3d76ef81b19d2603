#include <Pegasus/Embedded/CIMOMHandleRep.h>
#include <Pegasus/Provider/CIMOMHandle.h>
#include <gtest/gtest.h>

using namespace Pegasus;

namespace {

/// Has any class, and no instances: the provider's tests look at what arrives.
class ClassHost : public CIMOMHandleRep {
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
  const OperationContext none;
  const CIMNamespaceName root("root/x");
  const CIMName a("A");
  CIMOMHandle before;
  ClassHost host;
  setEmbeddedHost(&host);
  CIMOMHandle handle;
  setEmbeddedHost(nullptr);
  CIMOMHandle copy(handle);
  const auto getClass = [&](CIMOMHandle& from) {
    from.getClass(none, root, a, true, true, true, {});
  };
  const auto list = [&] { copy.enumerateInstances(none, root, a, true, true, true, true, {}); };
  const auto erase = [&] { copy.deleteInstance(none, root, CIMObjectPath(String("A.k=1"))); };
  EXPECT_EQ(statusOf([&] { getClass(copy); }), CIM_ERR_SUCCESS);
  EXPECT_EQ(statusOf([&] { getClass(before); }), CIM_ERR_FAILED);
  EXPECT_EQ(statusOf(list), CIM_ERR_INVALID_NAMESPACE);
  EXPECT_EQ(statusOf(erase), CIM_ERR_NOT_SUPPORTED) << "what the host does not offer";
}

}  // namespace
