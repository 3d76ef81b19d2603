#include <Pegasus/Common/ResponseHandler.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;

namespace {

/// A handler as a server writes one: it keeps what is delivered.
class KeepingHandler : public InstanceResponseHandler {
 public:
  void processing() override {}
  void complete() override {}
  void deliver(const CIMInstance& instance) override { instances.append(instance); }
  void deliver(const Array<CIMInstance>& delivered) override { instances.appendArray(delivered); }
  std::string user() const {
    return text(IdentityContainer(getContext().get(IdentityContainer::NAME)).getUserName());
  }

  Array<CIMInstance> instances;
};

TEST(ResponseHandlers, CopiesKeepContextAndWhatWasDelivered) {
  KeepingHandler handler;
  OperationContext context;
  context.insert(IdentityContainer(String("root")));
  handler.setContext(context);
  CIMInstance instance(CIMName("A"));
  handler.deliver(instance);
  // A handle was delivered: what was changed afterwards shows.
  instance.addProperty(CIMProperty(CIMName("late"), Uint32(1)));
  EXPECT_EQ(handler.instances[0].getPropertyCount(), 1u);

  const KeepingHandler copy(handler);
  handler.deliver(instance);
  EXPECT_EQ(copy.instances.size(), 1u);
  EXPECT_EQ(copy.user(), "root");
}

}  // namespace
