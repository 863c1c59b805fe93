// The merge of the visibility groups: by the names of groups and levels, and element by element in what a
// level includes.
#pragma once

#include <functional>
#include <vector>

#include "core/merge.h"
#include "elements/visibility.h"

namespace tessal {

/// The identity in the merged template of an element of one side; none for one that is to be left out.
using MergedIdentity = std::function<Uid(Uid)>;

/// The groups of one side, and what its elements are in the merged template.
struct SideGroups {
  const std::vector<VisibilityGroup>& groups;
  MergedIdentity identity;
};

/// The merged groups. Those of the base should leave out what one of the sides has removed: an element that
/// is in the merged template all the same is then a member wherever a side has it.
std::vector<VisibilityGroup> MergeGroups(const SideGroups& base, const SideGroups& ours,
                                         const SideGroups& theirs, std::vector<MergeConflict>& conflicts);

}  // namespace tessal
