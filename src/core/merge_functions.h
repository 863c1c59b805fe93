// The merge of the user functions of the settings, which go by their public names.
#pragma once

#include <vector>

#include "core/merge_values.h"
#include "elements/miscellaneous.h"

namespace tessal {

/// Brings into the settings of ours what changed from the base to theirs. Several functions of one name are
/// matched in their order.
void MergeFunctions(CEL_Miscanellous& ours, const CEL_Miscanellous& base, const CEL_Miscanellous& theirs,
                    const ValueMerge& values, std::vector<MergeConflict>& conflicts);

}  // namespace tessal
