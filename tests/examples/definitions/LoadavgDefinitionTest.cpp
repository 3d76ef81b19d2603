// What the loadavg example tells, against the kernel's own text. The walkthrough serves it.

#include <gtest/gtest.h>
#include <unistd.h>

#include <climits>
#include <cmath>
#include <fstream>

#include "definition/DefinitionFile.h"
#include "engine/ProviderDefClass.h"
#include "engine/Registry.h"

namespace {

class LoadavgDefinition : public testing::Test {
 protected:
  LoadavgDefinition() {
    EXPECT_EQ(chdir(EXAMPLE_HOMES "/loadavg/run"), 0);
    readProviderDefXML("loadavg.xml");
  }
  ~LoadavgDefinition() override {
    releaseFunctions();
    releaseModules();
  }

  static const ProviderDefClass& average() { return *getProviderDefClass("Load_Average"); }
  static int number(const char* property, int index) {
    return average().getProperty(property)->getValue(index).getIntValue();
  }
};

// "0.52 0.58 0.59 ...", as hundredths.
std::vector<int> kernelHundredths() {
  std::ifstream file("/proc/loadavg");
  std::vector<int> result;
  double average = 0;
  while (result.size() < 3 && file >> average) {
    result.push_back(static_cast<int>(std::lround(average * 100)));
  }
  return result;
}

TEST_F(LoadavgDefinition, TellsTheKernelsAverages) {
  const int count = average().getNumberOfInstances();
  std::vector<int> before, told;
  do {  // until the numbers, which move on every five seconds, stood still meanwhile
    before = kernelHundredths();
    told.clear();
    for (int i = 0; i < count; ++i) told.push_back(number("Hundredths", i));
  } while (before != kernelHundredths());
  ASSERT_EQ(told.size(), 3u);
  for (std::size_t i = 0; i < 3; ++i) EXPECT_NEAR(told[i], before[i], 1);
}

TEST_F(LoadavgDefinition, APositionBeyondTheLastIsZero) {
  for (const int index : {-1, 3, 1000000}) {
    EXPECT_EQ(number("Minutes", index), 0);
    EXPECT_EQ(number("Hundredths", index), 0);
  }
}

TEST_F(LoadavgDefinition, TheMethodNamesTheSpansAboveANumber) {
  const ProviderDefMethod* above = average().getMethod("Above");
  ASSERT_NE(above, nullptr);
  std::vector<ProviderDefValue> outputs;
  above->exec({-1}, outputs, 0);
  above->exec({INT_MAX}, outputs, 0);
  ASSERT_EQ(outputs.size(), 2u);
  EXPECT_EQ(outputs[0].getStringArray(),
            (std::vector<std::string>{"last 1 min", "last 5 min", "last 15 min"}));
  EXPECT_EQ(outputs[1].getStringArray(), std::vector<std::string>());
  EXPECT_EQ(above->exec({"text"}, outputs, 0), 1);
  EXPECT_EQ(outputs.size(), 2u);
}

}  // namespace
