// One whole template: all its elements, the flat symbol table over them, the names that nobody has defined,
// the item tree of the file it came from, and the operations that load, change, check and save it.
// Views, forms and the command line tool reach a template only through this class, and keep identities of
// elements, never pointers, between events.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <vector>

#include "core/collections.h"
#include "core/creation.h"
#include "core/edit_history.h"
#include "core/symbol_table.h"
#include "core/template_state.h"
#include "elements/element_owner.h"

namespace tessal {

enum class Rewriting : std::uint8_t;
struct MergeConflict;

/// The symbol of the message that a load leaves when it could not keep the file's further top-level sections.
inline constexpr std::string_view kNotKeptSymbol = "could not read template: ";

class TemplateCore final : public ElementOwner {
 public:
  TemplateCore();
  TemplateCore(const TemplateCore&) = delete;
  TemplateCore& operator=(const TemplateCore&) = delete;
  ~TemplateCore() override;

  /// Empties the template and the error registry.
  void Clear();

  // Counts and access. A bad index raises the subscript failure.
  const Collections& Elements() const { return state.collections; }
  const Sequence<CEL_StateVariable>& StateVariables() const { return Elements().stateVariables; }
  const Sequence<CEL_Constant>& Constants() const { return Elements().constants; }
  const Sequence<CEL_Forcing>& Forcings() const { return Elements().forcings; }
  const Sequence<CEL_Auxilliary_Variable>& Auxiliaries() const { return Elements().auxiliaries; }
  const Sequence<CEL_Process>& Processes() const { return Elements().processes; }
  const Sequence<CEL_Derived_Output>& DerivedOutputs() const { return Elements().derivedOutputs; }
  const Sequence<CEL_Lagrange_Specie>& Species() const { return Elements().species; }
  std::size_t GetStateVariableCount() const { return StateVariables().size(); }
  std::size_t GetConstantCount() const { return Constants().size(); }
  std::size_t GetForcingCount() const { return Forcings().size(); }
  std::size_t GetAuxiliaryCount() const { return Auxiliaries().size(); }
  std::size_t GetProcessCount() const { return Processes().size(); }
  std::size_t GetDerivedOutputCount() const { return DerivedOutputs().size(); }
  std::size_t GetSpecieCount() const { return Species().size(); }
  std::size_t GetExternalFunctionCount() const;
  CEL_StateVariable& GetStateVariable(std::size_t index) const { return At(StateVariables(), index); }
  CEL_Constant& GetConstant(std::size_t index) const { return At(Constants(), index); }
  CEL_Forcing& GetForcing(std::size_t index) const { return At(Forcings(), index); }
  CEL_Auxilliary_Variable& GetAuxiliary(std::size_t index) const { return At(Auxiliaries(), index); }
  CEL_Process& GetProcess(std::size_t index) const { return At(Processes(), index); }
  CEL_Derived_Output& GetDerivedOutput(std::size_t index) const { return At(DerivedOutputs(), index); }
  CEL_Lagrange_Specie& GetSpecie(std::size_t index) const { return At(Species(), index); }
  /// All symbol slots but those of the particle classes themselves and their movements.
  std::size_t CountNamedElements() const;

  /// The settings, or none for a template from a file without them.
  CEL_Miscanellous* GetMisc() { return state.hasMisc ? &state.misc : nullptr; }
  const CEL_Miscanellous* GetMisc() const { return state.hasMisc ? &state.misc : nullptr; }
  /// The revision of the settings, 0 without settings.
  std::int32_t GetDocumentRevision() const;
  CEL_ListHead& Root() { return state.root; }
  const CEL_ListHead& Root() const { return state.root; }
  CEL_ListHead& ListHead(ElementKind listKind) const { return state.ListHead(listKind); }
  const TemplateState::ListHeads& ListHeads() const { return state.listHeads; }

