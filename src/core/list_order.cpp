#include "core/list_order.h"

#include <algorithm>
#include <iterator>
#include <list>
#include <unordered_map>
#include <unordered_set>

namespace tessal {

std::vector<bool> OutOfOrder(const std::vector<std::size_t>& numbers) {
  constexpr auto kNone = static_cast<std::size_t>(-1);
  std::vector<std::size_t> ends;  // of the rows of each length, the place of the least last number
  std::vector<std::size_t> before(numbers.size(), kNone);
  for (std::size_t place = 0; place < numbers.size(); ++place) {
    const auto row = std::lower_bound(
        ends.begin(), ends.end(), place,
        [&numbers](std::size_t left, std::size_t right) { return numbers[left] < numbers[right]; });
    if (row != ends.begin()) before[place] = *(row - 1);
    if (row == ends.end()) {
      ends.push_back(place);
    } else {
      *row = place;
    }
  }
  std::vector<bool> outside(numbers.size(), true);
  for (std::size_t place = ends.empty() ? kNone : ends.back(); place != kNone; place = before[place])
    outside[place] = false;
  return outside;
}

namespace {

constexpr auto kFirst = static_cast<std::size_t>(-1);  ///< comes after nobody

using Places = std::unordered_map<std::size_t, std::size_t>;

Places PlacesIn(const ListOrder& order) {
  Places places;
  for (std::size_t place = 0; place < order.size(); ++place) places.emplace(order[place], place);
  return places;
}

/// The members of an order that have another place among those of the former one, with whom they come after.
Places MovedIn(const ListOrder& order, const Places& former) {
  ListOrder kept;
  std::vector<std::size_t> formerPlaces;
  for (const std::size_t member : order) {
    const auto place = former.find(member);
    if (place == former.end()) continue;
    kept.push_back(member);
    formerPlaces.push_back(place->second);
  }
  const std::vector<bool> outside = OutOfOrder(formerPlaces);
  Places moved;
  for (std::size_t place = 0; place < kept.size(); ++place) {
    if (outside[place]) moved.emplace(kept[place], place == 0 ? kFirst : kept[place - 1]);
  }
  return moved;
}

/// The order of the first side while those of the second come into it.
class Weaving final {
 public:
  explicit Weaving(const ListOrder& ours) : woven(ours.begin(), ours.end()) {
    for (auto place = woven.begin(); place != woven.end(); ++place) places.emplace(*place, place);
  }

  bool Has(std::size_t member) const { return places.contains(member); }

  /// Puts a member after another, and after those that follow it and are of the first side alone.
  void PutAfter(std::size_t predecessor, std::size_t member, const std::unordered_set<std::size_t>& own) {
    const auto present = places.find(member);
    if (present != places.end()) woven.erase(present->second);
    auto next = predecessor == kFirst ? woven.begin() : std::next(places.at(predecessor));
    while (next != woven.end() && own.contains(*next)) ++next;
    places.insert_or_assign(member, woven.insert(next, member));
  }

  ListOrder Order() const { return {woven.begin(), woven.end()}; }

 private:
  std::list<std::size_t> woven;
  std::unordered_map<std::size_t, std::list<std::size_t>::iterator> places;
};

}  // namespace

MergedOrder MergeOrders(const ListOrder& former, const ListOrder& ours, const ListOrder& theirs) {
  const Places inFormer = PlacesIn(former);
  const Places inTheirs = PlacesIn(theirs);
  const Places movedByUs = MovedIn(ours, inFormer);
  const Places movedByThem = MovedIn(theirs, inFormer);
  std::unordered_set<std::size_t> own;
  for (const std::size_t member : ours) {
    if (!inFormer.contains(member) && !inTheirs.contains(member)) own.insert(member);
  }
  MergedOrder merged;
  Weaving weaving(ours);
  std::size_t predecessor = kFirst;
  for (const std::size_t member : theirs) {
    const bool isNew = !weaving.Has(member) && !inFormer.contains(member);
    if (!isNew && !weaving.Has(member)) continue;  // ours has removed it
    const auto moved = movedByThem.find(member);
    const auto ourMove = movedByUs.find(member);
    if (isNew || (moved != movedByThem.end() && ourMove == movedByUs.end())) {
      weaving.PutAfter(predecessor, member, own);
    } else if (moved != movedByThem.end() && moved->second != ourMove->second) {
      merged.conflicts.push_back(member);
    }
    predecessor = member;
  }
  merged.order = weaving.Order();
  return merged;
}

}  // namespace tessal
