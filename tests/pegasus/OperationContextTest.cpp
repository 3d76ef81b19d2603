#include <Pegasus/Common/OperationContext.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

/// Counts its living objects, so that a lost or doubly destroyed clone shows.
class CountedContainer : public OperationContext::Container {
 public:
  explicit CountedContainer(const char* name) : name_(name) { ++alive; }
  CountedContainer(const CountedContainer& other)
      : OperationContext::Container(other), name_(other.name_) {
    ++alive;
  }
  ~CountedContainer() override { --alive; }
  String getName() const override { return name_; }
  Container* clone() const override { return new CountedContainer(*this); }
  void destroy() override { delete this; }

  static inline int alive = 0;

 private:
  String name_;
};

std::string userIn(const OperationContext& context) {
  return text(IdentityContainer(context.get(IdentityContainer::NAME)).getUserName());
}

TEST(OperationContext, ReportsAbsentAndPresentNames) {
  OperationContext context;
  const String absent("absent");
  const CountedContainer counted("x");
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
  const int before = CountedContainer::alive;
  {
    OperationContext context;
    context.insert(CountedContainer("x"));
    context.insert(IdentityContainer(String("guest")));
    context.set(IdentityContainer(String("root")));
    EXPECT_FALSE(context.contains(String("X")));
    OperationContext copy(context);
    EXPECT_EQ(CountedContainer::alive, before + 2);
    context.remove(String("x"));
    EXPECT_TRUE(copy.contains(String("x")));
    copy = context;
    EXPECT_FALSE(copy.contains(String("x")));
    const OperationContext& self = copy;
    copy = self;
    EXPECT_EQ(userIn(copy), "root");
    EXPECT_EQ(CountedContainer::alive, before);
    copy.clear();
    EXPECT_FALSE(copy.contains(IdentityContainer::NAME));
    EXPECT_EQ(userIn(context), "root");
  }
  EXPECT_EQ(CountedContainer::alive, before);
}

}  // namespace
