// The dumps of the other objects: tests/definition/data/every_element.dump.

#include "engine/ProviderDefValue.h"
#include "tests/support/StdoutCapture.h"

#include <gtest/gtest.h>

TEST(Dump, ValuesOfEveryType) {
  ProviderDefValue indexString("Disk");
  indexString.setIndexStringType();
  const std::pair<ProviderDefValue, std::string> cases[] = {
      {-5, "Value Type: int, Value: -5\n"},
      {"100%n %s", "Value Type: string, Value: 100%n %s\n"},
      {std::vector<int>{7, 8}, "Value Type: int array\n0 : 7, 1 : 8, "},
      {std::vector<int>{}, "Value Type: int array\n"},
      {std::vector<std::string>{"a", ""}, "Value Type: string array\n0 : a, 1 : , "},
      {indexString, "Value Type: index string, Value: Disk\n"},
      {true, "Value Type: boolean, Value: true\n"},
      {false, "Value Type: boolean, Value: false\n"},
      {5L, ""},
  };
  for (const auto& [value, content] : cases) {
    StdoutCapture out;
    value.dump();
    EXPECT_EQ(out.text(), "*** Start of ProviderDefValue Dump ***\n" + content +
                              "*** End   of ProviderDefValue Dump ***\n");
  }
}
