// The names of one template, each with a number: symbols, and what expressions mention. A name that has a
// number keeps it, so that an expression's names are looked up once, and not at each rebuild.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory_resource>
#include <string_view>
#include <utility>
#include <vector>

namespace tessal {

/// The number of a name, from 1; 0 for no name.
using NameNumber = std::uint32_t;

/// In a large template every step through memory counts: the slots of the hash table lie side by side, probed
/// one after the other, and hold enough of the hash that few names are compared in vain.
class NameTable final {
 public:
  NameTable() { Clear(); }
  NameTable(const NameTable&) = delete;
  NameTable& operator=(const NameTable&) = delete;

  void Clear() {
    names.assign(1, {});
    slots.assign(kFirstSlots, {});
    texts.release();
  }

  /// The number of a name, which gets one if it has none.
  NameNumber NumberOf(std::string_view name) {
    const std::uint32_t hash = ShortHash(name);
    Slot* slot = &slots[SlotOf(name, hash)];
    if (slot->number != 0) return slot->number;
    if (2 * names.size() > slots.size()) {
      Grow();
      slot = &slots[SlotOf(name, hash)];
    }
    names.push_back(Kept(name));
    *slot = {hash, static_cast<NameNumber>(names.size() - 1)};
    return slot->number;
  }

  std::string_view NameOf(NameNumber number) const { return names[number]; }
  /// One more than the highest number.
  std::size_t End() const { return names.size(); }

 private:
  static constexpr std::size_t kFirstSlots = 64;

  struct Slot {
    std::uint32_t hash = 0;
    NameNumber number = 0;  ///< 0 for an empty slot
  };

  static std::uint32_t ShortHash(std::string_view name) {
    return static_cast<std::uint32_t>(std::hash<std::string_view>()(name));
  }
  /// The slot that holds the name, or the empty one that would take it.
  std::size_t SlotOf(std::string_view name, std::uint32_t hash) const {
    std::size_t place = hash & (slots.size() - 1);
    while (slots[place].number != 0 && (slots[place].hash != hash || names[slots[place].number] != name)) {
      place = (place + 1) & (slots.size() - 1);
    }
    return place;
  }
  void Grow() {
    const std::vector<Slot> former = std::exchange(slots, std::vector<Slot>(2 * slots.size()));
    for (const Slot& slot : former) {
      if (slot.number == 0) continue;
      std::size_t place = slot.hash & (slots.size() - 1);
      while (slots[place].number != 0) place = (place + 1) & (slots.size() - 1);
      slots[place] = slot;
    }
  }
  std::string_view Kept(std::string_view name) {
    if (name.empty()) return {};
    char* const copy = static_cast<char*>(texts.allocate(name.size(), 1));
    name.copy(copy, name.size());
    return {copy, name.size()};
  }

  std::vector<std::string_view> names;
  std::vector<Slot> slots;
  std::pmr::monotonic_buffer_resource texts;
};

}  // namespace tessal
