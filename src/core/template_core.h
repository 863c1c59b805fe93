// One whole template: all its elements, the flat symbol table over them, the names that nobody has defined,
// the item tree of the file it came from, and the operations that load, change, check and save it.
// Views, forms and the command line tool reach a template only through this class, and keep identities of
// elements, never pointers, between events.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/creation.h"
#include "core/symbol_record.h"
#include "elements/element_owner.h"
#include "elements/expression_elements.h"
#include "elements/input_elements.h"
#include "elements/miscellaneous.h"
#include "elements/sequence.h"
#include "elements/specie.h"
#include "elements/state_variable.h"
#include "keyfile/item_tree.h"
#include "platform/kvf2004.h"

namespace tessal {

/// The symbol of the message that a load leaves when it could not keep the file's further top-level sections.
inline constexpr std::string_view kNotKeptSymbol = "could not read template: ";

/// The switches of one template. Every property holds the address of the first.
struct TemplateFlags {
  bool modified = false;
  bool rebuildEnabled = true;
  bool showAllBuiltIns = false;
  std::int32_t strictScopeRule = 1;
};

class TemplateCore final : public ElementOwner {
 public:
  static constexpr std::size_t kListHeadCount = 6;

  TemplateCore();
  TemplateCore(const TemplateCore&) = delete;
  TemplateCore& operator=(const TemplateCore&) = delete;
  ~TemplateCore() override;

  /// Empties the template and the error registry.
  void Clear();

  // Counts and access. A bad index raises the subscript failure.
  std::size_t GetStateVariableCount() const { return stateVariables.size(); }
  std::size_t GetConstantCount() const { return constants.size(); }
  std::size_t GetForcingCount() const { return forcings.size(); }
  std::size_t GetAuxiliaryCount() const { return auxiliaries.size(); }
  std::size_t GetProcessCount() const { return processes.size(); }
  std::size_t GetDerivedOutputCount() const { return derivedOutputs.size(); }
  std::size_t GetSpecieCount() const { return species.size(); }
  std::size_t GetExternalFunctionCount() const;
  CEL_StateVariable& GetStateVariable(std::size_t index) const { return At(stateVariables, index); }
  CEL_Constant& GetConstant(std::size_t index) const { return At(constants, index); }
  CEL_Forcing& GetForcing(std::size_t index) const { return At(forcings, index); }
  CEL_Auxilliary_Variable& GetAuxiliary(std::size_t index) const { return At(auxiliaries, index); }
  CEL_Process& GetProcess(std::size_t index) const { return At(processes, index); }
  CEL_Derived_Output& GetDerivedOutput(std::size_t index) const { return At(derivedOutputs, index); }
  CEL_Lagrange_Specie& GetSpecie(std::size_t index) const { return At(species, index); }
  const Sequence<CEL_StateVariable>& StateVariables() const { return stateVariables; }
  const Sequence<CEL_Constant>& Constants() const { return constants; }
  const Sequence<CEL_Forcing>& Forcings() const { return forcings; }
  const Sequence<CEL_Auxilliary_Variable>& Auxiliaries() const { return auxiliaries; }
  const Sequence<CEL_Process>& Processes() const { return processes; }
  const Sequence<CEL_Derived_Output>& DerivedOutputs() const { return derivedOutputs; }
  const Sequence<CEL_Lagrange_Specie>& Species() const { return species; }
  /// All symbol slots but those of the particle classes themselves and their movements.
  std::size_t CountNamedElements() const;

  /// The settings, or none for a template from a file without them.
  CEL_Miscanellous* GetMisc() { return hasMisc ? &misc : nullptr; }
  const CEL_Miscanellous* GetMisc() const { return hasMisc ? &misc : nullptr; }
  /// The revision of the settings, 0 without settings.
  std::int32_t GetDocumentRevision() const;
  CEL_ListHead& Root() { return root; }
  const CEL_ListHead& Root() const { return root; }
  /// The list head of a kind from 22 to 27.
  CEL_ListHead& ListHead(ElementKind listKind) const;
  const std::array<std::unique_ptr<CEL_ListHead>, kListHeadCount>& ListHeads() const { return listHeads; }

  const std::vector<SymbolRecord>& SymbolTable() const { return symbolTable; }
  const std::vector<std::unique_ptr<UndefinedSymbol>>& UndefinedSymbols() const { return undefinedSymbols; }
  std::vector<std::unique_ptr<UndefinedSymbol>>& UndefinedSymbols() { return undefinedSymbols; }
  const CKvfSectionItem& KeptTree() const { return keptTree; }
  const std::string& TemplateFileName() const { return templateFileName; }
  const std::string& SaveFileName() const { return saveFileName; }

