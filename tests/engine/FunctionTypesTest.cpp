#include "engine/FunctionTypes.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

// The contract with plug-ins and definition files, in the order of the slots: each family has its
// name and code, then those with the suffixes i, w and v.
TEST(FunctionTypes, TablesHoldNamesAndCodesInSlotOrder) {
  constexpr std::pair<const char*, int> families[] = {
      {"setI", 0},    {"setS", 10},   {"setAI", 20}, {"setAS", 30},  {"getI", 100},  {"getS", 110},
      {"getAI", 120}, {"getAS", 130}, {"getL", 140}, {"execA", 200}, {"execB", 220}, {"execC", 230},
  };
  size_t slot = 0;
  for (auto [family, code] : families) {
    for (const char* suffix : {"", "i", "w", "v"}) {
      const std::string name = std::string(family) + suffix;
      EXPECT_EQ(function_type_name_table[slot], name);
      EXPECT_EQ(function_type_number_table[slot], code) << name;
      EXPECT_EQ(functionTypeCode(name), code) << name;
      EXPECT_EQ(functionTypeSlot(code++), static_cast<int>(slot++)) << name;
    }
  }
  EXPECT_EQ(slot, 48u);
  EXPECT_EQ(function_type_name_table[48], nullptr);
  EXPECT_EQ(function_type_number_table[48], 0);
  for (const char* name : {"", "SetI", "setIx", "getLL", "execD", " getI", "getI "}) {
    EXPECT_EQ(functionTypeCode(name), kInvalidFunctionType) << name;
  }
  int known = 0;
  for (int other = -300; other < 1000; ++other) known += functionTypeSlot(other) >= 0 ? 1 : 0;
  EXPECT_EQ(known, 48);
  for (const int other : {INT_MIN, INT_MAX}) EXPECT_EQ(functionTypeSlot(other), -1);
}
