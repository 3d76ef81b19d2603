#include <gmock/gmock.h>

#include <cmath>
#include <fstream>

#include "tests/examples/definitions/ExampleHome.h"

namespace {

TEST(LoadavgDefinition, ServesThreeSpans) {
  const ExampleHome home("loadavg");
  ASSERT_NE(getProviderDefClass("Load_Average"), nullptr);
  ASSERT_EQ(getProviderDefClass("Load_Average")->getNumberOfInstances(), 3);
  const int minutes[] = {1, 5, 15};
  for (int i = 0; i < 3; ++i) {
    EXPECT_EQ(ExampleHome::value("Load_Average", "Minutes", i).getIntValue(), minutes[i]);
    EXPECT_EQ(ExampleHome::value("Load_Average", "Name", i).getStringValue(),
              "last " + std::to_string(minutes[i]) + " min");
    const ProviderDefValue label = ExampleHome::value("Load_Average", "Label", i);
    EXPECT_EQ(label.getType(), ProviderDefValue::kIndexString);
    EXPECT_EQ(label.getStringValue(), "span");
  }
}

// The kernel's own text, "0.52 0.58 0.59 ...", as hundredths.
std::vector<int> kernelHundredths() {
  std::ifstream file("/proc/loadavg");
  std::vector<int> result;
  double average = 0;
  while (result.size() < 3 && file >> average) {
    result.push_back(static_cast<int>(std::lround(average * 100)));
  }
  return result;
}

TEST(LoadavgDefinition, TellsTheKernelsAverages) {
  const ExampleHome home("loadavg");
  std::vector<int> before, told;
  do {  // until the numbers, which move on every five seconds, stood still meanwhile
    before = kernelHundredths();
    told.clear();
    for (const ProviderDefValue& value : ExampleHome::values("Load_Average", "Hundredths")) {
      told.push_back(value.getIntValue());
    }
  } while (before != kernelHundredths());
  ASSERT_EQ(told.size(), 3u);
  for (std::size_t i = 0; i < 3; ++i) EXPECT_NEAR(told[i], before[i], 1);
}

TEST(LoadavgDefinition, APositionBeyondTheLastIsZero) {
  const ExampleHome home("loadavg");
  for (const int index : {-1, 3, 1000000}) {
    EXPECT_EQ(ExampleHome::value("Load_Average", "Minutes", index).getIntValue(), 0);
    EXPECT_EQ(ExampleHome::value("Load_Average", "Hundredths", index).getIntValue(), 0);
  }
}

}  // namespace
