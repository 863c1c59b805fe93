#include "analysis/declared_values.h"

#include "elements/expression_elements.h"
#include "elements/input_elements.h"
#include "elements/specie_expressions.h"
#include "elements/specie_values.h"
#include "elements/state_variable.h"

namespace tessal {

namespace {

/// Calls the visitor with the element as what its kind says; false for a kind without declared values.
template <class Visitor>
bool WithFamily(const CEL_Element& element, Visitor visit) {
  switch (element.Kind()) {
    case ElementKind::StateVariable:
      return visit(static_cast<const CEL_StateVariable&>(element)), true;
    case ElementKind::Constant:
    case ElementKind::Forcing:
      return visit(static_cast<const CEL_Input&>(element)), true;
    case ElementKind::Auxiliary:
    case ElementKind::Process:
    case ElementKind::DerivedOutput:
      return visit(static_cast<const CEL_ExpressionElement&>(element)), true;
    case ElementKind::SpecieStateVariable:
    case ElementKind::SpecieConstant:
    case ElementKind::SpecieForcing:
      return visit(static_cast<const CEL_SpecieValue&>(element)), true;
    case ElementKind::ArithmeticExpression:
      return visit(static_cast<const CEL_Lagrange_Arithmetical_Expression&>(element)), true;
    default:
      return false;
  }
}

}  // namespace

std::optional<std::string_view> DeclaredUnit(const CEL_Element& element) {
  std::optional<std::string_view> unit;
  WithFamily(element, [&unit](const auto& member) { unit = member.unit.Text(); });
  return unit;
}

std::optional<DeclaredValue> DeclaredValueOf(const CEL_Element& element) {
  std::optional<DeclaredValue> value;
  WithFamily(element, [&value](const auto& member) {
    if constexpr (requires { member.defaultValue; }) {
      value = {member.defaultValue.RealValue(), member.minValue.RealValue(), member.maxValue.RealValue()};
    }
  });
  return value;
}

}  // namespace tessal
