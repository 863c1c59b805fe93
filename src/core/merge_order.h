// The order of the elements of a merged template: that of ours with what they moved and added, and then every
// use after its definition where both sides had it so.
#pragma once

#include <set>
#include <utility>
#include <vector>

#include "core/merge_nodes.h"
#include "core/template_state.h"

namespace tessal {

/// A user and what it uses, by their nodes.
using UseOfNodes = std::pair<const MergeNode*, const MergeNode*>;

/// The uses within one list that come before the definition.
std::set<UseOfNodes> EarlyUses(const TemplateCore& core, const MergeNodes& nodes);

/// Orders all lists. The orders of ours are those that the lists have.
void MergeListOrders(TemplateState& state, MergeNodes& nodes, const TemplateCore& base,
                     const TemplateCore& theirs, std::vector<MergeConflict>& conflicts);

/// Moves definitions before their uses, but for those that were early already. The table must be up to date;
/// true when something was moved, and it is not any more. A circle is a conflict.
bool PutDefinitionsFirst(TemplateState& state, const MergeNodes& nodes, const std::set<UseOfNodes>& early,
                         std::vector<MergeConflict>& conflicts);

}  // namespace tessal
