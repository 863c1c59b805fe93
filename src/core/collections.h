// The collections of a template, and the table of what holds for each: where it is kept, what it holds, how
// it is in the file and how its new elements are called. Loading, saving, numbering, moving, deleting,
// creating, validating, the tree and the documentation are loops over its rows.
#pragma once

#include <string_view>
#include <tuple>

#include "core/symbol_table.h"
#include "elements/expression_elements.h"
#include "elements/input_elements.h"
#include "elements/sequence.h"
#include "elements/specie.h"
#include "elements/state_variable.h"
#include "keyfile/keywords.h"

namespace tessal {

/// The elements of a template, each sequence in the order of declaration.
struct Collections {
  Sequence<CEL_StateVariable> stateVariables;
  Sequence<CEL_Constant> constants;
  Sequence<CEL_Forcing> forcings;
  Sequence<CEL_Auxilliary_Variable> auxiliaries;
  Sequence<CEL_Process> processes;
  Sequence<CEL_Derived_Output> derivedOutputs;
  Sequence<CEL_Lagrange_Specie> species;
};

template <class Element>
struct Collection {
  Sequence<Element> Collections::*elements;
  ElementKind kind;
  ElementKind listKind;  ///< of the list head; None for the particle classes, which have none
  std::string_view section;
  std::string_view prefix;        ///< of the sub-sections
  std::string_view symbolPrefix;  ///< of default symbols
  ElementKind writtenHead;        ///< the list head whose texts a save writes

  bool HasHead() const { return listKind != ElementKind::None; }
};

template <class Element>
Collection(Sequence<Element> Collections::*, ElementKind, ElementKind, std::string_view, std::string_view,
           std::string_view, ElementKind) -> Collection<Element>;

/// In the order of the file. The equations come between the collections with a head and the particle classes.
inline constexpr std::tuple kCollections{
    Collection{&Collections::stateVariables, ElementKind::StateVariable, ElementKind::StateVariableList,
               section::kStateVariables, section::kStateVariablePrefix, "StateVariable_",
               ElementKind::StateVariableList},
    Collection{&Collections::constants, ElementKind::Constant, ElementKind::ConstantList, section::kConstants,
               section::kConstantPrefix, "Constant_", ElementKind::ConstantList},
    Collection{&Collections::forcings, ElementKind::Forcing, ElementKind::ForcingList, section::kForcings,
               section::kForcingPrefix, "Forcing_", ElementKind::ForcingList},
    // The texts of the auxiliaries' head are those of the constants: files have always been written so.
    Collection{&Collections::auxiliaries, ElementKind::Auxiliary, ElementKind::AuxiliaryList,
               section::kAuxiliaryVariables, section::kAuxiliaryVariablePrefix, "Auxiliary_",
               ElementKind::ConstantList},
    Collection{&Collections::processes, ElementKind::Process, ElementKind::ProcessList, section::kProcesses,
               section::kProcessPrefix, "Process_", ElementKind::ProcessList},
    Collection{&Collections::derivedOutputs, ElementKind::DerivedOutput, ElementKind::DerivedOutputList,
               section::kDerivedOutputs, section::kDerivedOutputPrefix, "Derived Output ",
               ElementKind::DerivedOutputList},
    Collection{&Collections::species, ElementKind::Specie, ElementKind::None, section::kLagrange,
               section::kSpeciePrefix, "Specie_", ElementKind::None},
};

/// Calls the visitor with each row.
template <class Visitor>
void ForEachCollection(Visitor visit) {
  std::apply([&visit](const auto&... row) { (visit(row), ...); }, kCollections);
}

/// Calls the visitor with each row that has a list head: all but the particle classes.
template <class Visitor>
void ForEachHeadedCollection(Visitor visit) {
  ForEachCollection([&visit](const auto& row) {
    if (row.HasHead()) visit(row);
  });
}

/// Calls the operation with the row of the kind; false for a kind without one.
template <class Operation>
bool WithCollection(ElementKind kind, Operation operation) {
  return std::apply([kind, &operation](
                        const auto&... row) { return ((row.kind == kind && (operation(row), true)) || ...); },
                    kCollections);
}

/// Calls the visitor with each element that a reference by number or name may mean, in the order in which the
/// first hit wins: the template's collections, then those of each particle class.
template <class Visitor>
void ForEachNamedElement(const Collections& collections, Visitor visit) {
  ForEachHeadedCollection([&collections, &visit](const auto& row) {
    for (const auto& element : collections.*row.elements) visit(*element);
  });
  for (const auto& specie : collections.species) {
    ForEachMemberList([&specie, &visit](const auto& list) {
      if (!list.hasHead) return;
      for (const auto& member : (*specie).*list.members) visit(*member);
    });
  }
}

/// The particle class of a record of one, of its members or of its movements.
inline CEL_Lagrange_Specie& ClassOf(const Collections& collections, const SymbolRecord& record) {
  return At(collections.species, static_cast<std::size_t>(record.specieIndex));
}

/// Where a list of elements is: a collection of the template or, for a class, a list of its members.
struct ListPlace {
  ElementKind kind = ElementKind::None;
  CEL_Lagrange_Specie* specie = nullptr;  ///< none for the template's own collections
};

/// Calls the operation with the sequence at the place; false where there is none.
template <class Operation>
bool WithList(Collections& collections, const ListPlace& place, Operation operation) {
  if (place.specie == nullptr) {
    return WithCollection(
        place.kind, [&collections, &operation](const auto& row) { operation(collections.*row.elements); });
  }
  return WithMemberList(place.kind,
                        [&place, &operation](const auto& list) { operation(place.specie->*list.members); });
}

/// Moves the element at a place so that it is at another one when the move is done.
template <class Element>
void MoveWithinSequence(Sequence<Element>& elements, std::size_t from, std::size_t to) {
  const auto at = [&elements](std::size_t place) {
    return elements.begin() + static_cast<std::ptrdiff_t>(place);
  };
  if (to <= from) {
    std::rotate(at(to), at(from), at(from + 1));
  } else {
    std::rotate(at(from), at(from + 1), at(to + 1));
  }
}

template <class Visitor>
void ForEachSearchFunction(const Collections& collections, Visitor visit) {
  for (const auto& specie : collections.species) {
    for (const auto& function : specie->spatialFunctions) visit(*function);
  }
}

}  // namespace tessal
