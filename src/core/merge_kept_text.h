// The merge of what files hold beside the template: pools by their names and fields, other sections as a
// whole.
#pragma once

#include <vector>

#include "core/merge_values.h"
#include "core/pools.h"

namespace tessal {

/// The pools of a template, with the symbols that they name under their new names.
std::vector<Pool> PoolsUnderNames(const TemplateCore& core, const NewNames& newNames);

/// Brings into `ours` what changed from the base to theirs. The pools of `ours` have the merged names
/// already.
void MergeKeptText(TemplateCore& ours, const MergeSide& base, const MergeSide& theirs,
                   std::vector<MergeConflict>& conflicts);

}  // namespace tessal
