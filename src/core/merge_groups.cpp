#include "core/merge_groups.h"

#include <algorithm>
#include <set>
#include <string>
#include <utility>

#include "core/list_order.h"
#include "core/merge_values.h"

namespace tessal {

namespace {

constexpr std::string_view kName = "Name";
constexpr std::string_view kDescription = "Description";
constexpr auto kNone = static_cast<std::size_t>(-1);

bool HaveSameContent(const VisibilityLevel& one, const VisibilityLevel& other) {
  return one.description == other.description && one.items == other.items;
}

bool HaveSameContent(const VisibilityGroup& one, const VisibilityGroup& other) {
  return one.description == other.description &&
         std::equal(one.levels.begin(), one.levels.end(), other.levels.begin(), other.levels.end(),
                    [](const VisibilityLevel& level, const VisibilityLevel& otherLevel) {
                      return level.name == otherLevel.name && HaveSameContent(level, otherLevel);
                    });
}

template <class Named>
bool AreSame(const Named& one, const Named& other) {
  return one.name == other.name && HaveSameContent(one, other);
}

/// A group or a level in the three lists: its places there.
struct Trio {
  std::size_t base = kNone;
  std::size_t ours = kNone;
  std::size_t theirs = kNone;
};

/// For each place of the former list that of the same item in the later one: by name, then by content.
template <class Named>
std::vector<std::size_t> Partners(const std::vector<Named>& former, const std::vector<Named>& later,
                                  bool byContent) {
  std::vector<std::size_t> partners(former.size(), kNone);
  std::vector<bool> isTaken(later.size());
  const auto match = [&](const auto& isSame) {
    for (std::size_t place = 0; place < former.size(); ++place) {
      for (std::size_t other = 0; partners[place] == kNone && other < later.size(); ++other) {
        if (isTaken[other] || !isSame(former[place], later[other])) continue;
        partners[place] = other;
        isTaken[other] = true;
      }
    }
  };
  match([](const Named& one, const Named& other) { return one.name == other.name; });
  if (byContent) match([](const Named& one, const Named& other) { return HaveSameContent(one, other); });
  return partners;
}

template <class Named>
std::vector<Trio> TriosOf(const std::vector<Named>& base, const std::vector<Named>& ours,
                          const std::vector<Named>& theirs) {
  const std::vector<std::size_t> inOurs = Partners(base, ours, true);
  const std::vector<std::size_t> inTheirs = Partners(base, theirs, true);
  std::vector<Trio> trios;
  for (std::size_t place = 0; place < base.size(); ++place)
    trios.push_back({place, inOurs[place], inTheirs[place]});
  const std::vector<std::size_t> sameNames = Partners(ours, theirs, false);
  const auto isNew = [](const std::vector<std::size_t>& known, std::size_t place) {
    return place != kNone && std::find(known.begin(), known.end(), place) == known.end();
  };
  std::set<std::size_t> paired;
  for (std::size_t place = 0; place < ours.size(); ++place) {
    if (!isNew(inOurs, place)) continue;
    const std::size_t their = isNew(inTheirs, sameNames[place]) ? sameNames[place] : kNone;
    paired.insert(their);
    trios.push_back({kNone, place, their});
  }
  for (std::size_t place = 0; place < theirs.size(); ++place) {
    if (isNew(inTheirs, place) && !paired.contains(place)) trios.push_back({kNone, kNone, place});
  }
  return trios;
}

std::set<Uid> MergedItems(const std::set<Uid>& base, std::set<Uid> ours, const std::set<Uid>& theirs) {
  for (const Uid uid : theirs) {
    if (!base.contains(uid)) ours.insert(uid);
  }
  for (const Uid uid : base) {
    if (!theirs.contains(uid)) ours.erase(uid);
  }
  return ours;
}

class GroupMerge final {
 public:
  explicit GroupMerge(std::vector<MergeConflict>& conflictList) : conflicts(conflictList) {}

  template <class Named>
  std::vector<Named> Merge(const std::string& within, const std::vector<Named>& base,
                           const std::vector<Named>& ours, const std::vector<Named>& theirs) {
    const std::vector<Trio> trios = TriosOf(base, ours, theirs);
    std::vector<Named> merged(trios.size());
    std::vector<bool> isThere(trios.size());
    for (std::size_t number = 0; number < trios.size(); ++number) {
      const auto at = [](const std::vector<Named>& list, std::size_t place) {
        return place == kNone ? nullptr : &list[place];
      };
      const Trio& trio = trios[number];
      isThere[number] =
          MergeOne(within, at(base, trio.base), at(ours, trio.ours), at(theirs, trio.theirs), merged[number]);
    }
    SettleNames(within, trios, ours, merged, isThere);
    std::vector<Named> list;
    for (const std::size_t number : OrderOf(within, trios, isThere, merged))
      list.push_back(std::move(merged[number]));
    return list;
  }

 private:
  static std::string KindOf(const VisibilityGroup&) { return "Visibility group"; }
  static std::string KindOf(const VisibilityLevel&) { return "Visibility level"; }

  template <class Named>
  void Note(const std::string& within, const Named& item, std::string_view field, std::string ours,
            std::string theirs) {
    conflicts.push_back(
        {KindOf(item), within + item.name, std::string(field), std::move(ours), std::move(theirs)});
  }

