// What a three-way merge of templates (`TemplateCore::Merge`) could not decide: what both sides changed
// differently. Our side's value stays.
#pragma once

#include <string>

namespace tessal {

/// An item that a side has removed has "(removed)" for a value, one that it has as a whole "(kept)".
struct MergeConflict {
  std::string kind;    ///< of the item, for people
  std::string symbol;  ///< of the element as the merged template has it, or the item's name
  std::string field;   ///< its label; empty for the whole item
  std::string ours;
  std::string theirs;
};

}  // namespace tessal
