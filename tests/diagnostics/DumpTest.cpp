// Integers, index strings, booleans and the other objects:
// tests/definition/data/every_element.dump.

#include "engine/ProviderDefValue.h"
#include "tests/support/StdoutCapture.h"

#include <gtest/gtest.h>

TEST(Dump, TextsListsAndLongs) {
  const std::pair<ProviderDefValue, std::string> cases[] = {
      {"100%n %s", "Value Type: string, Value: 100%n %s\n"},
      {std::vector<int>{7, 8}, "Value Type: int array\n0 : 7, 1 : 8, "},
      {std::vector<int>{}, "Value Type: int array\n"},
      {std::vector<std::string>{"a", ""}, "Value Type: string array\n0 : a, 1 : , "},
      {5L, ""},
  };
  for (const auto& [value, content] : cases) {
    StdoutCapture out;
    value.dump();
    EXPECT_EQ(out.text(), "*** Start of ProviderDefValue Dump ***\n" + content +
                              "*** End   of ProviderDefValue Dump ***\n");
  }
}
