// Orders of lists that share members: which members have moved from one order to the other, and the order
// that follows from two changed ones.
#pragma once

#include <cstddef>
#include <vector>

namespace tessal {

/// Which of the numbers are outside a longest rising row of them: with those moved, all are in order.
std::vector<bool> OutOfOrder(const std::vector<std::size_t>& numbers);

/// Members of a list by their numbers, each once.
using ListOrder = std::vector<std::size_t>;

struct MergedOrder {
  ListOrder order;
  /// Those that both sides have moved, to different places; they stay where the first side has them.
  std::vector<std::size_t> conflicts;
};

/// The members of the first side and then those that the second added or moved, each after the member that
/// it comes after on that side. Who is only in the former order, or only in it and the second, is left out.
MergedOrder MergeOrders(const ListOrder& former, const ListOrder& ours, const ListOrder& theirs);

}  // namespace tessal
