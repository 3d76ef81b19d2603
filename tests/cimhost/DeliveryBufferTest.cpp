#include "cimhost/DeliveryBuffer.h"

#include <gmock/gmock.h>

#include <stdexcept>

namespace {

using cimhost::DeliveryBuffer;
using testing::ElementsAre;
using testing::IsEmpty;

class DeliveryBufferTest : public testing::Test {
 protected:
  std::vector<int> out_;
  DeliveryBuffer<int> buffer_{[this](int value) { return out_.push_back(value), true; }, 3};

  void deliver(std::initializer_list<int> values) {
    for (const int value : values) buffer_.deliver(value);
  }
};

TEST_F(DeliveryBufferTest, CallsJoinInOrderAndNothingGoesOutEarly) {
  deliver({1});
  buffer_.complete();
  buffer_.endCall();
  deliver({2});
  buffer_.complete();
  buffer_.endCall();
  EXPECT_THAT(out_, IsEmpty());
  buffer_.finish();
  EXPECT_THAT(out_, ElementsAre(1, 2));
}

TEST_F(DeliveryBufferTest, OneFailedCallTakesTheOthersBack) {
  deliver({1});
  buffer_.complete();
  buffer_.endCall();
  deliver({2});
  buffer_.discard();
  buffer_.finish();
  EXPECT_THAT(out_, IsEmpty());
}

TEST_F(DeliveryBufferTest, AnAbandonedCallLeavesTheOthers) {
  deliver({1});
  buffer_.complete();
  buffer_.endCall();
  deliver({2});
  buffer_.complete();
  buffer_.abandonCall();
  buffer_.finish();
  EXPECT_THAT(out_, ElementsAre(1));
}

TEST_F(DeliveryBufferTest, OverTheLimitAllThatWaitsGoesOutInOrder) {
  deliver({1});
  buffer_.complete();
  buffer_.endCall();
  deliver({2});
  buffer_.complete();  // Now 2 waits as completed, 3 and 4 as pending.
  deliver({3, 4});
  EXPECT_THAT(out_, ElementsAre(1, 2, 3, 4));
  deliver({5});
  buffer_.endCall();
  buffer_.finish();
  EXPECT_THAT(out_, ElementsAre(1, 2, 3, 4));
}

TEST(DeliveryBuffer, ConsumersStopQuietlyOrFailAtTheEnd) {
  int calls = 0;
  DeliveryBuffer<int> stopped([&](int) { return ++calls < 2; }, 0);
  for (int i = 0; i < 5; ++i) stopped.deliver(i);
  stopped.finish();
  EXPECT_EQ(calls, 2);

  calls = 0;
  DeliveryBuffer<int> failing(
      [&](int) -> bool { throw std::runtime_error(std::to_string(++calls)); }, 0);
  for (int i = 0; i < 5; ++i) failing.deliver(i);
  EXPECT_THROW(failing.finish(), std::runtime_error);
  EXPECT_EQ(calls, 1);
}

}  // namespace
