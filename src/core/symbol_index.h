// The symbols of a table by name, for the one step of a rebuild that looks every used name up.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/uid.h"

namespace tessal {

/// In a large template every step through memory counts: the names lie side by side, and so do the slots of
/// the hash table, probed one after the other.
class SymbolIndex final {
 public:
  explicit SymbolIndex(std::size_t records) : slots(std::bit_ceil(2 * records + 1)) {
    ends.reserve(records + 1);
    uids.reserve(records + 1);
  }

  /// Where the name of the next symbol is to be appended.
  std::string& NextName() { return names; }
  /// Adds the symbol whose name was appended last. Of equal names the first one counts.
  void AddNext(Uid uid) {
    ends.push_back(names.size());
    uids.push_back(uid);
    const auto sequence = static_cast<std::uint32_t>(ends.size() - 1);
    const std::string_view name = NameOf(sequence);
    Slot& slot = slots[SlotOf(name)];
    if (slot.sequence == 0) slot = {ShortHash(name), sequence};
  }

  /// The sequence number of the symbol of that name; 0 when there is none.
  std::uint32_t Find(std::string_view name) const { return slots[SlotOf(name)].sequence; }
  Uid UidOf(std::uint32_t sequence) const { return uids[sequence]; }

 private:
  struct Slot {
    std::uint32_t hash = 0;
    std::uint32_t sequence = 0;  ///< 0 for an empty slot
  };

  static std::uint32_t ShortHash(std::string_view name) {
    return static_cast<std::uint32_t>(std::hash<std::string_view>()(name));
  }
  std::string_view NameOf(std::uint32_t sequence) const {
    const std::size_t start = ends[sequence - 1];
    return std::string_view(names).substr(start, ends[sequence] - start);
  }
  /// The slot that holds the name, or the empty one that would take it.
  std::size_t SlotOf(std::string_view name) const {
    const std::uint32_t hash = ShortHash(name);
    std::size_t place = hash & (slots.size() - 1);
    while (slots[place].sequence != 0 &&
           (slots[place].hash != hash || NameOf(slots[place].sequence) != name)) {
      place = (place + 1) & (slots.size() - 1);
    }
    return place;
  }

  std::string names;
  std::vector<std::size_t> ends{0};  // of the names, by sequence number
  std::vector<Uid> uids{Uid::None};  // by sequence number
  std::vector<Slot> slots;
};

}  // namespace tessal
