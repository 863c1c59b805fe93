// What a template holds. The front, TemplateCore, owns it; the local classes of loading, saving and
// visibility groups work on it, so that a change to one of their steps touches no header.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <string>

#include "core/collections.h"
#include "core/symbol_table.h"
#include "elements/load_account.h"
#include "elements/miscellaneous.h"
#include "keyfile/item_tree.h"

namespace tessal {

/// The switches of one template. Every property holds the address of the first.
struct TemplateFlags {
  bool modified = false;
  bool rebuildEnabled = true;
  bool showAllBuiltIns = false;
  bool strictScopeRule = true;  ///< the scope rule; otherwise the process rule
};

class EditHistory;

struct TemplateState {
  static constexpr std::size_t kListHeadCount = 6;
  using ListHeads = std::array<std::unique_ptr<CEL_ListHead>, kListHeadCount>;

  /// The list head of a kind from StateVariableList to DerivedOutputList; any other raises the subscript
  /// failure.
  CEL_ListHead& ListHead(ElementKind listKind) const;
  /// Writes the numbers of the records into the elements and renumbers the classes, with what refers to them.
  void AssignIds();
  /// Has the settings ask for a spatial tree exactly when a search needs it. Without particle classes the
  /// choice is the modeller's.
  void SettleSpatialTree();
  void SetSpatialTree(bool needed);

  TemplateFlags flags;
  bool hasMisc = true;
  CEL_Miscanellous misc;
  CEL_ListHead root{ElementKind::Root, "Tessal Setup"};
  ListHeads listHeads;
  Collections collections;
  SymbolTable table;
  /// The text of the file that was loaded. Texts of elements are views into it.
  std::shared_ptr<const std::string> source;
  std::string keptText;  ///< what that file holds beside the template, as it is in it
  mutable std::unique_ptr<CKvfItemTree> keptTree;  ///< of the source; none before somebody asks
  LoadAccount account;                             ///< what the load did not take over
  std::uint32_t groupCounter = 0;
  EditHistory* history = nullptr;  ///< where edits are recorded
  std::string templateFileName;
  std::string saveFileName;
};

/// Switches rebuilds off, and on again on every way out.
class RebuildsOff final {
 public:
  explicit RebuildsOff(TemplateFlags& templateFlags) : flags(templateFlags) { flags.rebuildEnabled = false; }
  RebuildsOff(const RebuildsOff&) = delete;
  RebuildsOff& operator=(const RebuildsOff&) = delete;
  ~RebuildsOff() { flags.rebuildEnabled = true; }

 private:
  TemplateFlags& flags;
};

}  // namespace tessal
