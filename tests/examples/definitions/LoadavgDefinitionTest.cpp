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

TEST(LoadavgDefinition, TheMethodNamesTheSpansAboveANumber) {
  const ExampleHome home("loadavg");
  const ProviderDefMethod* above = getProviderDefClass("Load_Average")->getMethod("Above");
  ASSERT_NE(above, nullptr);
  std::vector<int> before;
  std::vector<std::string> expected;
  std::vector<ProviderDefValue> outputs;
  do {  // until the numbers stood still meanwhile
    before = kernelHundredths();
    const auto averages = ExampleHome::values("Load_Average", "Hundredths");
    const int middle = averages.at(1).getIntValue();
    expected.clear();
    for (int i = 0; i < 3; ++i) {
      if (averages[static_cast<std::size_t>(i)].getIntValue() > middle) {
        expected.push_back(ExampleHome::value("Load_Average", "Name", i).getStringValue());
      }
    }
    outputs.clear();
    EXPECT_EQ(above->exec({middle}, outputs, 0), 0);
  } while (before != kernelHundredths());
  ASSERT_EQ(outputs.size(), 1u);
  EXPECT_EQ(outputs[0].getStringArray(), expected);

  outputs.clear();
  above->exec({-1}, outputs, 0);
  EXPECT_EQ(outputs.at(0).getStringArray(),
            (std::vector<std::string>{"last 1 min", "last 5 min", "last 15 min"}));
  outputs.clear();
  EXPECT_EQ(above->exec({"text"}, outputs, 0), 1);
  EXPECT_TRUE(outputs.empty());
}

TEST(LoadavgDefinition, APositionBeyondTheLastIsZero) {
  const ExampleHome home("loadavg");
  for (const int index : {-1, 3, 1000000}) {
    EXPECT_EQ(ExampleHome::value("Load_Average", "Minutes", index).getIntValue(), 0);
    EXPECT_EQ(ExampleHome::value("Load_Average", "Hundredths", index).getIntValue(), 0);
  }
}

}  // namespace
