// What the members of a particle class may use: the template's inputs and state variables, and members of
// their own class that are declared before them.
#include <algorithm>
#include <optional>

#include "core/error_registry.h"
#include "elements/element_checks.h"
#include "elements/element_owner.h"
#include "elements/specie.h"

namespace tessal {

namespace {

/// What messages call a member of another class.
struct MemberWord {
  ElementKind kind;
  std::string_view word;
};

constexpr std::array<MemberWord, 3> kMemberWords = {{
    {ElementKind::SpecieConstant, "constant"},
    {ElementKind::SpatialFunction, "spatial function"},
    {ElementKind::ArithmeticExpression, "expression"},
}};

Finding NotOfThisClass(const CEL_Element& used, const CEL_Element& specie) {
  const auto hit = std::find_if(kMemberWords.begin(), kMemberWords.end(),
                                [&used](const MemberWord& row) { return row.kind == used.Kind(); });
  const std::string_view word = hit == kMemberWords.end() ? "symbol" : hit->word;
  return {"foreign-member", {word, used.symbol.Text(), specie.symbol.Text()}};
}

/// What a state variable's equation may use: the arithmetic expressions of its class.
std::optional<Finding> FindEquationFault(const CEL_Element& used, const CEL_Lagrange_Specie& specie) {
  if (used.Kind() != ElementKind::ArithmeticExpression) {
    return Finding("foreign-equation-term", {used.symbol.Text(), specie.symbol.Text()});
  }
  const auto& expression = static_cast<const CEL_Lagrange_Arithmetical_Expression&>(used);
  if (expression.specie.IntValue() == specie.Index()) return std::nullopt;
  return NotOfThisClass(used, specie);
}

std::optional<Finding> FindExpressionFault(const CEL_Element& used, const CEL_Lagrange_Specie& specie) {
  // A class may be named as the target of an interaction; one that comes later is a fault of order.
  const bool isOpenToAll = used.Kind() == ElementKind::StateVariable ||
                           used.Kind() == ElementKind::Constant || used.Kind() == ElementKind::Forcing ||
                           used.Kind() == ElementKind::Specie;
  if (isOpenToAll || specie.Owns(used)) return std::nullopt;
  if (used.Kind() == ElementKind::SpecieStateVariable) {
    return Finding("foreign-state-variable", {used.symbol.Text(), specie.symbol.Text()});
  }
  return NotOfThisClass(used, specie);
}

/// Whether an element is declared after its user. A class that does not come after this one is known already.
bool IsDeclaredAfter(const CEL_Element& used, const CEL_Element& user, const CEL_Lagrange_Specie& specie) {
  if (used.id.IntValue() <= user.id.IntValue()) return false;
  if (used.Kind() != ElementKind::Specie) return true;
  return static_cast<const CEL_Lagrange_Specie&>(used).Index() > specie.Index();
}

}  // namespace

bool CEL_Lagrange_Specie::ParseExpression() {
  bool good = true;
  const auto parse = [&good](CEL_Element& member) { good = member.ParseExpression() && good; };
  for (const auto& member : arithmeticExpressions) parse(*member);
  for (const auto& member : stateVariables) parse(*member);
  for (const auto& member : horizontalVectors) parse(*member);
  parse(*verticalEquation);
  return good;
}

bool CEL_Lagrange_Specie::Check() {
  bool good = CheckTextContent(*this);
  ForEachMember([this, &good](const CEL_Element& member) {
    if (member.HasExpression()) good = CheckMemberReferences(member) && good;
  });
  return good;
}

std::optional<Finding> CEL_Lagrange_Specie::FindUseFault(const CEL_Element& member,
                                                         const CEL_Element& used) const {
  // Equations use what they use regardless of order: state variables are integrated.
  if (member.Kind() == ElementKind::SpecieStateVariable) return FindEquationFault(used, *this);
  if (IsDeclaredAfter(used, member, *this))
    return Finding("order-violated", {used.symbol.Text(), member.FullSymbol()});
  return FindExpressionFault(used, *this);
}

bool CEL_Lagrange_Specie::CheckMemberReferences(const CEL_Element& member) const {
  if (Owner() == nullptr) return true;
  bool good = true;
  for (const CEL_Element* used : Owner()->ReferencedElements(member)) {
    const auto finding = FindUseFault(member, *used);
    if (!finding) continue;
    Errors().Report(member.FullSymbol(), member.GetUid(), *finding);
    good = false;
  }
  return good;
}

}  // namespace tessal
