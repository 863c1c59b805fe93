// Adding, deleting and moving elements. Each ends in a rebuild of the symbol table.
#include <algorithm>
#include <type_traits>

#include "core/template_core.h"

namespace tessal {

namespace {

/// Moves the element at `from` so that it stands where the one at `target` stands, which makes room.
template <class Element>
bool MoveWithin(Sequence<Element>& sequence, std::size_t from, std::size_t target) {
  if (from >= sequence.size()) return false;
  target = std::min(target, sequence.size());
  const auto begin = sequence.begin();
  const auto source = begin + static_cast<std::ptrdiff_t>(from);
  const auto place = begin + static_cast<std::ptrdiff_t>(target);
  if (place <= source) {
    std::rotate(place, source, source + 1);
  } else {
    std::rotate(source, source + 1, place);
  }
  return true;
}

template <class Element>
bool EraseFrom(Sequence<Element>& sequence, std::size_t index) {
  if (index >= sequence.size()) return false;
  sequence.erase(sequence.begin() + static_cast<std::ptrdiff_t>(index));
  return true;
}

bool IsParticleKind(ElementKind elementKind) {
  return elementKind >= ElementKind::SpecieStateVariable;
}

/// Kinds whose order of declaration an expression depends on.
bool IsOrdered(ElementKind elementKind) {
  return elementKind == ElementKind::Auxiliary || elementKind == ElementKind::Process ||
         elementKind == ElementKind::ArithmeticExpression;
}

/// Calls the operation with the class's sequence of members of the kind; false for a kind without one.
template <class Operation>
bool WithMemberSequence(CEL_Lagrange_Specie& specie, ElementKind elementKind, Operation operation) {
  switch (elementKind) {
    case ElementKind::SpecieStateVariable:
      return operation(specie.stateVariables);
    case ElementKind::SpecieConstant:
      return operation(specie.constants);
    case ElementKind::SpecieForcing:
      return operation(specie.forcings);
    case ElementKind::SpatialFunction:
      return operation(specie.spatialFunctions);
    case ElementKind::ArithmeticExpression:
      return operation(specie.arithmeticExpressions);
    case ElementKind::HorizontalVector:
      return operation(specie.horizontalVectors);
    default:
      return false;
  }
}

}  // namespace

template <class Operation>
bool TemplateCore::WithSequenceOf(const SymbolRecord& record, Operation operation) {
  const ElementKind elementKind = record.element->Kind();
  if (IsParticleKind(elementKind)) {
    return WithMemberSequence(At(species, static_cast<std::size_t>(record.specieIndex)), elementKind,
                              operation);
  }
  switch (elementKind) {
    case ElementKind::StateVariable:
      return operation(stateVariables);
    case ElementKind::Constant:
      return operation(constants);
    case ElementKind::Forcing:
      return operation(forcings);
    case ElementKind::Auxiliary:
      return operation(auxiliaries);
    case ElementKind::Process:
      return operation(processes);
    case ElementKind::DerivedOutput:
      return operation(derivedOutputs);
    case ElementKind::Specie:
      return operation(species);
    default:
      return false;
  }
}

std::string TemplateCore::MakeUniqueSymbol(std::string_view prefix, std::size_t number) const {
  std::string symbol = std::string(prefix) + std::to_string(number);
  while (SymbolExists(symbol)) symbol = std::string(prefix) + std::to_string(++number);
  return symbol;
}

void TemplateCore::FinishAdding() {
  if (flags.rebuildEnabled) RebuildSymbolTable();
  flags.modified = true;
}

template <class Element>
Element& TemplateCore::AddTo(Sequence<Element>& sequence, ElementKind listKind, std::string_view prefix) {
  auto element = std::make_unique<Element>(MakeUniqueSymbol(prefix, sequence.size() + 1));
  Adopt(*element, ListHead(listKind));
  element->documentation.SetText(root.documentation.Text());
  if constexpr (std::is_base_of_v<CEL_Input, Element>) {
    element->RebuildBuiltInChoices(flags.showAllBuiltIns);
  }
  sequence.push_back(std::move(element));
  FinishAdding();
  return *sequence.back();
}

CEL_StateVariable& TemplateCore::AddStateVariable() {
  return AddTo(stateVariables, ElementKind::StateVariableList, "StateVariable_");
}

CEL_Constant& TemplateCore::AddConstant() {
  return AddTo(constants, ElementKind::ConstantList, "Constant_");
}

CEL_Forcing& TemplateCore::AddForcing() {
  return AddTo(forcings, ElementKind::ForcingList, "Forcing_");
}

CEL_Auxilliary_Variable& TemplateCore::AddAuxiliary() {
  return AddTo(auxiliaries, ElementKind::AuxiliaryList, "Auxiliary_");
}

CEL_Process& TemplateCore::AddProcess() {
  return AddTo(processes, ElementKind::ProcessList, "Process_");
}

CEL_Derived_Output& TemplateCore::AddDerivedOutput() {
  return AddTo(derivedOutputs, ElementKind::DerivedOutputList, "Derived Output ");
}

CEL_Lagrange_Specie& TemplateCore::AddSpecie() {
  auto specie = std::make_unique<CEL_Lagrange_Specie>(MakeUniqueSymbol("Specie_", species.size() + 1));
  specie->SetIndex(static_cast<std::int32_t>(species.size() + 1));
  Adopt(*specie, root);
  specie->AddHorizontalVector();
  specie->documentation.SetText(root.documentation.Text());
  species.push_back(std::move(specie));
  FinishAdding();
  return *species.back();
}

bool TemplateCore::CanDelete(Uid uid) const {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  switch (record->element->Kind()) {
    case ElementKind::HorizontalVector:
      return At(species, static_cast<std::size_t>(record->specieIndex)).horizontalVectors.size() > 1;
    case ElementKind::VerticalEquation:
      return false;
    case ElementKind::ExternalFunction:
      return true;
    default:
      return record->referencedBy.empty();
  }
}

bool TemplateCore::DeleteElement(Uid uid) {
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr) return false;
  // First, so that an element whose deletion is refused has left its groups all the same.
  if (hasMisc) LeaveVisibilityGroups(*record->element);
  const ElementKind elementKind = record->element->Kind();
  if (!record->referencedBy.empty() || !EraseRecordElement(*record)) return false;
  RebuildSymbolTable();
  // With a search function the need for a spatial tree may go.
  if (elementKind == ElementKind::SpatialFunction || elementKind == ElementKind::Specie)
    RefreshSearchFunctionChoices();
  flags.modified = true;
  return true;
}

