// Numbered slots in which expressions keep values from one call to the next: `SAVE`, `LOAD` and `PEEK`.
// There are two banks, so that an engine can make saved values visible to `LOAD` at a step of its own;
// nothing in this library copies between them.
#pragma once

#include <array>
#include <cstddef>

namespace tessal {

inline constexpr std::size_t kDataSlots = 100;

/// The two banks of the process; slot 1 of an expression is entry 0.
struct DataSlotBanks {
  std::array<double, kDataSlots> saved{};
  std::array<double, kDataSlots> loaded{};
};

DataSlotBanks& DataSlots();

/// Puts 0 into every slot of both banks.
void ClearDataSlots();

/// `SAVE`: stores the value in the save bank and returns it. The slot number is truncated; -1, and nothing
/// stored, outside 1 to 100.
double SaveInSlot(double slot, double value);

/// `LOAD`: the slot's value in the load bank, -1 outside 1 to 100.
double LoadFromSlot(double slot);

/// `PEEK`: the slot's value in the save bank, -1 outside 1 to 100.
double PeekAtSlot(double slot);

}  // namespace tessal
