#include "engine/FunctionTypes.h"

#include <gtest/gtest.h>

#include <climits>

namespace {

// The contract with plug-ins and definition files: written out, in slot order.
constexpr std::pair<const char*, int> kTypes[] = {
    {"setI", 0},     {"setIi", 1},    {"setIw", 2},    {"setIv", 3},    {"setS", 10},
    {"setSi", 11},   {"setSw", 12},   {"setSv", 13},   {"setAI", 20},   {"setAIi", 21},
    {"setAIw", 22},  {"setAIv", 23},  {"setAS", 30},   {"setASi", 31},  {"setASw", 32},
    {"setASv", 33},  {"getI", 100},   {"getIi", 101},  {"getIw", 102},  {"getIv", 103},
    {"getS", 110},   {"getSi", 111},  {"getSw", 112},  {"getSv", 113},  {"getAI", 120},
    {"getAIi", 121}, {"getAIw", 122}, {"getAIv", 123}, {"getAS", 130},  {"getASi", 131},
    {"getASw", 132}, {"getASv", 133}, {"getL", 140},   {"getLi", 141},  {"getLw", 142},
    {"getLv", 143},  {"execA", 200},  {"execAi", 201}, {"execAw", 202}, {"execAv", 203},
    {"execB", 220},  {"execBi", 221}, {"execBw", 222}, {"execBv", 223}, {"execC", 230},
    {"execCi", 231}, {"execCw", 232}, {"execCv", 233},
};

}  // namespace

TEST(FunctionTypes, TablesHoldNamesAndCodesInSlotOrder) {
  ASSERT_EQ(std::size(kTypes), 48u);
  for (size_t slot = 0; slot < std::size(kTypes); ++slot) {
    const auto& [name, code] = kTypes[slot];
    EXPECT_STREQ(function_type_name_table[slot], name);
    EXPECT_EQ(function_type_number_table[slot], code) << name;
    EXPECT_EQ(functionTypeCode(name), code) << name;
    EXPECT_EQ(functionTypeSlot(code), static_cast<int>(slot)) << name;
  }
  EXPECT_EQ(function_type_name_table[48], nullptr);
  EXPECT_EQ(function_type_number_table[48], 0);
}

TEST(FunctionTypes, RefusesWhatIsNotInTheTables) {
  for (const char* name : {"", "SetI", "setIx", "getLL", "execD", " getI", "getI "}) {
    EXPECT_EQ(functionTypeCode(name), kInvalidFunctionType) << name;
  }
  int known = 0;
  for (int code = -300; code < 1000; ++code) known += functionTypeSlot(code) >= 0 ? 1 : 0;
  EXPECT_EQ(known, 48);
  EXPECT_EQ(functionTypeSlot(INT_MAX), -1);
  EXPECT_EQ(functionTypeSlot(INT_MIN), -1);
}