bool TemplateCore::EraseRecordElement(const SymbolRecord& record) {
  if (record.element->Kind() == ElementKind::HorizontalVector &&
      At(species, static_cast<std::size_t>(record.specieIndex)).horizontalVectors.size() < 2) {
    return false;
  }
  const auto index = static_cast<std::size_t>(record.index);
  const bool isSpecie = record.element->Kind() == ElementKind::Specie;
  if (isSpecie) ForgetSpecie(At(species, index).Index());
  const bool erased = WithSequenceOf(record, [index](auto& sequence) { return EraseFrom(sequence, index); });
  if (isSpecie) NumberSpecies();
  return erased;
}

bool TemplateCore::CanMove(Uid uid, Uid targetUid) const {
  const SymbolRecord* moved = FindRecordByUid(uid);
  const SymbolRecord* target = FindRecordByUid(targetUid);
  if (moved == nullptr || target == nullptr) return true;
  const ElementKind elementKind = moved->element->Kind();
  if (elementKind != target->element->Kind()) return true;
  if (IsParticleKind(elementKind) && moved->specieIndex != target->specieIndex) return true;
  if (!IsOrdered(elementKind)) return true;
  const auto staysAhead = [target](std::uint32_t used) { return used < target->sequence; };
  if (!std::all_of(moved->references.begin(), moved->references.end(), staysAhead)) return false;
  return std::all_of(
      moved->referencedBy.begin(), moved->referencedBy.end(), [this, target](std::uint32_t user) {
        const SymbolRecord* record = FindRecordBySequence(user);
        if (record == nullptr) return false;
        const ElementKind userKind = record->element->Kind();
        // Equations use what they use regardless of order.
        if (userKind == ElementKind::StateVariable || userKind == ElementKind::SpecieStateVariable)
          return true;
        return user > target->sequence;
      });
}

bool TemplateCore::MoveElement(Uid uid, Uid targetUid, bool before) {
  if (!CanMove(uid, targetUid)) return false;
  const SymbolRecord* moved = FindRecordByUid(uid);
  const SymbolRecord* target = FindRecordByUid(targetUid);
  if (moved == nullptr || target == nullptr) return false;
  const ElementKind elementKind = moved->element->Kind();
  const bool siblings = elementKind == target->element->Kind() &&
                        (!IsParticleKind(elementKind) || moved->specieIndex == target->specieIndex);
  if (!siblings) return false;
  if (!MoveRecordElement(*moved, static_cast<std::size_t>(target->index) + (before ? 0 : 1))) return false;
  flags.modified = true;
  RebuildSymbolTable();
  return true;
}

bool TemplateCore::MoveRecordElement(const SymbolRecord& record, std::size_t target) {
  const auto from = static_cast<std::size_t>(record.index);
  const bool moved =
      WithSequenceOf(record, [from, target](auto& sequence) { return MoveWithin(sequence, from, target); });
  if (record.element->Kind() == ElementKind::Specie) NumberSpecies();
  return moved;
}

bool TemplateCore::MoveBeforeFirstUser(Uid uid, Uid& predecessor) {
  predecessor = Uid::None;
  const SymbolRecord* record = FindRecordByUid(uid);
  if (record == nullptr || record->referencedByUids.empty()) return false;
  const ElementKind elementKind = record->element->Kind();
  const bool hasUserOfKind = std::any_of(
      record->referencedBy.begin(), record->referencedBy.end(), [this, elementKind](std::uint32_t user) {
        const SymbolRecord* candidate = FindRecordBySequence(user);
        return candidate != nullptr && candidate->element->Kind() == elementKind;
      });
  if (!hasUserOfKind) return false;
  // The last user decides the place, whatever its kind; the user of the same kind is only the condition.
  const SymbolRecord* last = FindRecordByUid(record->referencedByUids.back());
  const bool moves = elementKind == ElementKind::StateVariable || IsOrdered(elementKind);
  if (moves && last != nullptr) {
    // A place behind the element's own leaves it where it is.
    const auto place = static_cast<std::size_t>(std::min(last->index, record->index));
    MoveRecordElement(*record, place);
    if (place > 0) predecessor = UidAt(*record, place - 1);
  }
  RebuildSymbolTable();
  return true;
}

Uid TemplateCore::UidAt(const SymbolRecord& sibling, std::size_t place) {
  Uid uid = Uid::None;
  WithSequenceOf(sibling, [place, &uid](auto& sequence) {
    uid = At(sequence, place).GetUid();
    return true;
  });
  return uid;
}

}  // namespace tessal
