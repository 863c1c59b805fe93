// Adding, deleting and moving elements. Each ends in a rebuild of the symbol table.
#include <algorithm>

#include "core/search_functions.h"
#include "core/template_core.h"
#include "core/visibility_groups.h"
#include "elements/free_name.h"

namespace tessal {

namespace {

bool IsParticleKind(ElementKind elementKind) {
  return elementKind >= ElementKind::SpecieStateVariable;
}

/// Kinds whose order of declaration an expression depends on.
bool IsOrdered(ElementKind elementKind) {
  return elementKind == ElementKind::Auxiliary || elementKind == ElementKind::Process ||
         elementKind == ElementKind::ArithmeticExpression;
}

/// Whether two records are of one sequence.
bool AreSiblings(const SymbolRecord& one, const SymbolRecord& other) {
  const ElementKind elementKind = one.element->Kind();
  if (elementKind != other.element->Kind()) return false;
  return !IsParticleKind(elementKind) || one.specieIndex == other.specieIndex;
}

/// The list that holds the record's element.
ListPlace ListOf(const Collections& collections, const SymbolRecord& record) {
  const ElementKind elementKind = record.element->Kind();
  return {elementKind, IsParticleKind(elementKind) ? &ClassOf(collections, record) : nullptr};
}

}  // namespace

template <class Element>
Element& TemplateCore::Add(const Collection<Element>& row) {
  const std::size_t number = (Elements().*row.elements).size() + 1;
  Element& element =
      AppendElement(row, FirstFreeName(row.symbolPrefix, number,
                                       [this](const std::string& symbol) { return SymbolExists(symbol); }));
  history.NoteInserted({row.kind, nullptr}, number - 1, element);
  element.documentation.SetText(state.root.documentation.Text());
  RebuildSymbolTable();
  return element;
}

CEL_Element* TemplateCore::AddElement(ElementKind kind) {
  CEL_Element* added = nullptr;
  WithCollection(kind, [this, &added](const auto& row) { added = &Add(row); });
  return added;
}

CEL_StateVariable& TemplateCore::AddStateVariable() {
  return Add(std::get<Collection<CEL_StateVariable>>(kCollections));
}

CEL_Constant& TemplateCore::AddConstant() {
  return Add(std::get<Collection<CEL_Constant>>(kCollections));
}

CEL_Forcing& TemplateCore::AddForcing() {
  return Add(std::get<Collection<CEL_Forcing>>(kCollections));
}

CEL_Auxilliary_Variable& TemplateCore::AddAuxiliary() {
  return Add(std::get<Collection<CEL_Auxilliary_Variable>>(kCollections));
}

CEL_Process& TemplateCore::AddProcess() {
  return Add(std::get<Collection<CEL_Process>>(kCollections));
}

CEL_Derived_Output& TemplateCore::AddDerivedOutput() {
  return Add(std::get<Collection<CEL_Derived_Output>>(kCollections));
}

CEL_Lagrange_Specie& TemplateCore::AddSpecie() {
  return Add(std::get<Collection<CEL_Lagrange_Specie>>(kCollections));
}

bool TemplateCore::CanDelete(Uid uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  switch (record->element->Kind()) {
    case ElementKind::HorizontalVector:
      return ClassOf(Elements(), *record).horizontalVectors.size() > 1;
    case ElementKind::VerticalEquation:
      return false;
    default:
      return record->referencedBy.empty();
  }
}

bool TemplateCore::DeleteElement(Uid uid) {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  const EditStep step(history);
  // First, so that an element whose deletion is refused has left its groups all the same.
  if (state.hasMisc) VisibilityGroups(state).Leave(*record->element);
  const ElementKind elementKind = record->element->Kind();
  if (!record->referencedBy.empty() || !EraseElement(*record)) return false;
  RebuildSymbolTable();
  // With a search function the need for a spatial tree may go.
  if (elementKind == ElementKind::SpatialFunction || elementKind == ElementKind::Specie) {
    RefreshSearchFunctionChoices();
    if (Species().empty()) state.SetSpatialTree(false);
  }
  state.flags.modified = true;
  return true;
}

std::vector<Uid> TemplateCore::DeleteElements(std::vector<Uid> uids) {
  const EditStep step(history);
  // A use comes after its definition: the last go first, and one round is the rule.
  for (std::size_t before = uids.size() + 1; uids.size() < before;) {
    before = uids.size();
    for (auto uid = uids.rbegin(); uid != uids.rend(); ++uid) {
      if (CanDelete(*uid) && DeleteElement(*uid)) *uid = Uid::None;
    }
    std::erase(uids, Uid::None);
  }
  return uids;
}

bool TemplateCore::EraseElement(const SymbolRecord& record) {
  const std::size_t index = record.index;
  const ElementKind elementKind = record.element->Kind();
  // A class keeps its last horizontal movement.
  if (elementKind == ElementKind::HorizontalVector && !CanDelete(record.uid)) return false;
  if (elementKind == ElementKind::Specie) ForgetSpecie(Elements(), At(Species(), index).Index());
  const ListPlace list = ListOf(Elements(), record);
  const bool erased = WithList(state.collections, list, [this, &list, index](auto& sequence) {
    const auto place = sequence.begin() + static_cast<std::ptrdiff_t>(index);
    std::unique_ptr<CEL_Element> gone = std::move(*place);
    sequence.erase(place);
    history.NoteRemoved(list, index, std::move(gone));
  });
  if (elementKind == ElementKind::Specie) NumberSpecies(Elements());
  return erased;
}

bool TemplateCore::CanMove(Uid uid, Uid targetUid) const {
  const SymbolRecord* moved = FindRecordByUid(uid);
  const SymbolRecord* target = FindRecordByUid(targetUid);
  if (moved == nullptr || target == nullptr) return true;
  if (!AreSiblings(*moved, *target) || !IsOrdered(moved->element->Kind())) return true;
  const auto staysBefore = [target](std::uint32_t used) { return used < target->sequence; };
  if (!std::all_of(moved->references.begin(), moved->references.end(), staysBefore)) return false;
  return std::all_of(
      moved->referencedBy.begin(), moved->referencedBy.end(), [this, target](std::uint32_t user) {
        const ElementKind userKind = state.table.Used(user).element->Kind();
        // Equations use what they use regardless of order.
        const bool isEquation =
            userKind == ElementKind::StateVariable || userKind == ElementKind::SpecieStateVariable;
        return isEquation || user > target->sequence;
      });
}

bool TemplateCore::MoveElement(Uid uid, Uid targetUid, bool before) {
  if (!CanMove(uid, targetUid)) return false;
  const SymbolRecord* moved = FindRecordByUid(uid);
  const SymbolRecord* target = FindRecordByUid(targetUid);
  if (moved == nullptr || target == nullptr || !AreSiblings(*moved, *target)) return false;
  if (moved->element->Kind() == ElementKind::VerticalEquation) return false;
  const EditStep step(history);
  // The moved element makes room where it has been.
  const std::size_t place = target->index + (before ? 0 : 1);
  MoveWithin(*moved, moved->index < place ? place - 1 : place);
  state.flags.modified = true;
  RebuildSymbolTable();
  return true;
}

/// Moves the record's element so that it has the place when the move is done.
void TemplateCore::MoveWithin(const SymbolRecord& record, std::size_t place) {
  const ListPlace list = ListOf(Elements(), record);
  WithList(state.collections, list,
           [&record, place](auto& sequence) { MoveWithinSequence(sequence, record.index, place); });
  history.NoteMoved(list, record.index, place, *record.element);
  if (record.element->Kind() == ElementKind::Specie) NumberSpecies(Elements());
}

bool TemplateCore::MoveBeforeFirstUser(Uid uid, Uid& predecessor) {
  predecessor = Uid::None;
  const EditStep step(history);
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr || record->referencedBy.empty()) return false;
  const ElementKind elementKind = record->element->Kind();
  const bool hasUserOfKind = std::any_of(record->referencedBy.begin(), record->referencedBy.end(),
                                         [this, elementKind](std::uint32_t user) {
                                           return state.table.Used(user).element->Kind() == elementKind;
                                         });
  if (!hasUserOfKind) return false;
  // The last user decides the place, whatever its kind; the user of the same kind is only the condition.
  const SymbolRecord* last = FindRecordByUid(state.table.Used(record->referencedBy.back()).uid);
  if (elementKind == ElementKind::StateVariable || IsOrdered(elementKind)) {
    // A place after the element's own leaves it where it is.
    const std::size_t place = std::min(last->index, record->index);
    MoveWithin(*record, place);
    if (place > 0) {
      WithList(state.collections, ListOf(Elements(), *record), [place, &predecessor](const auto& sequence) {
        predecessor = At(sequence, place - 1).GetUid();
      });
    }
  }
  RebuildSymbolTable();
  return true;
}

}  // namespace tessal
