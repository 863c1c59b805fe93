// The elements of the three templates of a merge, each once, and the symbols that they have in the merged
// one.
#pragma once

#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "core/merge_values.h"

namespace tessal {

/// One element, as each template has it; none where it is not there.
struct MergeNode {
  const CEL_Element* base = nullptr;
  CEL_Element* ours = nullptr;
  const CEL_Element* theirs = nullptr;
  CEL_Element* merged = nullptr;  ///< ours, or the one that was made for it; none when it is away
  std::string name;               ///< its symbol in the merged template; for people where it has a caption
  bool isGoing = false;           ///< they removed it, and nothing speaks for it so far
  bool isRefused = false;         ///< they added it, and there is no place for it
};

class MergeNodes final {
 public:
  MergeNodes(TemplateCore& oursCore, const TemplateCore& baseCore, const TemplateCore& theirsCore);

  /// Gives the elements of ours their symbols in the merged template, rewrites their uses, and notes what
  /// the names of the others become.
  void SettleNames(std::vector<MergeConflict>& conflicts);

  std::deque<MergeNode>& All() { return nodes; }
  const std::deque<MergeNode>& All() const { return nodes; }
  /// The node of an element of any of the three; none for one that was made.
  MergeNode* Of(const CEL_Element* element) const;
  /// The node of the class that an element belongs to in its template; none outside of one.
  MergeNode* ClassOf(const CEL_Element& element) const;
  /// Whether two elements are in the same list, each of its own template.
  bool AreInOneList(const CEL_Element& one, const CEL_Element& other) const;

  const MergeSide& Base() const { return base; }
  const MergeSide& Theirs() const { return theirs; }

 private:
  void AddNode(const CEL_Element* inBase, CEL_Element* inOurs, const CEL_Element* inTheirs);
  void PairWhatBothAdded(const std::vector<CEL_Element*>& theirsNew);
  void ChooseNames(std::vector<MergeConflict>& conflicts);
  void KeepNamesApart(std::vector<MergeConflict>& conflicts);
  void NoteNames();
  void RenameOurs();

  TemplateCore& ours;
  MergeSide base;
  MergeSide theirs;
  NewNames oursNames;
  std::deque<MergeNode> nodes;
  std::unordered_map<const CEL_Element*, MergeNode*> nodeOf;
  ClassesOfMembers classes;  ///< of the elements of all three
};

}  // namespace tessal
