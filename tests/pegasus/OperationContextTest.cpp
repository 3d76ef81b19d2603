#include <Pegasus/Common/OperationContext.h>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

/// Counts its living objects, so that a lost or doubly destroyed clone shows.
class CountedContainer : public OperationContext::Container {
 public:
  CountedContainer() { ++alive; }
  CountedContainer(const CountedContainer& other) : OperationContext::Container(other) { ++alive; }
  ~CountedContainer() override { --alive; }
  String getName() const override { return "x"; }
  Container* clone() const override { return new CountedContainer(*this); }
  void destroy() override { delete this; }

  static inline int alive = 0;
};

std::string userIn(const OperationContext& context) {
  return text(IdentityContainer(context.get(IdentityContainer::NAME)).getUserName());
}

TEST(OperationContext, ReportsAbsentAndPresentNames) {
  OperationContext context;
  const String absent("absent");
  const CountedContainer counted;
  EXPECT_EQ(thrownMessage<Exception>([&] { context.get(absent); }), "object not found");
  EXPECT_EQ(thrownMessage<Exception>([&] { context.remove(absent); }), "object not found");
  EXPECT_EQ(thrownMessage<Exception>([&] { context.set(counted); }), "object not found");
  context.insert(counted);
  EXPECT_EQ(thrownMessage<Exception>([&] { context.insert(counted); }), "object already exists.");
  EXPECT_EQ(thrownMessage<DynamicCastFailedException>(
                [&] { IdentityContainer(context.get(String("x"))); }),
            "dynamic cast failed");
}

TEST(OperationContext, CopiesCloneEverything) {
  {
    OperationContext context;
    context.insert(CountedContainer());
    context.insert(IdentityContainer(String("guest")));
    context.set(IdentityContainer(String("root")));
    OperationContext copy(context);
    EXPECT_EQ(CountedContainer::alive, 2);
    context.remove(String("x"));
    EXPECT_TRUE(copy.contains(String("x")));
    copy = context;
    const OperationContext& self = copy;
    copy = self;
    EXPECT_FALSE(copy.contains(String("x")));
    EXPECT_EQ(userIn(copy), "root");
    EXPECT_EQ(CountedContainer::alive, 0);
    copy.clear();
    EXPECT_FALSE(copy.contains(IdentityContainer::NAME));
    copy.insert(CountedContainer());
  }
  EXPECT_EQ(CountedContainer::alive, 0);
}

}  // namespace