  const std::vector<SymbolRecord>& SymbolTable() const { return state.table.Records(); }
  /// Whether a name that no element has means something all the same.
  bool CountsAsDefined(std::string_view name) const { return tessal::CountsAsDefined(name, state.misc); }
  /// Whether several elements have the same symbol.
  bool HasSharedSymbols() const { return state.table.HasSharedSymbols(); }
  const std::vector<std::unique_ptr<UndefinedSymbol>>& UndefinedSymbols() const {
    return state.table.Undefined();
  }
  std::vector<std::unique_ptr<UndefinedSymbol>>& UndefinedSymbols() { return state.table.Undefined(); }
  /// The text of the file that was loaded, up to a zero byte; empty before a load.
  std::string_view SourceText() const {
    return state.source ? std::string_view(*state.source) : std::string_view();
  }
  /// Its item tree, made when it is first asked for; empty for a text that its reader refuses.
  const CKvfSectionItem& KeptTree() const;
  const std::string& TemplateFileName() const { return state.templateFileName; }
  const std::string& SaveFileName() const { return state.saveFileName; }

  bool Modified() const { return state.flags.modified; }
  void SetModified(bool value) { state.flags.modified = value; }
  bool ShowAllBuiltIns() const { return state.flags.showAllBuiltIns; }
  void SetShowAllBuiltIns(bool value);
  /// Off while many elements are made at once; the caller rebuilds after it.
  void SetRebuildEnabled(bool value) { state.flags.rebuildEnabled = value; }
  /// 1 for the scope rule in force, 0 for the process rule in its place.
  void SetStrictScopeRule(std::int32_t value) { state.flags.strictScopeRule = value != 0; }

  // Finding. Nothing, or false with the outputs untouched, when there is none.
  const SymbolRecord* FindRecordBySequence(std::uint32_t sequence) const {
    return state.table.BySequence(sequence);
  }
  const SymbolRecord* FindRecordByUid(Uid uid) const { return state.table.ByUid(uid); }
  const SymbolRecord* RecordOfElement(const CEL_Element& element) const {
    return state.table.OfElement(element);
  }
  /// The element with this identity: one with a record, a list head of a particle class, or a user function.
  /// A kind other than None must be that of an element with a record.
  CEL_Element* GetElement(Uid uid, ElementKind kindFilter = ElementKind::None) const;
  CEL_Element* GetElementBySequence(std::uint32_t sequence) const;
  bool FindSymbol(std::string_view symbol, std::uint32_t& sequence) const;
  bool SymbolExists(std::string_view symbol) const override {
    return state.table.BySymbol(symbol) != nullptr;
  }
  bool GetSymbolOfUid(Uid uid, std::string& symbol) const;
  bool GetSequenceOfUid(Uid uid, std::uint32_t& sequence) const;
  bool IsSymbolTakenByOther(Uid uid, std::string_view symbol) const override;
  bool IsReferenced(Uid uid) const;
  bool GetReferrerUids(Uid uid, std::vector<Uid>& uids) const;
  bool GetReferrerSymbols(Uid uid, std::vector<std::string>& symbols) const;
  /// The symbols of those who use the record's element, each user once.
  std::vector<std::string> ReferrerSymbols(const SymbolRecord& record) const;
  /// Finds a collection element (no movement, no class) by its symbol; the kind is Unknown when there is
  /// none.
  bool FindElementBySymbol(std::string_view symbol, std::int32_t& id, ElementKind& elementKind) const;
  /// The class that one of its list heads belongs to.
  CEL_Lagrange_Specie* GetParentSpecie(Uid headUid) const;
  std::string RecordSymbol(const SymbolRecord& record) const { return tessal::RecordSymbol(record); }

  // Adding, removing, ordering.
  CEL_StateVariable& AddStateVariable();
  CEL_Constant& AddConstant();
  CEL_Forcing& AddForcing();
  CEL_Auxilliary_Variable& AddAuxiliary();
  CEL_Process& AddProcess();
  CEL_Derived_Output& AddDerivedOutput();
  CEL_Lagrange_Specie& AddSpecie();
  /// Makes an element of a collection with a symbol that is not in use; none for a kind without a collection.
  CEL_Element* AddElement(ElementKind kind);
  /// Makes an element with a symbol at the end of a collection, and leaves the table as it is: for a load,
  /// which reads the symbol afterwards.
  template <class Element>
  Element& AppendElement(const Collection<Element>& collection, std::string_view symbol);
  bool CanDelete(Uid uid) const;
  /// Deletes an element that nobody uses. One that is refused has left its visibility groups all the same.
  bool DeleteElement(Uid uid);
  /// Deletes several, as one step, each as soon as nobody uses it any more; those that stay are as they were.
  /// The ones that were not deleted.
  std::vector<Uid> DeleteElements(std::vector<Uid> uids);
  /// Whether a move keeps every use after its definition. Only auxiliaries, processes and arithmetic
  /// expressions can be refused.
  bool CanMove(Uid uid, Uid targetUid) const;
  /// Moves an element next to a sibling of its own kind and class.
  bool MoveElement(Uid uid, Uid targetUid, bool before);
  /// Moves a new element before its users, when one of them is of its own kind. The predecessor is the
  /// identity of the element now before it, or none.
  bool MoveBeforeFirstUser(Uid uid, Uid& predecessor);