  bool Modified() const { return flags.modified; }
  void SetModified(bool value) { flags.modified = value; }
  bool ShowAllBuiltIns() const { return flags.showAllBuiltIns; }
  void SetShowAllBuiltIns(bool value);
  /// Off while many elements are made at once; the caller rebuilds behind it.
  void SetRebuildEnabled(bool value) { flags.rebuildEnabled = value; }
  /// 1 for the scope rule in force, 0 for the process rule that stands behind it.
  void SetStrictScopeRule(std::int32_t value) { flags.strictScopeRule = value; }

  // Finding. Nothing, or false with the outputs untouched, when there is none.
  const SymbolRecord* FindRecordBySequence(std::uint32_t sequence) const;
  /// The first record of the element: a horizontal movement's is that of its direction.
  const SymbolRecord* FindRecordByUid(Uid uid) const;
  /// The same for an element of this template that is at hand: without a search, behind a rebuild.
  const SymbolRecord* RecordOfElement(const CEL_Element& element) const;
  /// The element with this identity: one with a record, a list head of a particle class, or a user function.
  /// A kind other than None must be that of an element with a record.
  CEL_Element* GetElement(Uid uid, ElementKind kindFilter = ElementKind::None) const;
  CEL_Element* GetElementBySequence(std::uint32_t sequence) const;
  bool FindSymbol(std::string_view symbol, std::uint32_t& sequence) const;
  bool SymbolExists(std::string_view symbol) const override;
  bool GetSymbolOfUid(Uid uid, std::string& symbol) const;
  bool GetSequenceOfUid(Uid uid, std::uint32_t& sequence) const;
  bool IsSymbolTakenByOther(Uid uid, std::string_view symbol) const override;
  bool IsReferenced(Uid uid) const;
  bool GetReferrerUids(Uid uid, std::vector<Uid>& uids) const;
  bool GetReferrerSymbols(Uid uid, std::vector<std::string>& symbols) const;
  /// The symbols of those who use the record's element, each user once.
  std::vector<std::string> ReferrerSymbols(const SymbolRecord& record) const;
  /// Finds a collection element (no movement, no class) by its symbol; the kind is 20 when there is none.
  bool FindElementBySymbol(std::string_view symbol, std::int32_t& id, ElementKind& elementKind) const;
  /// The class that one of its list heads belongs to.
  CEL_Lagrange_Specie* GetParentSpecie(Uid headUid) const;
  /// The symbol of a record: the element's, composed with the class's for movements.
  std::string RecordSymbol(const SymbolRecord& record) const;

  // Adding, removing, ordering.
  CEL_StateVariable& AddStateVariable();
  CEL_Constant& AddConstant();
  CEL_Forcing& AddForcing();
  CEL_Auxilliary_Variable& AddAuxiliary();
  CEL_Process& AddProcess();
  CEL_Derived_Output& AddDerivedOutput();
  CEL_Lagrange_Specie& AddSpecie();
  bool CanDelete(Uid uid) const;
  /// Deletes an element that nobody uses. One that is refused has left its visibility groups all the same.
  bool DeleteElement(Uid uid);
  /// Whether a move keeps every use behind its definition. Only auxiliaries, processes and arithmetic
  /// expressions can be refused.
  bool CanMove(Uid uid, Uid targetUid) const;
  /// Moves an element next to a sibling of its own kind and class.
  bool MoveElement(Uid uid, Uid targetUid, bool before);
  /// Moves a new element ahead of its users, when one of them is of its own kind. The predecessor is the
  /// identity of the element now before it, or 0.
  bool MoveBeforeFirstUser(Uid uid, Uid& predecessor);

  // Creating and renaming.
  /// Makes an element with the request's symbol and default texts, ahead of its users. Turns change
  /// notifications on; a request for a kind that cannot be made leaves them off.
  CreatedElement CreateElement(const CreateRequest& request);
  /// The question about the first undefined symbol that was not asked about yet, which counts as asked from
  /// now on; none when nothing is left to ask. An answer may change the list: each call looks at it afresh.
  std::optional<CreationOffer> NextOffer();
  /// Gives an element a new symbol and, if asked to, rewrites every expression that uses it. False, with
  /// nothing changed, when the new symbol exists or the old one does not.
  bool RenameSymbol(std::string_view oldSymbol, std::string_view newSymbol, bool replaceInExpressions);