  /// Whether the item is in the merged list.
  template <class Named>
  bool MergeOne(const std::string& within, const Named* base, const Named* ours, const Named* theirs,
                Named& merged) {
    const bool isWithUs = ours != nullptr;
    if (isWithUs && theirs != nullptr) {
      static const Named kNothing{};
      merged = *ours;
      MergeTexts(within, base == nullptr ? *theirs : *base, *ours, *theirs, base == nullptr, merged);
      MergeContent(base == nullptr ? kNothing : *base, *ours, *theirs, within, merged);
      return true;
    }
    if (ours == nullptr && theirs == nullptr) return false;
    const Named& present = isWithUs ? *ours : *theirs;
    merged = present;
    if (base == nullptr) return true;
    if (AreSame(*base, present)) return false;
    Note(within, present, "", std::string(isWithUs ? kKeptValue : kRemovedValue),
         std::string(isWithUs ? kRemovedValue : kKeptValue));
    return isWithUs;
  }

  template <class Named>
  void MergeTexts(const std::string& within, const Named& base, const Named& ours, const Named& theirs,
                  bool isNew, Named& merged) {
    MergedText name = tessal::MergeTexts(base.name, ours.name, theirs.name);
    if (name.isConflict) Note(within, ours, kName, ours.name, theirs.name);
    merged.name = std::move(name.text);
    MergedText text = tessal::MergeTexts(base.description, ours.description, theirs.description);
    if (isNew) text = {ours.description, ours.description != theirs.description};
    if (text.isConflict) Note(within, ours, kDescription, ours.description, theirs.description);
    merged.description = std::move(text.text);
  }

  static void MergeContent(const VisibilityLevel& base, const VisibilityLevel& ours,
                           const VisibilityLevel& theirs, const std::string& /*within*/,
                           VisibilityLevel& merged) {
    merged.items = MergedItems(base.items, ours.items, theirs.items);
  }
  void MergeContent(const VisibilityGroup& base, const VisibilityGroup& ours, const VisibilityGroup& theirs,
                    const std::string& /*within*/, VisibilityGroup& merged) {
    merged.levels = Merge(ours.name + ": ", base.levels, ours.levels, theirs.levels);
  }

  /// No two siblings have one name: ours keeps its own, what theirs added does not come in.
  template <class Named>
  void SettleNames(const std::string& within, const std::vector<Trio>& trios, const std::vector<Named>& ours,
                   std::vector<Named>& merged, std::vector<bool>& isThere) {
    std::set<std::string> names;
    for (std::size_t number = 0; number < trios.size(); ++number) {
      const std::size_t place = trios[number].ours;
      if (isThere[number] && place != kNone && merged[number].name == ours[place].name)
        names.insert(merged[number].name);
    }
    for (std::size_t number = 0; number < trios.size(); ++number) {
      const std::size_t place = trios[number].ours;
      if (!isThere[number] || (place != kNone && merged[number].name == ours[place].name)) continue;
      if (names.insert(merged[number].name).second) continue;
      if (place == kNone) {
        Note(within, merged[number], "", "another of this name", std::string(kKeptValue));
        isThere[number] = false;
      } else {
        Note(within, ours[place], kName, ours[place].name, merged[number].name);
        merged[number].name = ours[place].name;
      }
    }
  }

  template <class Named>
  ListOrder OrderOf(const std::string& within, const std::vector<Trio>& trios,
                    const std::vector<bool>& isThere, const std::vector<Named>& merged) {
    const auto order = [&trios, &isThere](std::size_t Trio::*place, bool inBoth) {
      ListOrder numbers;
      for (std::size_t number = 0; number < trios.size(); ++number) {
        const Trio& trio = trios[number];
        const bool isCommon = trio.ours != kNone && trio.theirs != kNone;
        if (isThere[number] && trio.*place != kNone && (!inBoth || isCommon)) numbers.push_back(number);
      }
      std::sort(numbers.begin(), numbers.end(), [&trios, place](std::size_t left, std::size_t right) {
        return trios[left].*place < trios[right].*place;
      });
      return numbers;
    };
    const MergedOrder result =
        MergeOrders(order(&Trio::base, true), order(&Trio::ours, false), order(&Trio::theirs, false));
    for (const std::size_t number : result.conflicts)
      Note(within, merged[number], "Place", std::string(kKeptValue), "moved");
    return result.order;
  }

  std::vector<MergeConflict>& conflicts;
};

std::vector<VisibilityGroup> Translated(const SideGroups& side) {
  std::vector<VisibilityGroup> groups = side.groups;
  for (VisibilityGroup& group : groups) {
    for (VisibilityLevel& level : group.levels) {
      std::set<Uid> items;
      for (const Uid uid : level.items) {
        const Uid merged = side.identity(uid);
        if (merged != Uid::None) items.insert(merged);
      }
      level.items = std::move(items);
    }
  }
  return groups;
}

}  // namespace

std::vector<VisibilityGroup> MergeGroups(const SideGroups& base, const SideGroups& ours,
                                         const SideGroups& theirs, std::vector<MergeConflict>& conflicts) {
  std::vector<VisibilityGroup> theirGroups = Translated(theirs);
  for (VisibilityGroup& group : theirGroups) {
    for (VisibilityLevel& level : group.levels) {
      // What their load passed over is theirs alone.
      level.passedOver.clear();
      level.recordsPassedOver.clear();
    }
  }
  return GroupMerge(conflicts).Merge("", Translated(base), Translated(ours), theirGroups);
}

}  // namespace tessal
