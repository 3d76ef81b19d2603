#include <Pegasus/Common/Exception.h>
#include <Pegasus/Provider/CIMAssociationProvider.h>
#include <Pegasus/Provider/CIMInstanceProvider.h>
#include <Pegasus/Provider/CIMMethodProvider.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;

namespace {

/// A handler as a server writes one: it keeps what is delivered.
class KeepingHandler : public InstanceResponseHandler {
 public:
  void processing() override {}
  void complete() override { isComplete = true; }
  void deliver(const CIMInstance& instance) override { instances.append(instance); }
  void deliver(const Array<CIMInstance>& delivered) override { instances.appendArray(delivered); }
  std::string user() const {
    return text(IdentityContainer(getContext().get(IdentityContainer::NAME)).getUserName());
  }

  Array<CIMInstance> instances;
  bool isComplete = false;
};

/// Serves instances and methods, but no associations.
class TwoWayProvider : public CIMInstanceProvider, public CIMMethodProvider {
 public:
  explicit TwoWayProvider(bool& destroyed) : destroyed_(destroyed) {}
  ~TwoWayProvider() override { destroyed_ = true; }
  void initialize(CIMOMHandle&) override {}
  void terminate() override { delete this; }
  void getInstance(const OperationContext&, const CIMObjectPath&, const Boolean, const Boolean,
                   const CIMPropertyList&, InstanceResponseHandler&) override {
    throw CIMObjectNotFoundException(String("getInstance"));
  }
  void enumerateInstances(const OperationContext&, const CIMObjectPath& classReference,
                          const Boolean, const Boolean, const CIMPropertyList&,
                          InstanceResponseHandler& handler) override {
    handler.processing();
    CIMInstance instance(classReference.getClassName());
    handler.deliver(instance);
    instance.addProperty(CIMProperty(CIMName("late"), Uint32(1)));
    handler.complete();
  }
  void enumerateInstanceNames(const OperationContext&, const CIMObjectPath&,
                              ObjectPathResponseHandler&) override {}
  void modifyInstance(const OperationContext&, const CIMObjectPath&, const CIMInstance&,
                      const Boolean, const CIMPropertyList&, ResponseHandler&) override {}
  void createInstance(const OperationContext&, const CIMObjectPath&, const CIMInstance&,
                      ObjectPathResponseHandler&) override {}
  void deleteInstance(const OperationContext&, const CIMObjectPath&, ResponseHandler&) override {}
  void invokeMethod(const OperationContext&, const CIMObjectPath&, const CIMName&,
                    const Array<CIMParamValue>&, MethodResultResponseHandler&) override {}

 private:
  bool& destroyed_;
};

TEST(ProviderInterfaces, AreFoundFromTheProviderPointer) {
  bool destroyed = false;
  CIMProvider* const provider = new TwoWayProvider(destroyed);
  EXPECT_NE(dynamic_cast<CIMMethodProvider*>(provider), nullptr);
  EXPECT_EQ(dynamic_cast<CIMAssociationProvider*>(provider), nullptr);
  auto* const instances = dynamic_cast<CIMInstanceProvider*>(provider);
  ASSERT_NE(instances, nullptr);

  KeepingHandler handler;
  OperationContext context;
  context.insert(IdentityContainer(String("root")));
  handler.setContext(context);
  const CIMObjectPath path(String("root/x:A"));
  instances->enumerateInstances(context, path, false, false, CIMPropertyList(), handler);
  EXPECT_TRUE(handler.isComplete);
  EXPECT_EQ(handler.user(), "root");
  ASSERT_EQ(handler.instances.size(), 1u);
  // A handle was delivered: what was changed afterwards shows.
  EXPECT_EQ(handler.instances[0].getPropertyCount(), 1u);

  // A copy keeps what was delivered up to then.
  KeepingHandler copy(handler);
  handler.deliver(CIMInstance(CIMName("B")));
  EXPECT_EQ(copy.instances.size(), 1u);
  EXPECT_EQ(copy.user(), "root");

  EXPECT_THROW(instances->getInstance(context, path, false, false, CIMPropertyList(), handler),
               CIMException);
  provider->terminate();
  EXPECT_TRUE(destroyed);
}

template <class E>
void expectCode(CIMStatusCode code) {
  try {
    throw E(String("%s stays as it is"));
  } catch (const CIMException& exception) {
    EXPECT_EQ(exception.getCode(), code);
    EXPECT_EQ(text(exception.getMessage()), "%s stays as it is");
    EXPECT_NE(dynamic_cast<const CIMOperationFailedException*>(&exception), nullptr);
  }
}

TEST(ProviderExceptions, CarryTheCodesOfTheirNames) {
  expectCode<CIMOperationFailedException>(CIM_ERR_FAILED);
  expectCode<CIMAccessDeniedException>(CIM_ERR_ACCESS_DENIED);
  expectCode<CIMInvalidParameterException>(CIM_ERR_INVALID_PARAMETER);
  expectCode<CIMObjectNotFoundException>(CIM_ERR_NOT_FOUND);
  expectCode<CIMNotSupportedException>(CIM_ERR_NOT_SUPPORTED);
  expectCode<CIMObjectAlreadyExistsException>(CIM_ERR_ALREADY_EXISTS);
  expectCode<CIMPropertyNotFoundException>(CIM_ERR_NO_SUCH_PROPERTY);
  expectCode<CIMMethodNotFoundException>(CIM_ERR_METHOD_NOT_FOUND);
}

}  // namespace