  // The structural pass and the check pass.
  /// Numbers the elements, makes the symbol table and finds who uses whom. Reports nothing.
  void RebuildSymbolTable() override;
  /// Adds what it finds to the error registry; true when nothing was found.
  bool ValidateTemplate();
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
  /// Makes a level with a default name; its number, 0 for a group that does not exist.
  std::int32_t CreateLevel(std::int32_t group);
  void DeleteLevel(std::int32_t group, std::int32_t level);
  void AddItemToLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence);
  void RemoveItemFromLevel(std::int32_t group, std::int32_t level, std::uint32_t sequence);
  /// Record numbers of the elements of a level; of all levels of the group for a level below 1; of the whole
  /// table for a group below 1. With `recursive`, the levels down to the first are taken in.
  void CollectItems(std::int32_t group, std::int32_t level, std::vector<std::int32_t>& items,
                    bool recursive) const;
  /// Names for people; a number below 1 has a word for "all".
  std::string GroupText(std::int32_t group) const;
  std::string GroupListText(std::int32_t group) const;
  std::string LevelText(std::int32_t group, std::int32_t level) const;
  std::string LevelListText(std::int32_t group, std::int32_t level) const;

  // What elements ask of their template.
  std::vector<const CEL_Element*> ReferencedElements(const CEL_Element& element) const override;
  std::vector<NamedNumber> SpecieNames() const override;
  std::set<std::int32_t> ItemsToRecordNumbers(const std::set<Uid>& uids) const override;
  void RefreshSearchFunctionChoices() override;

  /// Loads a file in the place of the present template. False when it could not be read; the registry then
  /// holds the reason.
  bool LoadWrapper(const std::string& path);
  /// Saves: under its own name plainly, under another with fresh version stamps and a restarted revision.
  /// False when it failed; the registry then holds the reason, and the file on disk is as it was.
  bool SaveWrapper(const std::string& path);

 private:
  struct ReferenceLookup;

  template <class Element>
  Element& AddTo(Sequence<Element>& sequence, ElementKind listKind, std::string_view prefix);
  template <class Visitor>
  void ForEachNamedElement(Visitor visit) const;
  /// Each element with a record, once.
  template <class Visitor>
  void ForEachRecordElement(Visitor visit) const;
  void Adopt(CEL_Element& element, CEL_Element& parent);
  void FinishAdding();
  std::string MakeUniqueSymbol(std::string_view prefix, std::size_t number) const;
  /// Calls the operation with the sequence that holds the record's element; false for a kind without one.
  template <class Operation>
  bool WithSequenceOf(const SymbolRecord& record, Operation operation);
  bool EraseRecordElement(const SymbolRecord& record);
  /// Numbers the particle classes by their places, and takes the searches for a class along to its number.
  void NumberSpecies();
  /// Searches for the class of that number look for none from now on: the number goes to another class.
  void ForgetSpecie(std::int32_t number);
  template <class Visitor>
  void ForEachSearchFunction(Visitor visit) const;
  bool MoveRecordElement(const SymbolRecord& record, std::size_t target);
  Uid UidAt(const SymbolRecord& sibling, std::size_t place);
  void LeaveVisibilityGroups(CEL_Element& element);

  void AppendRecordSymbol(const SymbolRecord& record, std::string& text) const;
  SymbolRecord& Record(std::uint32_t sequence) { return symbolTable[sequence - 1]; }
  const SymbolRecord& Record(std::uint32_t sequence) const { return symbolTable[sequence - 1]; }
  bool CheckRecordOrder(const SymbolRecord& record) const;

  CEL_Element* AddByRequest(const CreateRequest& request);
  CreationOffer OfferFor(const UndefinedSymbol& undefined) const;
  void RewriteUsers(const SymbolRecord& renamed, std::string_view oldSymbol, std::string_view newSymbol);
  bool ApplyExpression(std::uint32_t sequence, std::string_view text);
  bool ApplySymbol(std::uint32_t sequence, std::string_view text);
  bool ApplyFields(std::uint32_t sequence, const std::vector<ElementField>& fields);

