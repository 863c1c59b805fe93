#include "expr/numeric/data_slots.h"

#include <cmath>
#include <optional>

namespace tessal {

namespace {

constexpr double kNoSuchSlot = -1;

std::optional<std::size_t> SlotEntry(double slot) {
  const double number = std::trunc(slot);
  if (!(number >= 1 && number <= kDataSlots)) return std::nullopt;
  return static_cast<std::size_t>(number) - 1;
}

}  // namespace

DataSlotBanks& DataSlots() {
  static DataSlotBanks banks;
  return banks;
}

void ClearDataSlots() {
  DataSlots() = DataSlotBanks{};
}

double SaveInSlot(double slot, double value) {
  const std::optional<std::size_t> entry = SlotEntry(slot);
  if (!entry) return kNoSuchSlot;
  DataSlots().saved.at(*entry) = value;
  return value;
}

double LoadFromSlot(double slot) {
  const std::optional<std::size_t> entry = SlotEntry(slot);
  return entry ? DataSlots().loaded.at(*entry) : kNoSuchSlot;
}

double PeekAtSlot(double slot) {
  const std::optional<std::size_t> entry = SlotEntry(slot);
  return entry ? DataSlots().saved.at(*entry) : kNoSuchSlot;
}

}  // namespace tessal
