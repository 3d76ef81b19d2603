#pragma once

#include <array>
#include <cstddef>
#include <string_view>

// The calling types of plug-in functions: twelve families in four forms each. Codes, names and
// slots derive from kFamilies, the only list.

/// What a function does and with which data.
enum class Family {
  kSetI,
  kSetS,
  kSetAI,
  kSetAS,
  kGetI,
  kGetS,
  kGetAI,
  kGetAS,
  kGetL,
  kExecA,
  kExecB,
  kExecC
};

/// The extra argument: none, an `int`, a `const char*`, or a packed buffer.
enum class Suffix { kNone = 0, kI = 1, kW = 2, kV = 3 };

struct FamilyRow {
  Family family;
  int firstCode;  ///< The code of the form without suffix; i, w and v follow.
  std::array<const char*, 4> names;
};

inline constexpr FamilyRow kFamilies[] = {
    {Family::kSetI, 0, {"setI", "setIi", "setIw", "setIv"}},
    {Family::kSetS, 10, {"setS", "setSi", "setSw", "setSv"}},
    {Family::kSetAI, 20, {"setAI", "setAIi", "setAIw", "setAIv"}},
    {Family::kSetAS, 30, {"setAS", "setASi", "setASw", "setASv"}},
    {Family::kGetI, 100, {"getI", "getIi", "getIw", "getIv"}},
    {Family::kGetS, 110, {"getS", "getSi", "getSw", "getSv"}},
    {Family::kGetAI, 120, {"getAI", "getAIi", "getAIw", "getAIv"}},
    {Family::kGetAS, 130, {"getAS", "getASi", "getASw", "getASv"}},
    {Family::kGetL, 140, {"getL", "getLi", "getLw", "getLv"}},
    {Family::kExecA, 200, {"execA", "execAi", "execAw", "execAv"}},
    {Family::kExecB, 220, {"execB", "execBi", "execBw", "execBv"}},
    {Family::kExecC, 230, {"execC", "execCi", "execCw", "execCv"}},
};

inline constexpr size_t kSuffixes = 4;
inline constexpr size_t kFunctionTypes = std::size(kFamilies) * kSuffixes;
static_assert(kFunctionTypes == 48, "the plug-in contract has 48 calling types");

namespace function_types {

template <class T, class Pick>
constexpr std::array<T, kFunctionTypes + 1> makeTable(Pick pick, T end) {
  std::array<T, kFunctionTypes + 1> table{};
  for (size_t row = 0; row < kFunctionTypes; ++row) {
    table[row] = pick(kFamilies[row / kSuffixes], row % kSuffixes);
  }
  table[kFunctionTypes] = end;
  return table;
}

}  // namespace function_types

/// Names in table order, closed by a null pointer.
inline constexpr auto function_type_name_table = function_types::makeTable<const char*>(
    [](const FamilyRow& row, size_t suffix) { return row.names[suffix]; }, nullptr);

/// Codes in the same order, closed by a 0.
inline constexpr auto function_type_number_table = function_types::makeTable<int>(
    [](const FamilyRow& row, size_t suffix) { return row.firstCode + static_cast<int>(suffix); },
    0);

/// The code that a function has whose type name is in no row; every operation refuses it.
inline constexpr int kInvalidFunctionType = -1;

/// The code behind a type name (exact, case-sensitive), or kInvalidFunctionType.
int functionTypeCode(std::string_view name);

/// The row of a code in the tables, or -1.
int functionTypeSlot(int code);

inline Family familyOfSlot(int slot) {
  return kFamilies[static_cast<size_t>(slot) / kSuffixes].family;
}
inline Suffix suffixOfSlot(int slot) {
  return static_cast<Suffix>(static_cast<size_t>(slot) % kSuffixes);
}