  // Steps of the rebuild.
  void MarkUndefinedStale();
  void DropStaleUndefined();
  SymbolRecord& AppendRecord(CEL_Element& element, std::int32_t index, std::int32_t specieIndex,
                             std::string_view text);
  void NumberTemplateElements();
  void NumberParticleElements();
  void ResolveReferencesToNames();
  void ResolveNamesToReferences();
  void ExtractReferences();
  void ExtractRecordReferences(SymbolRecord& record, ReferenceLookup& lookup);
  void Refer(SymbolRecord& record, std::string_view name, ReferenceLookup& lookup);
  void NoteUndefined(std::string_view name, Uid uid, ReferenceLookup& lookup);
  bool CountsAsDefined(std::string_view name) const;
  void BuildReverseReferences();
  void ClassifyArithmeticExpressions();

  // Steps of a load.
  bool Load(const std::string& path);
  bool ReadTemplate(const std::string& path);
  bool ReadSections(KvfHandle file, int targetNumber);
  void ReadMisc(KvfNode target, int& status);
  void ReadCollections(KvfNode target, int& status);
  template <class AddElement>
  void ReadCollection(KvfNode target, std::string_view name, ElementKind listKind, int& status,
                      AddElement add);
  void ReadEquations(KvfNode target, int& status);
  void ReadSpecies(KvfNode target, int& status);
  void ApplyVisibilityGroups();
  bool HasGroup(std::int32_t group) const;
  bool HasLevel(std::int32_t group, std::int32_t level) const;
  const VisibilityGroup& Group(std::int32_t group) const;
  VisibilityGroup& Group(std::int32_t group);
  VisibilityLevel& Level(std::int32_t group, std::int32_t level);
  std::string NamedGroup(std::int32_t group, std::string_view all) const;
  std::string NamedLevel(std::int32_t group, std::int32_t level, std::string_view all) const;
  bool CheckIdRange();
  void AssignIds();

  // Steps of a save.
  bool Save(const std::string& path);
  bool SaveAs(const std::string& path);
  bool WriteTemplateFile(const std::string& path);
  bool WriteSections(KvfHandle file);
  void WriteCollections(KvfHandle file, int& status);
  void WriteEquations(KvfHandle file, int& status);
  void WriteSpecies(KvfHandle file, int& status);
  /// Writes everything into the place of the file; the empty text, or the reason of a failure.
  std::string WriteThrough(const std::string& path);
  std::string KeptSectionsText() const;

  bool hasMisc = true;
  CEL_Miscanellous misc;
  TemplateFlags flags;
  std::array<std::unique_ptr<CEL_ListHead>, kListHeadCount> listHeads;
  Sequence<CEL_StateVariable> stateVariables;
  Sequence<CEL_Constant> constants;
  Sequence<CEL_Forcing> forcings;
  Sequence<CEL_Auxilliary_Variable> auxiliaries;
  Sequence<CEL_Process> processes;
  Sequence<CEL_Derived_Output> derivedOutputs;
  Sequence<CEL_Lagrange_Specie> species;
  CKvfSectionItem keptTree;
  std::uint32_t groupCounter = 0;
  std::string templateFileName;
  std::string saveFileName;
  CEL_ListHead root{ElementKind::Root, "Tessal Setup"};
  std::vector<SymbolRecord> symbolTable;
  std::size_t recordCount = 0;  ///< records that the rebuild under way has made
  std::vector<std::unique_ptr<UndefinedSymbol>> undefinedSymbols;
};

template <class Visitor>
void TemplateCore::ForEachSearchFunction(Visitor visit) const {
  for (const auto& specie : species) {
    for (const auto& function : specie->spatialFunctions) visit(*function);
  }
}

/// Calls the visitor with each element that a reference by number or name may mean, in the order in which
/// the first hit wins: the template's collections, then those of each particle class.
template <class Visitor>
void TemplateCore::ForEachNamedElement(Visitor visit) const {
  for (const auto& element : stateVariables) visit(*element);
  for (const auto& element : constants) visit(*element);
  for (const auto& element : forcings) visit(*element);
  for (const auto& element : auxiliaries) visit(*element);
  for (const auto& element : processes) visit(*element);
  for (const auto& element : derivedOutputs) visit(*element);
  for (const auto& specie : species) {
    for (const auto& element : specie->stateVariables) visit(*element);
    for (const auto& element : specie->constants) visit(*element);
    for (const auto& element : specie->forcings) visit(*element);
    for (const auto& element : specie->spatialFunctions) visit(*element);
    for (const auto& element : specie->arithmeticExpressions) visit(*element);
  }
}

}  // namespace tessal