  // Creating and renaming.
  /// Makes an element with the request's symbol and default texts, before its users. Turns change
  /// notifications on, also after a request for a kind that cannot be made.
  CreatedElement CreateElement(const CreateRequest& request);
  /// The question about the first undefined symbol that was not asked about yet, which counts as asked from
  /// now on; none when nothing is left to ask. An answer may change the list: each call looks at it afresh.
  std::optional<CreationOffer> NextOffer();
  /// The same question about one symbol, whether it was asked about or not; none when it is not undefined.
  std::optional<CreationOffer> OfferOf(std::string_view symbol);
  /// Gives an element a new symbol and, if asked to, rewrites every expression that uses it, by letters.
  /// False, with nothing changed, when the new symbol exists, the element does not take it, or the old one
  /// does not exist or is not editable: derived outputs and movements have captions, no symbols that a file
  /// holds.
  bool RenameSymbol(std::string_view oldSymbol, std::string_view newSymbol, bool replaceInExpressions);
  /// The same with any of the ways to rewrite the uses.
  bool Rename(std::string_view oldSymbol, std::string_view newSymbol, Rewriting rewriting);

  // Taking back. Off until the history is started.
  EditHistory& History() { return history; }
  /// Takes the last step back, or does the next one again, and brings up to date what follows; none when
  /// there is no step. The template counts as modified unless the file holds it as it is then.
  std::optional<StepEffect> Undo();
  std::optional<StepEffect> Redo();

  // The structural pass and the check pass.
  /// Numbers the elements, makes the symbol table and finds who uses whom. Reports nothing.
  void RebuildSymbolTable() override;
  /// Adds what it finds to the error registry; true when nothing was found.
  bool ValidateTemplate();
  /// What the rules of order, place and class find in a use of one element by another's expression; nothing
  /// when it is allowed. Reports nothing.
  std::optional<Finding> FindUseFault(const SymbolRecord& user, const SymbolRecord& used) const;
  bool CheckElementOrder(Uid uid) const;
  bool CheckDeclarationOrder() const;
  bool CheckScopeRule() const;
  bool CheckProcessRule() const;
  bool ParseAllExpressions();

