#include "engine/FunctionTypes.h"

namespace {

constexpr int kCodes = 234;  // the highest code, 233, and one

constexpr std::array<signed char, kCodes> makeSlots() {
  std::array<signed char, kCodes> slots{};
  for (auto& slot : slots) slot = -1;
  for (size_t row = 0; row < kFunctionTypes; ++row) {
    slots[static_cast<size_t>(function_type_number_table[row])] = static_cast<signed char>(row);
  }
  return slots;
}

constexpr auto kSlots = makeSlots();

// With their lengths, so that a comparison ends at once.
constexpr auto kNames = function_types::makeTable<std::string_view>(
    [](const FamilyRow& row, size_t suffix) { return std::string_view(row.names[suffix]); },
    std::string_view());

}  // namespace

int functionTypeCode(std::string_view name) {
  for (size_t row = 0; row < kFunctionTypes; ++row) {
    if (name == kNames[row]) return function_type_number_table[row];
  }
  return kInvalidFunctionType;
}

int functionTypeSlot(int code) {
  return code >= 0 && code < kCodes ? kSlots[static_cast<size_t>(code)] : -1;
}
