// What an element is: the numbers that the symbol table, the tree and the change hints share.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace tessal {

enum class ElementKind : std::int32_t {
  None = 0,
  StateVariable = 1,
  Constant = 2,
  Forcing = 3,
  Auxiliary = 4,
  Process = 5,
  DerivedOutput = 6,
  Specie = 7,
  SpecieStateVariable = 8,
  SpecieConstant = 9,
  SpecieForcing = 10,
  SpatialFunction = 11,
  ArithmeticExpression = 12,
  HorizontalVector = 13,
  VerticalEquation = 14,
  Miscellaneous = 15,
  ExternalFunction = 16,
  Visibility = 17,
  VisibilityGroup = 18,
  VisibilityGroups = 19,
  Unknown = 20,
  Root = 21,
  StateVariableList = 22,
  ConstantList = 23,
  ForcingList = 24,
  AuxiliaryList = 25,
  ProcessList = 26,
  DerivedOutputList = 27,
  SpecieStateVariableList = 28,
  SpecieConstantList = 29,
  SpecieForcingList = 30,
  SpatialFunctionList = 31,
  ArithmeticExpressionList = 32,
  HorizontalVectorList = 33,
  VerticalEquationList = 34,
};

/// The number of a kind, as listings print it.
constexpr std::int32_t NumberOf(ElementKind kind) {
  return static_cast<std::int32_t>(kind);
}

/// The kind a number of places after another.
constexpr ElementKind KindAfter(ElementKind first, std::size_t place) {
  return static_cast<ElementKind>(NumberOf(first) + static_cast<std::int32_t>(place));
}

/// The text that lists and messages use; "unknown" for a number without a row.
std::string_view KindText(ElementKind kind);

}  // namespace tessal