  // Visibility groups. Groups and levels count from 1; everything does nothing, and gives 0 or an empty text,
  // for a template without settings.
  /// Makes a group with a name that is not in use; its number.
  std::int32_t AddVisibilityGroup();
  void RemoveVisibilityGroup(std::int32_t group);
  /// False, and nothing changes, for an empty name, one of another group, or a group that does not exist.
  bool SetGroupName(std::int32_t group, std::string_view name);
  void SetGroupDescription(std::int32_t group, std::string_view text);
  /// Makes a level with a name that is not in use in the group; its number, 0 for a group that does not
  /// exist.
  std::int32_t CreateLevel(std::int32_t group);
  /// False, and nothing changes, for an empty name, one of another level of the group, or a level that does
  /// not exist.
  bool SetLevelName(std::int32_t group, std::int32_t level, std::string_view name);
  void SetLevelDescription(std::int32_t group, std::int32_t level, std::string_view text);
  void DeleteLevel(std::int32_t group, std::int32_t level);
  void AddItemToLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence);
  void RemoveItemFromLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence);
  /// Record numbers of the elements of a level; of all levels of the group for a level below 1; of the whole
  /// table for a group below 1. With `recursive`, the levels down to the first are taken in.
  void CollectItems(std::int32_t group, std::int32_t level, std::vector<std::int32_t>& items,
                    bool recursive) const;
  /// Record numbers of the elements that belong to a level, in the order of the table and each element once:
  /// a movement by the first of its two records. None for a level that does not exist.
  std::vector<std::int32_t> IncludedItems(std::int32_t group, std::int32_t level) const;
  /// The same of all elements that do not belong to it.
  std::vector<std::int32_t> AvailableItems(std::int32_t group, std::int32_t level) const;
  /// Names for people; a number below 1 has a word for "all".
  std::string GroupText(std::int32_t group) const;
  std::string GroupListText(std::int32_t group) const;
  std::string LevelText(std::int32_t group, std::int32_t level) const;
  std::string LevelListText(std::int32_t group, std::int32_t level) const;

  // What elements report to their template.
  void OnChanging(CEL_Element& element, CEL_Property& property) override;
  void OnAppended(CEL_Element& element) override;
  void OnRemoved(std::unique_ptr<CEL_Element> element, std::size_t place) override;

  // What elements ask of their template.
  std::vector<const CEL_Element*> ReferencedElements(const CEL_Element& element) const override;
  std::size_t SpecieCount() const override { return Species().size(); }
  std::map<Uid, std::int32_t> RecordNumbers(const std::set<Uid>& uids) const override;
  void RefreshSearchFunctionChoices() override;

  /// Loads a file in the place of the present template. False when it could not be read; the registry then
  /// holds the reason.
  bool LoadWrapper(const std::string& path);
  /// Loads the text of a file that has no name.
  bool LoadText(std::string text);
  /// Loads the content of one file as that of another, which a plain save then replaces; of none where `path`
  /// is empty. Fails as a load does.
  bool LoadCopy(const std::string& source, const std::string& path);
  /// What the file of the load holds beside the template, as text; each save writes it after the template.
  const std::string& KeptText() const { return state.keptText; }
  /// Puts another text in its place, as an edit. The text is that of whole sections, with CRLF line ends and
  /// no blank lines at its ends.
  void SetKeptText(std::string text);
  /// What the file of the load holds that the load did not take over; empty after a save.
  const LoadAccount& Account() const { return state.account; }
  /// Counts what another load did not take over from the file that a save will replace.
  void AddToAccount(const LoadAccount& ofThatFile) { state.account.AddEntriesOf(ofThatFile); }
  /// Takes over what the load passed over, and forgets it. False when there is more that is to be set by
  /// hand.
  bool TakeOverPassedOver();
  /// Brings what changed from a base to another state of it into this one, which came from the base too.
  /// What the sides changed differently (`core/merge.h`) stays as it is here. Elements go by their symbols,
  /// renamed ones by their content (`core/matching.h`), and uses follow a rename of either side. The revision
  /// becomes the higher one. What the loads of the others did not take over is not merged. Nothing is
  /// recorded, so the history must not have been started.
  std::vector<MergeConflict> Merge(const TemplateCore& base, const TemplateCore& theirs);
  /// Saves: under its own name plainly, under another with fresh version stamps and a restarted revision.
  /// False when it failed; the registry then holds the reason, and the file on disk is as it was.
  bool SaveWrapper(const std::string& path);
  /// The text that a plain save would write, but for the revision, which stays. Nothing, with the reason,
  /// when the format cannot hold the template; the registry then names the elements.
  std::optional<std::string> CopyText(std::string& reason);

 private:
  template <class Element>
  Element& Add(const Collection<Element>& collection);
  void Adopt(CEL_Element& element, CEL_Element& parent);
  bool EraseElement(const SymbolRecord& record);
  void MoveWithin(const SymbolRecord& record, std::size_t place);
  CreationOffer OfferFor(const UndefinedSymbol& undefined) const;

  StepEffect Take(StepEffect (EditHistory::*step)());
  void FollowStep(const StepEffect& effect);

  TemplateState state;
  EditHistory history{state};
};

template <class Element>
Element& TemplateCore::AppendElement(const Collection<Element>& row, std::string_view symbol) {
  auto& elements = state.collections.*row.elements;
  auto owned = std::make_unique<Element>(symbol);
  Element& element = *owned;
  if constexpr (std::is_same_v<Element, CEL_Lagrange_Specie>) {
    element.SetIndex(static_cast<std::int32_t>(elements.size() + 1));
    Adopt(element, state.root);
    element.AddMember(ElementKind::HorizontalVector);
  } else {
    Adopt(element, ListHead(row.listKind));
  }
  if constexpr (std::is_base_of_v<CEL_Input, Element>) {
    if (state.flags.showAllBuiltIns) element.RebuildBuiltInChoices(true);
  }
  elements.push_back(std::move(owned));
  state.flags.modified = true;
  return element;
}

}  // namespace tessal
