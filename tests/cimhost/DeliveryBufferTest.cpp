#include "cimhost/DeliveryBuffer.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

// How calls end is tested with the operations; here, what happens at the limit.
TEST(DeliveryBuffer, OverTheLimitAllThatWaitsGoesOutInOrder) {
  std::vector<int> out;
  cimhost::DeliveryBuffer<int> buffer([&out](int value) { return out.push_back(value), true; }, 3);
  buffer.deliver(1);
  buffer.complete();
  buffer.endCall();
  buffer.deliver(2);
  buffer.complete();
  buffer.deliver(3);
  EXPECT_THAT(out, ElementsAre());
  buffer.deliver(4);  // 2 waits as completed, 3 and 4 as pending.
  EXPECT_THAT(out, ElementsAre(1, 2, 3, 4));
  buffer.deliver(5);
  buffer.endCall();  // without complete()
  buffer.finish();
  EXPECT_THAT(out, ElementsAre(1, 2, 3, 4));
}

}  // namespace
