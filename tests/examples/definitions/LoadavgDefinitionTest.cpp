// What the loadavg example tells, against the kernel's own text. The walkthrough serves it.

#include <gmock/gmock.h>
#include <unistd.h>

#include <climits>
#include <cmath>
#include <fstream>

#include "definition/DefinitionFile.h"
#include "engine/ProviderDefClass.h"
#include "engine/Registry.h"
#include "tests/engine/ValueText.h"

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
std::vector<long> kernelHundredths() {
  std::ifstream file("/proc/loadavg");
  double averages[3] = {};
  file >> averages[0] >> averages[1] >> averages[2];
  return {std::lround(averages[0] * 100), std::lround(averages[1] * 100),
          std::lround(averages[2] * 100)};
}

TEST_F(LoadavgDefinition, TellsTheKernelsAverages) {
  ASSERT_EQ(average().getNumberOfInstances(), 3);
  std::vector<long> before, told;
  do {  // until the numbers, which move on every five seconds, stood still meanwhile
    before = kernelHundredths();
    told = {number("Hundredths", 0), number("Hundredths", 1), number("Hundredths", 2)};
  } while (before != kernelHundredths());
  EXPECT_THAT(told, testing::Pointwise(testing::DoubleNear(1), before));
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
  Values outputs;
  above->exec({-1}, outputs, 0);
  above->exec({INT_MAX}, outputs, 0);
  EXPECT_EQ(above->exec({"text"}, outputs, 0), 1);
  EXPECT_EQ(valueText(outputs), "3 {last 1 min, last 5 min, last 15 min}; 3 {}; ");
}

}  // namespace
