// The merge of the values of one element, with the names that the merged template gives to others.
#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "core/edits.h"
#include "core/matching.h"
#include "core/merge.h"

namespace tessal {

inline constexpr std::string_view kRemovedValue = "(removed)";
inline constexpr std::string_view kKeptValue = "(kept)";

/// One of the templates that go into a merge, and what its symbols become.
struct MergeSide {
  const TemplateCore& core;
  NewNames names;
};

/// What the searches of the merged template are to look at.
using LinksToSet = std::unordered_map<CEL_Element*, SearchLink>;

/// A value that may be of an item without an element: three texts become one.
struct MergedText {
  std::string text;
  bool isConflict = false;
};
MergedText MergeTexts(const std::string& base, const std::string& ours, const std::string& theirs);

class ValueMerge final {
 public:
  /// The names of `ours` are those of the merged template already.
  ValueMerge(const TemplateCore& oursCore, const MergeSide& baseSide, const MergeSide& theirSide,
             std::vector<MergeConflict>& conflictList)
      : ours(oursCore), base(baseSide), theirs(theirSide), conflicts(conflictList) {}

  /// Merges into our element. Without one of the base, of its class, each difference is a conflict.
  void Merge(const CEL_Element* former, CEL_Element& into, const CEL_Element& from, const std::string& name,
             LinksToSet& links) const;
  /// Gives a new element the values of theirs.
  void Take(CEL_Element& made, const CEL_Element& from, LinksToSet& links) const;

  bool WeChanged(const CEL_Element& former, const CEL_Element& present) const;
  bool TheyChanged(const CEL_Element& former, const CEL_Element& present) const;

  /// Notes each value of theirs that is not that of the base, or each that is not empty, as a conflict.
  void NoteTheirs(const CEL_Element* former, const CEL_Element& from, const std::string& name,
                  std::string_view oursValue) const;

 private:
  std::string Text(const MergeSide& side, const CEL_Element& element, const ElementValue& value) const;

  const TemplateCore& ours;
  const MergeSide& base;
  const MergeSide& theirs;
  std::vector<MergeConflict>& conflicts;
};

}  // namespace tessal
